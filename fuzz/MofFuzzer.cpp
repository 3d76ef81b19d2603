// Any bytes as a MOF file; what it declares is then written as MOF and as CIM-XML.

#include "cimhost/mof/MofReader.h"
#include "cimhost/output/MofText.h"
#include "cimhost/output/XmlText.h"
#include "fuzz/FuzzCheck.h"

#include <strings.h>
#include <cstdint>

namespace {

using namespace cimhost;

// The file system is out of bounds: no directive names a file.
std::string withoutIncludes(std::string text) {
  for (std::size_t i = 0; i + 7 <= text.size(); ++i) {
    if (strncasecmp(text.data() + i, "include", 7) == 0) text[i] = 'e';
  }
  return text;
}

void writeClass(const ClassRepository& repository, const Pegasus::CIMNamespaceName& nameSpace,
                const Pegasus::CIMName& name) {
  const Pegasus::CIMClass declaration =
      repository.getClass(nameSpace, name, false, true, true, Pegasus::CIMPropertyList());
  check(!mofClass(declaration).empty(), "a class without a text");
  XmlBuffer xml;
  appendClass(xml, declaration);
  checkWellFormed(xml.view());
}

}  // namespace

extern "C" int LLVMFuzzerTestOneInput(const std::uint8_t* data, std::size_t size) {
  ClassRepository repository;
  MofReader reader(repository);
  const std::string text = withoutIncludes({reinterpret_cast<const char*>(data), size});
  const bool good = reader.readText(text, "fuzz.mof", Pegasus::CIMNamespaceName("root/fuzz"));
  check(good == reader.diagnostics().empty(), "a failure without a diagnostic");
  for (const auto& diagnostic : reader.diagnostics()) {
    check(!diagnostic.toString().empty(), "an empty diagnostic");
  }
  for (const Pegasus::CIMNamespaceName& nameSpace : repository.namespaces()) {
    for (const Pegasus::CIMName& name :
         repository.subclassNames(nameSpace, Pegasus::CIMName(), true)) {
      writeClass(repository, nameSpace, name);
    }
  }
  return 0;
}
