#include "tests/cimhost/TestModel.h"

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

TestHost::TestHost(const std::string& providerName) {
  repository.addNamespace(kNamespace);
  repository.addClass(kNamespace, makeClass("Test_Base", "", {"Name"}));
  repository.addClass(kNamespace, makeClass("Test_Unserved", "Test_Base", {"Size"}));
  repository.addClass(kNamespace, makeClass("Test_Disk", "Test_Base", {"Text"}));
  repository.addClass(kNamespace, makeClass("Test_BigDisk", "Test_Disk", {"Size"}));
  for (const char* name : {"Test_Array",         "Test_Nothing",       "Test_OnlyCompletes",
                           "Test_NoComplete",    "Test_LateDelivery",  "Test_TwoBatches",
                           "Test_ThrowsCim",     "Test_ThrowsSuccess", "Test_ThrowsNotSupported",
                           "Test_ThrowsPegasus", "Test_ThrowsStd",     "Test_ThrowsInt",
                           "Test_Uninitialized", "Test_Many",          "Test_ManyNoComplete",
                           "Test_ManyThrows",    "Test_Swallows",      "Test_ServerDisks",
                           "Test_Nested",        "Test_NoNamespace",   "Test_EchoPath"}) {
    repository.addClass(kNamespace, makeClass(name, "", {"Name", "Size"}));
    served.add({kNamespace, CIMName(name), false, false, "test.xml", {}});
  }
  served.add({kNamespace, CIMName("Test_Disk"), false, false, "test.xml", {}});
  served.add({CIMNamespaceName(), CIMName("Test_BigDisk"), false, false, "test.xml", {}});
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
