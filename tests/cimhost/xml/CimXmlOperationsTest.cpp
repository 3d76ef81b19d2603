// Every operation, as literal XML.

#include "tests/cimhost/xml/CimXmlTestSupport.h"

namespace cimhost::test {
namespace {

const std::string kPathA =
    "<INSTANCENAME CLASSNAME=\"Test_Disk\"><KEYBINDING NAME=\"Name\">"
    "<KEYVALUE VALUETYPE=\"string\">a</KEYVALUE></KEYBINDING></INSTANCENAME>";
const std::string kNameOfA = "<PROPERTY NAME=\"Name\" TYPE=\"string\"><VALUE>a</VALUE></PROPERTY>";
const std::string kSize = "<PROPERTY NAME=\"Size\" TYPE=\"uint64\"><VALUE>7</VALUE></PROPERTY>";

std::string error(int code, const std::string& description) {
  return "<ERROR CODE=\"" + std::to_string(code) + "\" DESCRIPTION=\"" + description + "\"/>";
}

std::string returned(const std::string& elements) {
  return "<IRETURNVALUE>" + elements + "</IRETURNVALUE>";
}

TEST_F(CimXmlTest, AWholeReply) {
  const Reply reply =
      answer(intrinsic("GetInstance", instanceName("InstanceName", "Test_BigDisk", "a") +
                                          value("LocalOnly", "FALSE")));
  EXPECT_EQ(reply.status, 200);
  EXPECT_EQ(reply.headers.at("Content-Type"), "application/xml; charset=\"utf-8\"");
  EXPECT_EQ(reply.headers.at("CIMOperation"), "MethodResponse");
  const std::string head =
      "<?xml version=\"1.0\" encoding=\"utf-8\" ?>\n"
      "<CIM CIMVERSION=\"2.0\" DTDVERSION=\"2.0\">\n"
      "<MESSAGE ID=\"42\" PROTOCOLVERSION=\"1.0\">\n<SIMPLERSP>\n"
      "<IMETHODRESPONSE NAME=\"GetInstance\">\n<IRETURNVALUE>\n";
  const std::string tail =
      "\n</IRETURNVALUE>\n</IMETHODRESPONSE>\n</SIMPLERSP>\n</MESSAGE>\n</CIM>\n";
  EXPECT_EQ(reply.body,
            head + "<INSTANCE CLASSNAME=\"Test_BigDisk\">" +
                "<PROPERTY NAME=\"Name\" TYPE=\"string\"><VALUE>big</VALUE></PROPERTY>" + kSize +
                "</INSTANCE>" + tail);
  EXPECT_EQ(reply.summary.operation, "GetInstance");
  EXPECT_EQ(reply.summary.target, "root/test:Test_BigDisk");
  EXPECT_EQ(reply.summary.objects, 1u);
  EXPECT_EQ(reply.summary.cimStatus, 0);
}

TEST_F(CimXmlTest, Instances) {
  const std::string namedA = "<VALUE.NAMEDINSTANCE>" + kPathA +
                             "<INSTANCE CLASSNAME=\"Test_Disk\">" + kNameOfA + kSize +
                             "</INSTANCE></VALUE.NAMEDINSTANCE>";
  const std::string all =
      ask("EnumerateInstances", className("ClassName", "Test_Disk") + value("LocalOnly", "false"));
  EXPECT_EQ(all.find(returned("").substr(0, 14) + namedA), 0u) << all;
  EXPECT_NE(all.find("CLASSNAME=\"Test_BigDisk\""), std::string::npos) << "subclasses too";
  EXPECT_EQ(ask("EnumerateInstances", className("ClassName", "Test_OnlyCompletes")), returned(""));
  EXPECT_EQ(ask("GetInstance", instanceName("InstanceName", "Test_BigDisk", "a")),
            returned("<INSTANCE CLASSNAME=\"Test_BigDisk\">" + kSize + "</INSTANCE>"))
      << "LocalOnly is true by default, and the key is inherited";
  EXPECT_EQ(ask("getinstance",
                instanceName("instancename", "Test_BigDisk", "a") + value("LOCALONLY", "FALSE") +
                    value("IncludeQualifiers", "TRUE") + value("IncludeClassOrigin", "TRUE") +
                    "<IPARAMVALUE NAME=\"PropertyList\"><VALUE.ARRAY>"
                    "<VALUE>NAME</VALUE></VALUE.ARRAY></IPARAMVALUE>"),
            returned("<INSTANCE CLASSNAME=\"Test_BigDisk\"><PROPERTY NAME=\"Name\" TYPE=\"string\" "
                     "CLASSORIGIN=\"Test_Base\"><QUALIFIER NAME=\"Key\" TYPE=\"boolean\" "
                     "OVERRIDABLE=\"false\" TOSUBCLASS=\"false\"><VALUE>TRUE</VALUE></QUALIFIER>"
                     "<VALUE>big</VALUE></PROPERTY></INSTANCE>"));
  EXPECT_EQ(ask("EnumerateInstanceNames", className("ClassName", "Test_Array")),
            returned("<INSTANCENAME CLASSNAME=\"Test_Array\"><KEYBINDING NAME=\"Name\"><KEYVALUE "
                     "VALUETYPE=\"string\">n</KEYVALUE></KEYBINDING></INSTANCENAME>"
                     "<INSTANCENAME CLASSNAME=\"Test_Array\"></INSTANCENAME>"));
}

TEST_F(CimXmlTest, Changes) {
  const std::string memory = instanceName("InstanceName", "Test_Memory", "m");
  EXPECT_EQ(ask("SetProperty", memory + value("PropertyName", "size") + value("NewValue", "0x10")),
            "");
  EXPECT_EQ(ask("GetProperty", memory + value("PropertyName", "SIZE")),
            returned("<VALUE>16</VALUE>"));
  EXPECT_EQ(ask("GetProperty", memory + value("PropertyName", "Name")), returned(""))
      << "not delivered: null";
  EXPECT_EQ(ask("SetProperty", memory + value("PropertyName", "Size")), "");
  EXPECT_EQ(ask("GetProperty", memory + value("PropertyName", "Size")), returned("")) << "null";
  EXPECT_EQ(ask("GetProperty", memory + value("PropertyName", "Nope")), error(12, "Nope"));
  EXPECT_EQ(ask("SetProperty", memory + value("PropertyName", "Nope") + value("NewValue", "1")),
            error(12, "Nope"));
  EXPECT_EQ(ask("SetProperty", memory + value("PropertyName", "Size") + value("NewValue", "many")),
            error(13, "parameter NewValue: &quot;many&quot; is not an integer"));
  EXPECT_EQ(ask("CreateInstance",
                "<IPARAMVALUE NAME=\"NewInstance\"><INSTANCE CLASSNAME=\"Test_Array\"/>"
                "</IPARAMVALUE>"),
            returned("<INSTANCENAME CLASSNAME=\"Test_Array\"><KEYBINDING NAME=\"Name\"><KEYVALUE "
                     "VALUETYPE=\"string\">new</KEYVALUE></KEYBINDING></INSTANCENAME>"));
  EXPECT_EQ(ask("DeleteInstance", instanceName("InstanceName", "Test_ThrowsNotSupported", "x")),
            error(7, "no"));
  EXPECT_EQ(ask("DeleteInstance", instanceName("InstanceName", "Test_Array", "x")), "");
}

TEST_F(CimXmlTest, Associations) {
  const std::string disk = instanceName("ObjectName", "Test_Disk", "a");
  const std::string port = className("ResultClass", "Test_FastPort");
  const std::string hostName = toUtf8(host.operations.hostName());
  const std::string place = "<INSTANCEPATH><NAMESPACEPATH><HOST>" + hostName +
                            "</HOST><LOCALNAMESPACEPATH><NAMESPACE NAME=\"root\"/><NAMESPACE "
                            "NAME=\"test\"/></LOCALNAMESPACEPATH></NAMESPACEPATH>";
  const std::string names = ask("AssociatorNames", disk + className("AssocClass", "Link_FastPort"));
  EXPECT_EQ(names.find(returned("").substr(0, 14) + "<OBJECTPATH>" + place), 0u) << names;
  const std::string objects = ask("Associators", disk + port);
  EXPECT_EQ(objects.find(returned("").substr(0, 14) + "<VALUE.OBJECTWITHPATH>" + place), 0u)
      << objects;
  EXPECT_NE(objects.find("</INSTANCEPATH><INSTANCE CLASSNAME=\"Test_FastPort\"><PROPERTY"),
            std::string::npos)
      << objects;
  const std::string links = ask("ReferenceNames", disk + className("ResultClass", "Link_Port"));
  EXPECT_NE(links.find("<INSTANCENAME CLASSNAME=\"Link_Port\">"), std::string::npos) << links;
  EXPECT_NE(ask("References", disk + value("Role", "Disk")).find("<INSTANCE CLASSNAME=\"Link_Port"),
            std::string::npos);
  EXPECT_EQ(ask("Associators", disk + className("AssocClass", "Nope")), error(4, "Nope"));
}

TEST_F(CimXmlTest, Classes) {
  EXPECT_EQ(ask("EnumerateClassNames", className("ClassName", "Test_Base")),
            returned("<CLASSNAME NAME=\"Test_Unserved\"/><CLASSNAME NAME=\"Test_Disk\"/>"));
  EXPECT_EQ(ask("GetClass", className("ClassName", "test_disk")),
            returned("<CLASS NAME=\"Test_Disk\" SUPERCLASS=\"Test_Base\">"
                     "<PROPERTY NAME=\"Text\" TYPE=\"string\"></PROPERTY></CLASS>"));
  const std::string whole =
      ask("GetClass", className("ClassName", "Test_Disk") + value("LocalOnly", "FALSE") +
                          value("IncludeClassOrigin", "TRUE"));
  EXPECT_EQ(whole,
            returned("<CLASS NAME=\"Test_Disk\" SUPERCLASS=\"Test_Base\"><PROPERTY NAME=\"Name\" "
                     "TYPE=\"string\" CLASSORIGIN=\"Test_Base\" PROPAGATED=\"true\"><QUALIFIER "
                     "NAME=\"Key\" TYPE=\"boolean\" PROPAGATED=\"true\" OVERRIDABLE=\"false\">"
                     "<VALUE>TRUE</VALUE></QUALIFIER></PROPERTY><PROPERTY NAME=\"Text\" "
                     "TYPE=\"string\" CLASSORIGIN=\"Test_Disk\"></PROPERTY><METHOD NAME=\"Format\" "
                     "TYPE=\"uint32\" CLASSORIGIN=\"Test_Base\" PROPAGATED=\"true\"></METHOD>"
                     "</CLASS>"));
  const std::string link = ask("EnumerateClasses", className("ClassName", "Link_Port"));
  EXPECT_EQ(link.find(returned("").substr(0, 14) +
                      "<CLASS NAME=\"Link_FastPort\" SUPERCLASS=\"Link_Port\">"),
            0u)
      << link;
  EXPECT_NE(ask("GetClass", className("ClassName", "Link_Port"))
                .find("<PROPERTY.REFERENCE NAME=\"Disk\" REFERENCECLASS=\"Test_Disk\">"),
            std::string::npos);
  EXPECT_EQ(ask("GetClass", className("ClassName", "Nope")), error(6, "Nope"));
}

TEST_F(CimXmlTest, Qualifiers) {
  EXPECT_EQ(ask("GetQualifier", value("QualifierName", "key")),
            returned("<QUALIFIER.DECLARATION NAME=\"Key\" TYPE=\"boolean\" ISARRAY=\"false\" "
                     "OVERRIDABLE=\"false\"><SCOPE REFERENCE=\"true\" PROPERTY=\"true\"></SCOPE>"
                     "<VALUE>FALSE</VALUE></QUALIFIER.DECLARATION>"));
  EXPECT_EQ(ask("GetQualifier", value("QualifierName", "Nope")), error(6, "Nope"));
  const std::string all = ask("EnumerateQualifiers", "");
  EXPECT_EQ(all.find(returned("").substr(0, 14) + "<QUALIFIER.DECLARATION NAME=\"Abstract\""), 0u);
  EXPECT_NE(all.find("NAME=\"ValueMap\" TYPE=\"string\" ISARRAY=\"true\""), std::string::npos);
}

struct ErrorCase {
  const char* name;
  const char* operation;
  std::string parameters;
  std::string expected;
};

class CimXmlError : public CimXmlTest, public testing::WithParamInterface<ErrorCase> {};

TEST_P(CimXmlError, IsAnErrorElement) {
  const Reply reply = answer(intrinsic(GetParam().operation, GetParam().parameters));
  EXPECT_EQ(reply.status, 200);
  EXPECT_EQ(reply.result(), GetParam().expected);
  EXPECT_EQ(reply.summary.objects, 0u);
  EXPECT_NE(reply.summary.cimStatus, 0);
}

std::string errorName(const testing::TestParamInfo<ErrorCase>& info) {
  return info.param.name;
}

const std::string kClass = className("ClassName", "Test_Disk");

INSTANTIATE_TEST_SUITE_P(
    Errors, CimXmlError,
    testing::Values(
        ErrorCase{"Pull", "OpenEnumerateInstances", kClass, error(7, "OpenEnumerateInstances")},
        ErrorCase{"Unknown", "Frobnicate", "", error(7, "Frobnicate")},
        ErrorCase{"CreateClass", "CreateClass",
                  "<IPARAMVALUE NAME=\"NewClass\"><CLASS NAME=\"X\"/></IPARAMVALUE>",
                  error(7, "CreateClass")},
        ErrorCase{"NoClass", "EnumerateInstances", className("ClassName", "Nope"),
                  error(5, "Nope")},
        ErrorCase{"ClassMissing", "EnumerateInstances", "",
                  error(4, "parameter ClassName is missing")},
        ErrorCase{"ClassNull", "EnumerateInstances", "<IPARAMVALUE NAME=\"ClassName\"/>",
                  error(4, "parameter ClassName is missing")},
        ErrorCase{"ClassAsText", "EnumerateInstances", value("ClassName", "Test_Disk"),
                  error(4, "parameter ClassName is no CLASSNAME")},
        ErrorCase{"IllegalName", "EnumerateInstances", className("ClassName", "1x"),
                  error(4, "parameter ClassName: The CIM name is not valid: 1x")},
        ErrorCase{"UnknownParameter", "EnumerateInstances", kClass + value("Colour", "red"),
                  error(4, "the operation has no parameter Colour")},
        ErrorCase{"TwiceGiven", "EnumerateInstances", kClass + className("classname", "X"),
                  error(4, "parameter classname is given twice")},
        ErrorCase{"NoBoolean", "EnumerateInstances", kClass + value("LocalOnly", "maybe"),
                  error(4, "parameter LocalOnly: &quot;maybe&quot; is neither true nor false")},
        ErrorCase{"OldKeyForm", "GetInstance",
                  "<IPARAMVALUE NAME=\"InstanceName\"><INSTANCENAME CLASSNAME=\"Test_Disk\">"
                  "<KEYVALUE>a</KEYVALUE></INSTANCENAME></IPARAMVALUE>",
                  error(4, "parameter InstanceName: a key without a name is not understood")},
        ErrorCase{"FromProvider", "EnumerateInstances", className("ClassName", "Test_ThrowsCim"),
                  error(2, "not for you")},
        ErrorCase{"NotUtf8", "EnumerateInstances", className("ClassName", "Test_ThrowsStd"),
                  error(1, "std \xEF\xBF\xBD")},
        ErrorCase{"UnnamedNoObject", "GetInstance", instanceName("InstanceName", "Nope", "a"),
                  error(5, "Nope")}),
    errorName);

TEST_F(CimXmlTest, Namespaces) {
  Request request = intrinsic("EnumerateClassNames", "");
  const auto with = [&](const std::string& name) {
    Request changed = request;
    changed.headers["CIMObject"] = name;
    const std::string before = "<NAMESPACE NAME=\"root\"/><NAMESPACE NAME=\"test\"/>";
    changed.text.replace(changed.text.find(before), before.size(),
                         "<NAMESPACE NAME=\"" + name + "\"/>");
    return answer(changed).result();
  };
  EXPECT_EQ(with("root/nope"), error(3, "root/nope"));
  EXPECT_EQ(with("root//test"), error(3, "root//test"));
  EXPECT_EQ(with("ROOT/test").find("<IRETURNVALUE><CLASSNAME"), 0u) << "in one element";
}

TEST_F(CimXmlTest, UserReachesTheProvider) {
  host.repository.addClass(kNamespace, makeClass("Test_User", "", {"Name", "Size"}));
  host.served.add({kNamespace, Pegasus::CIMName("Test_User"), false, false, "test.xml", {}});
  Request request = intrinsic("EnumerateInstances", className("ClassName", "Test_User"));
  request.who = "j\xC3\xBCrg";
  EXPECT_NE(answer(request).body.find("<VALUE>j\xC3\xBCrg</VALUE>"), std::string::npos);
}

TEST_F(CimXmlTest, LargeRepliesComeInPieces) {
  const Request many = intrinsic("EnumerateInstances", className("ClassName", "Test_Many"));
  const Reply reply = answer(many);
  EXPECT_EQ(reply.summary.objects, 2500u);
  EXPECT_GT(reply.pieces, 5u);
  EXPECT_NE(reply.body.find("<KEYVALUE VALUETYPE=\"string\">2499<"), std::string::npos);
  const Reply left = answer(many, 1);
  EXPECT_EQ(left.pieces, 1u) << "nothing is written for a client that has gone";
  EXPECT_FALSE(left.aborted);
}

TEST_F(CimXmlTest, FailureAfterTheFirstPieceCutsTheReplyOff) {
  const Reply reply =
      answer(intrinsic("EnumerateInstances", className("ClassName", "Test_ManyThrows")));
  EXPECT_EQ(reply.status, 200);
  EXPECT_TRUE(reply.aborted);
  EXPECT_EQ(reply.summary.cimStatus, 1);
  EXPECT_EQ(reply.body.find("</IMETHODRESPONSE>"), std::string::npos);
}

}  // namespace
}  // namespace cimhost::test
