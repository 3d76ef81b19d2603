#include "definition/ModuleElement.h"

#include "diagnostics/debug.h"
#include "engine/ProviderDefFunctionCall.h"
#include "engine/ProviderDefModule.h"
#include "engine/Registry.h"

#include <cstdint>

ProviderDefModule::ProviderDefModule(const char* text, int length, int* consumed)
    : firstFunction_(functionCount()) {
  ElementReader reader(text, length);
  readOrDetach(reader);
  *consumed = reader.consumed();
}

ProviderDefModule::ProviderDefModule(ElementReader& reader) : firstFunction_(functionCount()) {
  readOrDetach(reader);
}

void ProviderDefModule::readOrDetach(ElementReader& reader) {
  try {
    read(reader);
  } catch (...) {
    detachFunctions();
    throw;
  }
}

void ProviderDefModule::read(ElementReader& reader) {
  debug(9, "ProviderDefModule Constructor\n");
  reader.retrace();
  withContext("module", name_, [&] {
    for (const auto& [key, value] : reader.unit().getAttributes()) {
      if (key == "name") name_ = value;
      if (key == "path" && value == "short") path_ = kShort;
    }
    if (reader.isEmptyElement()) return;
    reader.advance();
    if (reader.isStart("functioncall")) {
      setInit(keepInitCall(std::make_unique<ProviderDefFunctionCall>(reader, this)));
      DEBUG_FORMAT(7, "setting needInit=true, init : %lx\n",
                   static_cast<unsigned long>(reinterpret_cast<std::uintptr_t>(init_)));
      reader.advance();
    }
    reader.expectEnd("module", "the end of module element missing before: ");
  });
}

ProviderDefModule* readModule(ElementReader& reader) {
  const size_t firstFunction = functionCount();
  auto read = std::make_unique<ProviderDefModule>(reader);
  reader.advance();
  ProviderDefModule* registered = getModule(read->getName());
  if (registered == nullptr) return registerModule(std::move(read));
  if (!registered->getNeedInit() && read->getNeedInit()) registered->setInit(read->getInit());
  replaceModule(read.get(), registered, firstFunction);
  return registered;
}
