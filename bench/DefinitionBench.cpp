// Reading definition files and looking classes up. The yardstick for reading is expat's pass over
// the same text with empty handlers: it builds nothing.

#include "definition/DefinitionFile.h"
#include "engine/ProviderDefClass.h"
#include "engine/Registry.h"

#include <benchmark/benchmark.h>
#include <expat.h>

#include <stdexcept>
#include <string>

namespace {

std::string call(const std::string& function, const std::string& type) {
  return "        <functioncall>\n"
         "          <function name=\"" +
         function + "\" type=\"" + type +
         "\"/>\n"
         "          <argument type=\"index\"/>\n"
         "        </functioncall>\n";
}

std::string classText(int number) {
  const std::string n = std::to_string(number);
  std::string text = "  <class name=\"Bench_Class" + n +
                     "\" namespace=\"root/bench\">\n"
                     "    <instances>\n      <functioncall>\n        <function name=\"count" +
                     n + "\" type=\"getI\"/>\n      </functioncall>\n    </instances>\n";
  const char* const types[] = {"getSi", "getIi", "getLi"};
  for (int p = 0; p < 3; ++p) {
    const std::string name = "Property" + std::to_string(p);
    text += "    <property name=\"" + name + "\">\n      <get>\n" +
            call("get" + name + "OfClass" + n, types[p]) + "      </get>\n    </property>\n";
  }
  text +=
      "    <property name=\"CreationClassName\">\n      <get>\n"
      "        <constant type=\"string\">Bench_Class</constant>\n      </get>\n    </property>\n";
  return text + "  </class>\n";
}

std::string definitionText(int classes) {
  std::string text = "<plugin>\n  <module name=\"bench\" path=\"short\"/>\n";
  for (int i = 0; i < classes; ++i) text += classText(i);
  return text + "</plugin>\n";
}

void release() {
  releaseFunctions();
  releaseModules();
}

void readDefinitions(benchmark::State& state) {
  const std::string text = definitionText(static_cast<int>(state.range(0)));
  for (auto _ : state) {
    definition::readText(text);
    state.PauseTiming();
    release();
    state.ResumeTiming();
  }
  state.SetBytesProcessed(state.iterations() * static_cast<int64_t>(text.size()));
}
BENCHMARK(readDefinitions)->Arg(1000)->Arg(10000)->Arg(40000)->Unit(benchmark::kMillisecond);

void XMLCALL onStart(void*, const XML_Char*, const XML_Char**) {}
void XMLCALL onEnd(void*, const XML_Char*) {}
void XMLCALL onText(void*, const XML_Char*, int) {}

void expatPass(benchmark::State& state) {
  const std::string text = definitionText(static_cast<int>(state.range(0)));
  for (auto _ : state) {
    XML_Parser parser = XML_ParserCreate(nullptr);
    XML_SetElementHandler(parser, onStart, onEnd);
    XML_SetCharacterDataHandler(parser, onText);
    if (XML_Parse(parser, text.data(), static_cast<int>(text.size()), 1) != XML_STATUS_OK) {
      throw std::runtime_error("the text is not well-formed");
    }
    XML_ParserFree(parser);
  }
  state.SetBytesProcessed(state.iterations() * static_cast<int64_t>(text.size()));
}
BENCHMARK(expatPass)->Arg(10000)->Unit(benchmark::kMillisecond);

void lookUpClass(benchmark::State& state) {
  const int classes = static_cast<int>(state.range(0));
  definition::readText(definitionText(classes));
  const std::string last = "BENCH_CLASS" + std::to_string(classes - 1);
  for (auto _ : state) benchmark::DoNotOptimize(getProviderDefClass(last));
  if (getProviderDefClass(last) == nullptr) state.SkipWithError("the class is not found");
  release();
}
BENCHMARK(lookUpClass)->Arg(10)->Arg(10000);

}  // namespace
