# Values, objects, handlers and the provider interfaces.
# The handle to a host that the test plays; what only this API promises.
set(embedded_only CIMOMHandleTest.cpp StricterThanTheServerTest.cpp)
commonprovider_test(pegasus_objects_test
  SOURCES
    "$<$<STREQUAL:${CIM_API},embedded>:${embedded_only}>"
    CIMValueTest.cpp
    HandleTest.cpp
    ObjectRulesTest.cpp
    OperationContextTest.cpp
  LIBRARIES cim_api)
