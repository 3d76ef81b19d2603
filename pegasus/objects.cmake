# Sources of values, objects, handlers and the provider interfaces.
set(CIM_API_OBJECT_SOURCES)
foreach(name
    ArrayObjects CIMClass CIMFlavor CIMInstance CIMKeyBindingValue CIMMethod CIMObject CIMObjectText CIMOMHandle
    CIMParamValue CIMParameter CIMProperty CIMPropertyList CIMQualifier CIMValue CIMValueText
    CIMProvider OperationContext ProviderException QualifiedHandle ResponseHandler Shareable)
  list(APPEND CIM_API_OBJECT_SOURCES "${CMAKE_CURRENT_LIST_DIR}/src/${name}.cpp")
endforeach()
