#pragma once

#include "cimhost/mof/MofReader.h"
#include "tests/cimhost/repository/ClassText.h"
#include "tests/support/TemporaryTree.h"

#include <gtest/gtest.h>

#include <string>

namespace cimhost_test {

inline const Pegasus::CIMNamespaceName kNamespace("root/test");

/// A repository and a reader that fills it.
struct Mof {
  cimhost::ClassRepository repository;
  cimhost::MofReader reader{repository};

  bool read(const std::string& mof) { return reader.readText(mof, "t.mof", kNamespace); }

  /// All diagnostics, each ended by a newline.
  std::string diagnostics() const {
    std::string result;
    for (const auto& diagnostic : reader.diagnostics()) result += diagnostic.toString() + '\n';
    return result;
  }

  /// The first line of the first diagnostic, without "error: ".
  std::string firstLine() const {
    std::string all = diagnostics();
    all = all.substr(0, all.find('\n'));
    const std::size_t word = all.find("error: ");
    return word == std::string::npos ? all : all.erase(word, 7);
  }

  Pegasus::CIMClass get(const char* name, const Pegasus::CIMNamespaceName& ns = kNamespace) const {
    return repository.getClass(ns, name, false, true, true, Pegasus::CIMPropertyList());
  }

  /// The class as classText() writes it, or the diagnostics when there are any.
  std::string classAsText(const char* name) const {
    const std::string problems = diagnostics();
    return problems.empty() ? classText(get(name)) : problems;
  }
};

/// A file below the folder that a TemporaryTree makes the current one.
inline void write(const std::string& file, const std::string& text) {
  TemporaryTree::write(file, text);
}

}  // namespace cimhost_test
