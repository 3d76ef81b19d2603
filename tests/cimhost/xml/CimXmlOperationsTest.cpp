// Every operation, as literal XML.

#include "tests/cimhost/xml/CimXmlTestSupport.h"

#include <gmock/gmock.h>

namespace cimhost::test {
namespace {

using testing::HasSubstr;
using testing::StartsWith;

const std::string kSize = "<PROPERTY NAME='Size' TYPE='uint64'><VALUE>7</VALUE></PROPERTY>";

std::string error(int code, const std::string& description) {
  return "<ERROR CODE='" + std::to_string(code) + "' DESCRIPTION='" + description + "'/>";
}

std::string returned(const std::string& elements) {
  return "<IRETURNVALUE>" + elements + "</IRETURNVALUE>";
}

TEST_F(CimXmlTest, Instances) {
  const Reply reply =
      answer(intrinsic("EnumerateInstances", className("ClassName", "Test_BigDisk")));
  EXPECT_EQ(reply.headers.at("Content-Type"), "application/xml; charset=\"utf-8\"");
  EXPECT_EQ(reply.headers.at("CIMOperation"), "MethodResponse");
  // LocalOnly is true by default, and the key is inherited.
  EXPECT_EQ(reply.result(),
            returned("<VALUE.NAMEDINSTANCE>" + instanceElement("Test_BigDisk", "big") +
                     "<INSTANCE CLASSNAME='Test_BigDisk'>" + kSize +
                     "</INSTANCE></VALUE.NAMEDINSTANCE>"));
  EXPECT_EQ(reply.summary.operation, "EnumerateInstances");
  EXPECT_EQ(reply.summary.target, "root/test:Test_BigDisk");
  EXPECT_EQ(reply.summary.objects, 1u);
  EXPECT_EQ(ask("EnumerateInstances", className("ClassName", "Test_OnlyCompletes")), returned(""));
  EXPECT_EQ(ask("getinstance",
                instanceName("instancename", "Test_BigDisk", "a") + value("LOCALONLY", "FALSE") +
                    value("IncludeQualifiers", "TRUE") + value("IncludeClassOrigin", "TRUE") +
                    parameter("PropertyList", "<VALUE.ARRAY><VALUE>NAME</VALUE></VALUE.ARRAY>")),
            returned("<INSTANCE CLASSNAME='Test_BigDisk'><PROPERTY NAME='Name' TYPE='string' "
                     "CLASSORIGIN='Test_Base'><QUALIFIER NAME='Key' TYPE='boolean' "
                     "OVERRIDABLE='false' TOSUBCLASS='false'><VALUE>TRUE</VALUE></QUALIFIER>"
                     "<VALUE>big</VALUE></PROPERTY></INSTANCE>"));
  EXPECT_EQ(ask("EnumerateInstanceNames", className("ClassName", "Test_Array")),
            returned(instanceElement("Test_Array", "n") +
                     "<INSTANCENAME CLASSNAME='Test_Array'></INSTANCENAME>"));
}

TEST_F(CimXmlTest, Changes) {
  const std::string memory = instanceName("InstanceName", "Test_Memory", "m");
  const auto get = [&](const char* name) {
    return ask("GetProperty", memory + value("PropertyName", name));
  };
  const auto set = [&](const char* name, const std::string& newValue) {
    return ask("SetProperty", memory + value("PropertyName", name) + newValue);
  };
  EXPECT_EQ(set("size", value("NewValue", "0x10")), "");
  EXPECT_EQ(get("SIZE"), returned("<VALUE>16</VALUE>"));
  EXPECT_EQ(get("Name"), returned(""));  // not delivered: null
  EXPECT_EQ(set("Size", ""), "");
  EXPECT_EQ(get("Size"), returned(""));
  EXPECT_EQ(get("Nope"), error(12, "Nope"));
  EXPECT_EQ(set("Nope", value("NewValue", "1")), error(12, "Nope"));
  EXPECT_EQ(set("Size", value("NewValue", "many")),
            error(13, "parameter NewValue: &quot;many&quot; is not an integer"));
  EXPECT_EQ(ask("CreateInstance", parameter("NewInstance", "<INSTANCE CLASSNAME='Test_Array'/>")),
            returned(instanceElement("Test_Array", "new")));
  EXPECT_EQ(ask("DeleteInstance", instanceName("InstanceName", "Test_ThrowsNotSupported", "x")),
            error(7, "no"));
  EXPECT_EQ(ask("DeleteInstance", instanceName("InstanceName", "Test_Array", "x")), "");
}

TEST_F(CimXmlTest, Associations) {
  const std::string disk = instanceName("ObjectName", "Test_Disk", "a");
  const std::string place = "<INSTANCEPATH><NAMESPACEPATH><HOST>" +
                            toUtf8(host.operations.hostName()) +
                            "</HOST><LOCALNAMESPACEPATH><NAMESPACE NAME='root'/><NAMESPACE "
                            "NAME='test'/></LOCALNAMESPACEPATH></NAMESPACEPATH>";
  EXPECT_THAT(ask("AssociatorNames", disk + className("AssocClass", "Link_FastPort")),
              StartsWith("<IRETURNVALUE><OBJECTPATH>" + place));
  EXPECT_THAT(ask("Associators", disk + className("ResultClass", "Test_FastPort")),
              testing::AllOf(StartsWith("<IRETURNVALUE><VALUE.OBJECTWITHPATH>" + place),
                             HasSubstr("</INSTANCEPATH><INSTANCE CLASSNAME='Test_FastPort'>"
                                       "<PROPERTY")));
  EXPECT_THAT(ask("ReferenceNames", disk + className("ResultClass", "Link_Port")),
              HasSubstr("<INSTANCENAME CLASSNAME='Link_Port'>"));
  EXPECT_THAT(ask("References", disk + value("Role", "Disk")),
              HasSubstr("<INSTANCE CLASSNAME='Link_Port"));
  EXPECT_EQ(ask("Associators", disk + value("ResultRole", "Disk")), returned(""));
}

TEST_F(CimXmlTest, Classes) {
  EXPECT_EQ(ask("EnumerateClassNames", className("ClassName", "Test_Base")),
            returned("<CLASSNAME NAME='Test_Unserved'/><CLASSNAME NAME='Test_Disk'/>"));
  EXPECT_EQ(ask("GetClass", className("ClassName", "Test_Disk") + value("LocalOnly", "FALSE") +
                                value("IncludeClassOrigin", "TRUE")),
            returned("<CLASS NAME='Test_Disk' SUPERCLASS='Test_Base'><PROPERTY NAME='Name' "
                     "TYPE='string' CLASSORIGIN='Test_Base' PROPAGATED='true'><QUALIFIER "
                     "NAME='Key' TYPE='boolean' PROPAGATED='true' OVERRIDABLE='false'>"
                     "<VALUE>TRUE</VALUE></QUALIFIER></PROPERTY><PROPERTY NAME='Text' "
                     "TYPE='string' CLASSORIGIN='Test_Disk'></PROPERTY><METHOD NAME='Format' "
                     "TYPE='uint32' CLASSORIGIN='Test_Base' PROPAGATED='true'></METHOD></CLASS>"));
  EXPECT_THAT(
      ask("GetClass", className("ClassName", "Test_Typed")),
      HasSubstr("<PROPERTY NAME='Size' TYPE='uint8'><VALUE>5</VALUE></PROPERTY>"
                "<METHOD NAME='Take' TYPE='uint32'>"
                "<PARAMETER NAME='Count' TYPE='uint8'></PARAMETER>"
                "<PARAMETER.ARRAY NAME='Names' TYPE='string' ARRAYSIZE='2'></PARAMETER.ARRAY>"
                "<PARAMETER.REFERENCE NAME='Ref' REFERENCECLASS='Test_Disk'></PARAMETER.REFERENCE>"
                "<PARAMETER.REFARRAY NAME='Refs' REFERENCECLASS='Test_Disk'></PARAMETER.REFARRAY>"
                "</METHOD></CLASS>"));
  EXPECT_THAT(ask("EnumerateClasses", className("ClassName", "Link_Port")),
              StartsWith("<IRETURNVALUE><CLASS NAME='Link_FastPort' SUPERCLASS='Link_Port'>"));
  EXPECT_EQ(ask("EnumerateClasses", "").find(" SUPERCLASS="), std::string::npos);
  EXPECT_THAT(ask("EnumerateClasses", value("DeepInheritance", "TRUE")),
              HasSubstr("SUPERCLASS='Test_Base'"));
}

TEST_F(CimXmlTest, Qualifiers) {
  EXPECT_EQ(ask("GetQualifier", value("QualifierName", "key")),
            returned("<QUALIFIER.DECLARATION NAME='Key' TYPE='boolean' ISARRAY='false' "
                     "OVERRIDABLE='false'><SCOPE REFERENCE='true' PROPERTY='true'></SCOPE>"
                     "<VALUE>FALSE</VALUE></QUALIFIER.DECLARATION>"));
  EXPECT_EQ(ask("GetQualifier", value("QualifierName", "Nope")), error(6, "Nope"));
  EXPECT_THAT(ask("EnumerateQualifiers", ""),
              testing::AllOf(StartsWith("<IRETURNVALUE><QUALIFIER.DECLARATION NAME='Abstract'"),
                             HasSubstr("NAME='ValueMap' TYPE='string' ISARRAY='true'")));
}

TEST_F(CimXmlTest, Errors) {
  const char* const enumerate = "EnumerateInstances";
  const std::string disk = className("ClassName", "Test_Disk");
  const std::string key = "<INSTANCENAME CLASSNAME='A'><KEYVALUE>a</KEYVALUE></INSTANCENAME>";
  const struct {
    const char* operation;
    std::string parameters;
    int code;
    const char* description;
  } cases[] = {
      {"CreateClass", parameter("NewClass", "<CLASS NAME='X'/>"), 7, "CreateClass"},
      {enumerate, "", 4, "parameter ClassName is missing"},
      {enumerate, parameter("ClassName", ""), 4, "parameter ClassName is missing"},
      {enumerate, value("ClassName", "A"), 4, "parameter ClassName is no CLASSNAME"},
      {enumerate, className("ClassName", "1x"), 4,
       "parameter ClassName: The CIM name is not valid: 1x"},
      {enumerate, disk + value("Colour", "red"), 4, "the operation has no parameter Colour"},
      {enumerate, disk + className("classname", "X"), 4, "parameter classname is given twice"},
      {enumerate, disk + value("LocalOnly", "maybe"), 4,
       "parameter LocalOnly: &quot;maybe&quot; is neither true nor false"},
      {"GetInstance", parameter("InstanceName", key), 4,
       "parameter InstanceName: a key without a name is not understood"},
      {enumerate, className("ClassName", "Test_ThrowsStd"), 1, "std \xEF\xBF\xBD"},
  };
  for (const auto& row : cases) {
    const Reply reply = answer(intrinsic(row.operation, row.parameters));
    EXPECT_EQ(reply.status, 200);
    EXPECT_EQ(reply.result(), error(row.code, row.description));
    EXPECT_EQ(reply.summary.cimStatus, row.code);
  }
}

TEST_F(CimXmlTest, Namespaces) {
  const auto with = [&](const std::string& name, const char* operation = "EnumerateClassNames") {
    Request request = intrinsic(operation, "");
    request.headers["CIMObject"] = name;
    const std::string before = "<NAMESPACE NAME='root'/><NAMESPACE NAME='test'/>";
    request.text.replace(request.text.find(before), before.size(),
                         "<NAMESPACE NAME='" + name + "'/>");
    return answer(request).result();
  };
  EXPECT_EQ(with("root/nope"), error(3, "root/nope"));
  EXPECT_EQ(with("root//test"), error(3, "root//test"));
  EXPECT_THAT(with("ROOT/test"), StartsWith("<IRETURNVALUE><CLASSNAME"));  // in one element
  EXPECT_EQ(with("root/nope", "GetClass"), error(3, "root/nope"));  // before the missing class
}

TEST_F(CimXmlTest, LargeRepliesComeInPieces) {
  const Request many = intrinsic("EnumerateInstances", className("ClassName", "Test_Many"));
  const Reply reply = answer(many);
  EXPECT_EQ(reply.summary.objects, 2500u);
  EXPECT_GT(reply.pieces, 5u);
  EXPECT_THAT(reply.body, HasSubstr("<KEYVALUE VALUETYPE=\"string\">2499<"));
  const Reply left = answer(many, 1);
  EXPECT_EQ(left.pieces, 1u) << "nothing is written for a client that has gone";
  EXPECT_FALSE(left.aborted);
  const Reply failed =
      answer(intrinsic("EnumerateInstances", className("ClassName", "Test_ManyThrows")));
  EXPECT_EQ(failed.status, 200);
  EXPECT_TRUE(failed.aborted);
  EXPECT_EQ(failed.summary.cimStatus, 1);
  EXPECT_THAT(failed.body, testing::Not(HasSubstr("</IMETHODRESPONSE>")));
}

}  // namespace
}  // namespace cimhost::test
