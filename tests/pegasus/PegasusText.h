#pragma once

#include <Pegasus/Common/Exception.h>
#include <gtest/gtest.h>

#include <string>

inline std::string text(const Pegasus::String& str) {
  return static_cast<const char*>(str.getCString());
}

/// The message of the exception of type E that `action` throws; a note when it throws none or
/// another one.
template <class E, class Action>
std::string thrownMessage(Action action) {
  try {
    action();
  } catch (const Pegasus::Exception& exception) {
    const bool expected = dynamic_cast<const E*>(&exception) != nullptr;
    return (expected ? "" : "another exception: ") + text(exception.getMessage());
  }
  return "no exception";
}
