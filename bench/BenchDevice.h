#pragma once

#include <Pegasus/Common/CIMClass.h>
#include <Pegasus/Common/CIMObjectPath.h>
#include <Pegasus/Common/CIMProperty.h>
#include <Pegasus/Common/CIMQualifier.h>

#include <unistd.h>

#include <cstdlib>
#include <filesystem>
#include <fstream>
#include <stdexcept>
#include <string>

// The class that the benchmarks enumerate: its declaration, and its definition over bench_plugin.
namespace bench {

using namespace Pegasus;

struct PropertyRow {
  const char* name;
  CIMType type;
  bool isArray;
  bool key;
  const char* function;
  const char* functionType;
};

constexpr PropertyRow kProperties[] = {
    {"DeviceID", CIMTYPE_STRING, false, true, "benchText", "getSi"},
    {"Caption", CIMTYPE_STRING, false, false, "benchText", "getSi"},
    {"Number", CIMTYPE_UINT32, false, false, "benchNumber", "getIi"},
    {"Percent", CIMTYPE_UINT8, false, false, "benchNumber", "getIi"},
    {"Offset", CIMTYPE_SINT16, false, false, "benchNumber", "getIi"},
    {"Size", CIMTYPE_UINT64, false, false, "benchLong", "getLi"},
    {"Ready", CIMTYPE_BOOLEAN, false, false, "benchNumber", "getIi"},
    {"Load", CIMTYPE_REAL64, false, false, "benchNumber", "getIi"},
    {"Counters", CIMTYPE_SINT32, true, false, "benchNumbers", "getAIi"},
    {"Labels", CIMTYPE_STRING, true, false, "benchTexts", "getASi"},
};

inline CIMClass benchClass() {
  CIMClass cimClass(CIMName("Bench_Device"));
  for (const PropertyRow& row : kProperties) {
    CIMProperty property(CIMName(row.name), CIMValue(row.type, row.isArray));
    property.addQualifier(CIMQualifier(CIMName("Key"), CIMValue(row.key)));
    property.addQualifier(
        CIMQualifier(CIMName("Description"), CIMValue(String("A property of the device."))));
    cimClass.addProperty(property);
  }
  return cimClass;
}

inline std::string definitionText(const std::string& countFunction) {
  std::string text = std::string("<plugin><module name=\"") + BENCH_PLUGIN +
                     "\"/><class name=\"Bench_Device\" namespace=\"root/bench\"><instances>"
                     "<functioncall><function name=\"" +
                     countFunction +
                     "\" type=\"getI\"/></functioncall>"
                     "</instances>";
  for (const PropertyRow& row : kProperties) {
    text += std::string("<property name=\"") + row.name +
            "\"><get><functioncall><function name=\"" + row.function + "\" type=\"" +
            row.functionType + "\"/><argument type=\"index\"/></functioncall></get></property>";
  }
  return text + "</class></plugin>";
}

// The working directory of a server: the definition file in run/, where the process is while the
// object lives.
class WorkingDirectory {
 public:
  // `countFunction` tells how many instances there are: benchCount or benchManyCount.
  explicit WorkingDirectory(const std::string& countFunction = "benchCount")
      : before_(std::filesystem::current_path()) {
    char name[] = "/tmp/commonprovider-bench-XXXXXX";
    if (mkdtemp(name) == nullptr) throw std::runtime_error("no temporary directory");
    tree_ = name;
    std::filesystem::create_directory(tree_ / "run");
    std::ofstream(tree_ / "run" / "bench.xml") << definitionText(countFunction);
    std::filesystem::current_path(tree_ / "run");
  }
  ~WorkingDirectory() {
    std::filesystem::current_path(before_);
    std::filesystem::remove_all(tree_);
  }

 private:
  std::filesystem::path before_;
  std::filesystem::path tree_;
};

inline const CIMObjectPath& benchPath() {
  static const CIMObjectPath path(String(), CIMNamespaceName("root/bench"),
                                  CIMName("Bench_Device"));
  return path;
}

}  // namespace bench
