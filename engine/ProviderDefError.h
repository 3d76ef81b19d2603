#pragma once

#include <string>
#include <utility>

/// A failure at run time, for example a plug-in library that cannot be loaded.
///
/// Thrown by value, caught by reference. Unrelated to ProviderDefXMLError: a handler for the one
/// does not catch the other.
class ProviderDefError {
 public:
  explicit ProviderDefError(std::string message) : message_(std::move(message)) {}
  std::string getMessage() const { return message_; }

 private:
  std::string message_;
};
