#include "tests/cimhost/TestModel.h"

#include "cimhost/mof/MofReader.h"

#include <sstream>
#include <stdexcept>

namespace cimhost::test {

using namespace Pegasus;

CIMClass readClass(const std::string& mof, const char* name) {
  ClassRepository repository;
  MofReader reader(repository);
  if (!reader.readText(mof, "test.mof", kNamespace)) throw std::runtime_error("malformed MOF");
  return repository.getClass(kNamespace, name, false, true, true, {});
}

namespace {

// Disks have well-behaved links, Test_Odd the others.
constexpr const char* kClasses = R"(
class Test_Base { [Key] string Name; uint32 Format(); };
class Test_Unserved : Test_Base { uint64 Size; };
class Test_Disk : Test_Base { string Text; };
class Test_BigDisk : Test_Disk { uint64 Size; };
class Test_Port { [Key] string Name; };
class Test_FastPort : Test_Port {};
class Test_Odd { [Key] string Name; };
class Test_Typed {
  [Key] string Name;
  [Key(false)] uint8 Size = 5;
  uint32 Take(uint8 Count, string Names[2], Test_Disk REF Ref, Test_Disk REF Refs[]);
};
[Association] class Link_Port { [Key] Test_Disk REF Disk; [Key] Test_Port REF Port; };
class Link_FastPort : Link_Port {};
[Association] class Link_Copy { [Key] Test_Base REF Original; [Key] Test_Base REF Copy; };
[Association] class Link_Half { [Key] Test_Disk REF Disk; };
[Association] class Link_Unserved { [Key] Test_Disk REF A; [Key] Test_Port REF B; };
)";

// Plain ones, and odd links.
constexpr const char* kNames =
    "Test_Array Test_Nothing Test_OnlyCompletes Test_NoComplete Test_LateDelivery Test_TwoBatches "
    "Test_ThrowsCim Test_ThrowsSuccess Test_ThrowsOddCode Test_ThrowsNotSupported "
    "Test_ThrowsPegasus Test_ThrowsStd Test_ThrowsInt Test_Uninitialized Test_Many "
    "Test_ManyNoComplete Test_ManyThrows Test_Swallows Test_ServerDisks Test_Nested "
    "Test_NoNamespace Test_EchoPath Test_Memory Test_User Link_Echo Link_NoComplete "
    "Link_ThrowsNotSupported Link_ThrowsCim Link_Class";

}  // namespace

TestHost::TestHost(const std::string& providerName) {
  std::string mof = kClasses;
  for (const char* name : {"Link_Port", "Link_FastPort", "Link_Copy", "Link_Half"})
    serve(name, true);
  std::istringstream names(kNames);
  for (std::string name; names >> name;) {
    const bool link = name[0] == 'L';
    mof += (link ? "[Association] class " : "class ") + name +
           (link ? " { [Key] Test_Odd REF Odd; [Key] Test_Port REF Port; };\n"
                 : " { [Key] string Name; uint64 Size; };\n");
    serve(name.c_str(), link);
  }
  serve("Test_Disk", false, true);
  serve("Test_Typed", false, true);
  served.add({CIMNamespaceName(), "Test_BigDisk", false, false, "test.xml", {}});
  MofReader reader(repository);
  if (!reader.readText(mof, "test.mof", kNamespace)) throw std::runtime_error("malformed MOF");
  setEmbeddedHost(&cimom);
  handle_ = new CIMOMHandle;
  provider.load(TEST_PROVIDER_FILE, providerName, *handle_);
}

void TestHost::serve(const char* name, bool association, bool methods) {
  served.add({kNamespace, name, association, methods, "test.xml", {}});
}

TestHost::~TestHost() {
  provider.unload();
  delete handle_;
  setEmbeddedHost(nullptr);
}

}  // namespace cimhost::test
