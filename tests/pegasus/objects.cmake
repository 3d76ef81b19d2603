# Values, objects, handlers and the provider interfaces.
commonprovider_test(pegasus_objects_test
  SOURCES
    CIMKeyBindingValueTest.cpp
    CIMOMHandleTest.cpp
    CIMPropertyListTest.cpp
    CIMValueTest.cpp
    CloneModelTest.cpp
    CloneThreadsTest.cpp
    HandleTest.cpp
    ObjectRulesTest.cpp
    OperationContextTest.cpp
    PortabilityTest.cpp
    ProviderInterfaceTest.cpp
  LIBRARIES cim_api)
