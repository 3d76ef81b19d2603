#include "tests/cimhost/TestModel.h"

#include <Pegasus/Common/CIMMethod.h>

namespace cimhost::test {

using namespace Pegasus;

bool RecordingSink::deliverInstance(const CIMInstance& instance) {
  String name;
  const Uint32 position = instance.findProperty(CIMName("Name"));
  if (position != PEG_NOT_FOUND) instance.getProperty(position).getValue().get(name);
  names.push_back(toUtf8(name));
  instances.push_back(instance);
  return true;
}

bool RecordingSink::deliverPath(const CIMObjectPath& path) {
  names.push_back(toUtf8(path.toString()));
  return true;
}

bool RecordingSink::deliverClass(const CIMClass& declaration) {
  classes.push_back(declaration);
  return deliverClassName(declaration.getClassName());
}

bool RecordingSink::deliverClassName(const CIMName& name) {
  names.push_back(toUtf8(name.getString()));
  return true;
}

bool RecordingSink::deliverMethodResult(const CIMValue& returned,
                                        const Array<CIMParamValue>& parameters) {
  returnValue = returned.isNull() ? "null" : toUtf8(returned.toString());
  for (Uint32 i = 0; i < parameters.size(); ++i) {
    names.push_back(toUtf8(parameters[i].getParameterName()) + "=" +
                    toUtf8(parameters[i].getValue().toString()));
  }
  return true;
}

CIMClass makeClass(const std::string& name, const std::string& superclass,
                   const std::vector<std::string>& properties) {
  CIMClass declaration(CIMName(name.c_str()),
                       superclass.empty() ? CIMName() : CIMName(superclass.c_str()));
  for (const std::string& each : properties) {
    const CIMType type = each == "Size" ? CIMTYPE_UINT64 : CIMTYPE_STRING;
    CIMProperty property(CIMName(each.c_str()), CIMValue(type, false));
    if (each == "Name") property.addQualifier(CIMQualifier(CIMName("Key"), CIMValue(true)));
    declaration.addProperty(property);
  }
  return declaration;
}

CIMClass makeAssociation(const std::string& name, const std::string& superclass,
                         const std::vector<std::pair<const char*, const char*>>& ends) {
  CIMClass declaration = makeClass(name, superclass, {});
  if (superclass.empty()) {
    declaration.addQualifier(CIMQualifier(CIMName("Association"), CIMValue(true)));
  }
  for (const auto& [role, className] : ends) {
    CIMProperty reference(CIMName(role), CIMValue(CIMTYPE_REFERENCE, false), 0, CIMName(className));
    reference.addQualifier(CIMQualifier(CIMName("Key"), CIMValue(true)));
    declaration.addProperty(reference);
  }
  return declaration;
}

CIMObjectPath pathOf(const std::string& className) {
  return CIMObjectPath(String((className + ".Name=\"a\"").c_str()));
}

CIMPropertyList listOf(const std::vector<const char*>& names) {
  Array<CIMName> list;
  for (const char* name : names) list.append(CIMName(name));
  return CIMPropertyList(list);
}

std::string textOf(const OperationStatus& status) {
  return std::to_string(static_cast<int>(status.code)) + " " + status.message;
}

// Disks have well-behaved links, Test_Odd the others.
void TestHost::addAssociations() {
  repository.addClass(kNamespace, makeClass("Test_Port", "", {"Name"}));
  repository.addClass(kNamespace, makeClass("Test_FastPort", "Test_Port", {}));
  repository.addClass(kNamespace, makeClass("Test_Odd", "", {"Name"}));
  repository.addClass(
      kNamespace, makeAssociation("Link_Port", "", {{"Disk", "Test_Disk"}, {"Port", "Test_Port"}}));
  repository.addClass(kNamespace, makeAssociation("Link_FastPort", "Link_Port", {}));
  repository.addClass(
      kNamespace,
      makeAssociation("Link_Copy", "", {{"Original", "Test_Base"}, {"Copy", "Test_Base"}}));
  repository.addClass(
      kNamespace, makeAssociation("Link_Unserved", "", {{"A", "Test_Disk"}, {"B", "Test_Port"}}));
  std::vector<std::string> links = {"Link_Port", "Link_FastPort", "Link_Copy"};
  for (const char* name : {"Link_Echo", "Link_NoComplete", "Link_ThrowsNotSupported",
                           "Link_ThrowsCim", "Link_Class"}) {
    repository.addClass(kNamespace,
                        makeAssociation(name, "", {{"Odd", "Test_Odd"}, {"Port", "Test_Port"}}));
    links.push_back(name);
  }
  for (const std::string& name : links) {
    served.add({kNamespace, CIMName(name.c_str()), true, false, "test.xml", {}});
  }
}

TestHost::TestHost(const std::string& providerName) {
  repository.addNamespace(kNamespace);
  CIMClass base = makeClass("Test_Base", "", {"Name"});
  base.addMethod(CIMMethod(CIMName("Format"), CIMTYPE_UINT32));
  repository.addClass(kNamespace, base);
  repository.addClass(kNamespace, makeClass("Test_Unserved", "Test_Base", {"Size"}));
  repository.addClass(kNamespace, makeClass("Test_Disk", "Test_Base", {"Text"}));
  repository.addClass(kNamespace, makeClass("Test_BigDisk", "Test_Disk", {"Size"}));
  for (const char* name : {"Test_Array",         "Test_Nothing",
                           "Test_OnlyCompletes", "Test_NoComplete",
                           "Test_LateDelivery",  "Test_TwoBatches",
                           "Test_ThrowsCim",     "Test_ThrowsSuccess",
                           "Test_ThrowsOddCode", "Test_ThrowsNotSupported",
                           "Test_ThrowsPegasus", "Test_ThrowsStd",
                           "Test_ThrowsInt",     "Test_Uninitialized",
                           "Test_Many",          "Test_ManyNoComplete",
                           "Test_ManyThrows",    "Test_Swallows",
                           "Test_ServerDisks",   "Test_Nested",
                           "Test_NoNamespace",   "Test_EchoPath",
                           "Test_Memory"}) {
    repository.addClass(kNamespace, makeClass(name, "", {"Name", "Size"}));
    served.add({kNamespace, CIMName(name), false, false, "test.xml", {}});
  }
  served.add({kNamespace, CIMName("Test_Disk"), false, true, "test.xml", {}});
  served.add({CIMNamespaceName(), CIMName("Test_BigDisk"), false, false, "test.xml", {}});
  addAssociations();
  setEmbeddedHost(&cimom);
  handle_ = new CIMOMHandle;
  provider.load(TEST_PROVIDER_FILE, providerName, *handle_);
}

TestHost::~TestHost() {
  provider.unload();
  delete handle_;
  setEmbeddedHost(nullptr);
}

}  // namespace cimhost::test
