#include "definition/DefinitionCheck.h"

#include "definition/DefinitionFile.h"
#include "definition/DefinitionRegistry.h"
#include "definition/ElementReader.h"
#include "diagnostics/debug.h"
#include "engine/Registry.h"

#include <algorithm>
#include <unordered_set>
#include <utility>

namespace definition {
namespace {

constexpr size_t kMaxSourceLine = 200;
constexpr size_t kMaxSourceBefore = 100;

bool isContinuation(char byte) {
  return (static_cast<unsigned char>(byte) & 0xC0) == 0x80;
}

Problem problemAt(const std::string& file, const std::string& text, size_t position,
                  const std::string& message) {
  const size_t before = position == 0 ? std::string::npos : text.rfind('\n', position - 1);
  const size_t lineStart = before == std::string::npos ? 0 : before + 1;
  Problem problem;
  problem.file = file;
  problem.line = 1 + static_cast<int>(std::count(
                         text.begin(), text.begin() + static_cast<long>(lineStart), '\n'));
  problem.column = static_cast<int>(position - lineStart) + 1;
  problem.message = message;
  size_t start = std::max(lineStart, position - std::min(position, kMaxSourceBefore));
  while (start < position && isContinuation(text[start])) ++start;
  const size_t lineEnd = std::min(text.find('\n', lineStart), start + kMaxSourceLine);
  problem.source = text.substr(start, lineEnd - start);
  problem.caret = static_cast<int>(position - start) + 1;
  if (!problem.source.empty() && problem.source.back() == '\r') problem.source.pop_back();
  return problem;
}

size_t skipSpaces(const std::string& text, size_t position) {
  while (position < text.size() && isSpace(static_cast<unsigned char>(text[position]))) ++position;
  return position;
}

// What the reader passes over in silence: a text that is no definition file, or elements behind the
// place where it stopped.
void checkEnd(const std::string& file, const std::string& text, int stopped,
              std::vector<Problem>& problems) {
  const ElementReader start(text.data(), static_cast<int>(text.size()));
  const size_t place = skipSpaces(text, static_cast<size_t>(stopped));
  const ElementReader end(text.data() + place, static_cast<int>(text.size() - place));
  if (!start.isStart("plugin")) {
    problems.push_back(problemAt(file, text, skipSpaces(text, 0),
                                 "not a definition file: it must begin with the plugin element"));
  } else if (place == text.size()) {
    problems.push_back(problemAt(file, text, place, "the end of plugin element missing"));
  } else if (!end.isEnd("plugin")) {
    problems.push_back(problemAt(
        file, text, place,
        "unexpected " + end.unit().getName() +
            ": the rest of the file is not read (module, then classes, then associations)"));
  }
}

std::string whyUncallable(const ProviderDefFunction& function) {
  if (functionTypeSlot(function.getType()) < 0) return "its type is none of the function types";
  return function.getModule() == nullptr ? "no module element stands before it" : std::string();
}

void checkFunctions(const std::string& file, size_t first, CheckResult& result) {
  for (size_t i = first; i < registeredFunctions().size(); ++i) {
    const std::string reason = whyUncallable(*registeredFunctions()[i]);
    if (reason.empty()) continue;
    const std::string& name = registeredFunctions()[i]->getName();
    result.uncallable.push_back(
        {file, 0, 0, "function " + name + " is never called: " + reason, std::string()});
  }
}

void checkFile(const std::string& file, CheckResult& result) {
  std::string error;
  const std::string text = loadFile(file, error);
  if (!error.empty()) {
    result.problems.push_back({file, 0, 0, error, std::string()});
    return;
  }
  const size_t firstClass = registeredClasses().size();
  const size_t firstAssociation = registeredAssociations().size();
  const size_t firstFunction = functionCount();
  const size_t before = result.problems.size();
  try {
    checkEnd(file, text, readText(text), result.problems);
  } catch (const ProviderDefXMLError& syntax) {
    const auto position = ElementReader::lastErrorPosition() - text.data();
    result.problems.push_back(
        problemAt(file, text, static_cast<size_t>(position), syntax.getMessage()));
  }
  for (size_t i = firstClass; i < registeredClasses().size(); ++i) {
    const ProviderDefClass& read = registeredClasses()[i];
    std::vector<std::string> properties;
    for (const ProviderDefProperty& property : read.getProperties()) {
      properties.push_back(property.getName());
    }
    result.served.push_back({read.getNamespace(), read.getName(), false, !read.getMethods().empty(),
                             file, std::move(properties)});
  }
  for (size_t i = firstAssociation; i < registeredAssociations().size(); ++i) {
    const ProviderDefAssociation& read = registeredAssociations()[i];
    result.served.push_back({read.getNamespace(), read.getName(), true, false, file, {}});
  }
  if (result.problems.size() == before) checkFunctions(file, firstFunction, result);
}

// Before the registries are released.
void keepUsedModules(std::vector<UsedModule>& modules) {
  std::unordered_set<std::string> used;
  for (const auto& function : registeredFunctions()) {
    if (function->getModule() != nullptr) used.insert(function->getModule()->getName());
  }
  modules.erase(
      std::remove_if(modules.begin(), modules.end(),
                     [&](const UsedModule& module) { return used.count(module.name) == 0; }),
      modules.end());
}

CheckResult readFiles(const std::vector<std::string>& files) {
  configRead.store(1);
  LOG_LEVEL.store(0);
  CheckResult result;
  for (const std::string& file : files) {
    const size_t firstModule = registeredModules().size();
    checkFile(file, result);
    for (size_t i = firstModule; i < registeredModules().size(); ++i) {
      const ProviderDefModule& read = *registeredModules()[i];
      result.modules.push_back({file, read.getName(), read.pathToLoad()});
    }
  }
  keepUsedModules(result.modules);
  return result;
}

void releaseAll() {
  releaseFunctions();
  releaseModules();
}

}  // namespace

CheckResult checkDefinitionFiles(const std::vector<std::string>& files) {
  CheckResult result = readFiles(files);
  releaseAll();
  return result;
}

std::vector<Problem> dumpDefinitionFiles(const std::vector<std::string>& files) {
  std::vector<Problem> problems = readFiles(files).problems;
  for (const auto& module : registeredModules()) module->dump();
  for (const ProviderDefClass& definition : registeredClasses()) definition.dump();
  for (const ProviderDefAssociation& definition : registeredAssociations()) definition.dump();
  releaseAll();
  return problems;
}

}  // namespace definition
