#include "definition/DefinitionFile.h"

#include "definition/DefinitionRegistry.h"
#include "definition/ElementReader.h"
#include "definition/ModuleElement.h"
#include "diagnostics/debug.h"

#include <sys/stat.h>

#include <cerrno>
#include <cstdio>
#include <cstring>
#include <memory>

namespace definition {
namespace {

constexpr off_t kMaxFileSize = off_t{64} * 1024 * 1024;

using RegisterElement = void (*)(ElementReader&, ProviderDefModule*);

void readElements(ElementReader& reader, const char* name, RegisterElement registerElement,
                  ProviderDefModule* module) {
  while (reader.isStart(name)) {
    registerElement(reader, module);
    reader.advance();
  }
}

}  // namespace

std::string loadFile(const std::string& name, std::string& error) {
  struct stat status {};
  // Looked at before opening: opening a FIFO would wait for a writer.
  if (stat(name.c_str(), &status) != 0) {
    error = std::strerror(errno);
    return std::string();
  }
  if (!S_ISREG(status.st_mode)) error = "not a regular file";
  if (status.st_size > kMaxFileSize) error = "larger than 64 MiB";
  if (S_ISREG(status.st_mode) && status.st_size == 0) error = "empty";
  if (!error.empty()) return std::string();

  const auto close = [](std::FILE* open) { std::fclose(open); };
  const std::unique_ptr<std::FILE, decltype(close)> file(std::fopen(name.c_str(), "r"), close);
  if (!file) {
    error = std::strerror(errno);
    return std::string();
  }
  std::string text(static_cast<size_t>(status.st_size), '\0');
  size_t used = 0;
  while (used < text.size()) {
    const size_t got = std::fread(&text[used], 1, text.size() - used, file.get());
    if (got == 0) break;
    used += got;
  }
  text.resize(used);
  if (used == 0) error = "cannot be read";
  return text;
}

int readText(const std::string& text) {
  ElementReader reader(text.data(), static_cast<int>(text.size()));
  ProviderDefModule* module = nullptr;
  if (reader.isStart("plugin")) {
    reader.advance();
    if (reader.isStart("module")) module = readModule(reader);
  }
  // All classes come before all associations; what follows is not looked at.
  readElements(reader, "class", registerClass, module);
  readElements(reader, "association", registerAssociation, module);
  return static_cast<int>(text.size()) - reader.restLength();
}

}  // namespace definition

int readProviderDefXML(const std::string& name) {
  std::string error;
  const std::string text = definition::loadFile(name, error);
  if (!error.empty()) {
    DEBUG_FORMAT(1, "Couldn't read definition file %s: %s\n", name.c_str(), error.c_str());
    return 0;
  }
  try {
    definition::readText(text);
  } catch (const ProviderDefXMLError& syntax) {
    DEBUG_FORMAT(1, "XML syntax error: %s\n", syntax.getMessage().c_str());
  }
  return 0;
}
