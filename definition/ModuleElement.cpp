#include "definition/ModuleElement.h"

#include "diagnostics/debug.h"
#include "engine/ProviderDefFunctionCall.h"
#include "engine/ProviderDefModule.h"
#include "engine/Registry.h"

#include <cstdint>

void ProviderDefModule::parse(const char* text, int length, int* consumed) {
  debug(9, "ProviderDefModule Constructor\n");
  withContext("module", name_, [&] {
    ElementReader reader(text, length);
    for (const auto& [key, value] : reader.unit().getAttributes()) {
      if (key == "name") name_ = value;
      if (key == "path") path_ = value == "short" ? kShort : kFull;
    }
    if (!reader.isEmptyElement()) {
      reader.advance();
      if (reader.isStart("functioncall")) {
        int used = 0;
        setInit(keepInitCall(std::make_unique<ProviderDefFunctionCall>(
            reader.rest(), reader.restLength(), &used, this)));
        DEBUG_FORMAT(7, "setting needInit=true, init : %lx\n",
                     static_cast<unsigned long>(reinterpret_cast<std::uintptr_t>(init_)));
        reader.skip(used);
      }
      reader.expectEnd("module", "the end of module element missing before: ");
    }
    *consumed = reader.consumed();
  });
}

ProviderDefModule* readModule(ElementReader& reader) {
  const size_t firstFunction = functionCount();
  int used = 0;
  auto read = std::make_unique<ProviderDefModule>(reader.rest(), reader.restLength(), &used);
  reader.skip(used);
  ProviderDefModule* registered = getModule(read->getName());
  if (registered == nullptr) return registerModule(std::move(read));
  if (!registered->getNeedInit() && read->getNeedInit()) registered->setInit(read->getInit());
  replaceModule(read.get(), registered, firstFunction);
  return registered;
}
