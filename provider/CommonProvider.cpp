#include "provider/CommonProvider.h"

#include "definition/DefinitionFile.h"
#include "engine/Registry.h"

#include <Pegasus/Common/Exception.h>

#include <dirent.h>

#include <cstring>
#include <memory>

using namespace Pegasus;

namespace Vaneth {
namespace {

// The one text of every operation that the provider refuses, whichever it is.
const char kRefusal[] = "CommonProvider::deleteInstance";

[[noreturn]] void refuse() {
  throw CIMException(CIM_ERR_NOT_SUPPORTED, String(kRefusal));
}

}  // namespace

CommonProvider::CommonProvider() = default;
CommonProvider::~CommonProvider() = default;

void CommonProvider::initialize(CIMOMHandle& cimom) {
  cimom_ = &cimom;
  const auto close = [](DIR* open) { closedir(open); };
  const std::unique_ptr<DIR, decltype(close)> directory(opendir("."), close);
  if (!directory) return;
  while (const dirent* entry = readdir(directory.get())) {
    // Anywhere in the name, not only at its end.
    if (std::strstr(entry->d_name, ".xml") != nullptr) readProviderDefXML(entry->d_name);
  }
}

void CommonProvider::terminate() {
  releaseFunctions();
  releaseModules();
  // The server drops its pointer without deleting the object.
  delete this;
}

void CommonProvider::createInstance(const OperationContext&, const CIMObjectPath&,
                                    const CIMInstance&, ObjectPathResponseHandler&) {
  refuse();
}

void CommonProvider::deleteInstance(const OperationContext&, const CIMObjectPath&,
                                    ResponseHandler&) {
  refuse();
}

void CommonProvider::references(const OperationContext&, const CIMObjectPath&, const CIMName&,
                                const String&, const Boolean, const Boolean, const CIMPropertyList&,
                                ObjectResponseHandler&) {
  refuse();
}

void CommonProvider::referenceNames(const OperationContext&, const CIMObjectPath&, const CIMName&,
                                    const String&, ObjectPathResponseHandler&) {
  refuse();
}

}  // namespace Vaneth

extern "C" PEGASUS_EXPORT CIMProvider* PegasusCreateProvider(const String& providerName) {
  if (!String::equalNoCase(providerName, "CommonProvider")) return nullptr;
  return new Vaneth::CommonProvider();
}
