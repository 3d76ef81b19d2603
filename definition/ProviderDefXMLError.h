#pragma once

#include <string>
#include <utility>

/// Malformed definition text. Thrown by value, caught by reference; unrelated to ProviderDefError.
class ProviderDefXMLError {
 public:
  explicit ProviderDefXMLError(std::string message) : message_(std::move(message)) {}
  std::string getMessage() const { return message_; }
  void append(const std::string& text) { message_ += text; }

 private:
  std::string message_;
};

/// Adds a line of context to the message: a newline, `element`, ":", `name` and a newline. Each
/// enclosing element adds one on the error's way out, so the message reads from the inside
/// outwards.
void processException(const std::string& element, const std::string& name,
                      ProviderDefXMLError& error);

/// Runs `body`, which reads the element `element`; adds its line of context to an error that
/// leaves. `name` is looked at only then: it is what the body has read of the element's name so
/// far.
template <class Body>
void withContext(const char* element, const std::string& name, Body body) {
  try {
    body();
  } catch (ProviderDefXMLError& error) {
    processException(element, name, error);
    throw;
  }
}
