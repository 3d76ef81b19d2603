#pragma once

#include <Pegasus/Common/String.h>

#include <cstddef>
#include <cstring>
#include <memory>
#include <string_view>

namespace cimhost {

/// An XML document under construction: a growing block of bytes that is valid UTF-8 and holds only
/// characters of XML 1.0, whatever text is put in. One thread at a time; throws std::bad_alloc.
class XmlBuffer {
 public:
  /// Markup, as it is.
  void append(std::string_view markup) {
    std::memcpy(room(markup.size()), markup.data(), markup.size());
    size_ += markup.size();
  }

  /// Text or an attribute's value: `<`, `>`, `&` and `"` become the named entities, and what XML
  /// has no form for (control characters, lone surrogates, U+FFFE and U+FFFF, bytes that are not
  /// UTF-8) becomes U+FFFD. A carriage return is kept: a reference to it is not read everywhere.
  void appendText(const Pegasus::String& text);
  void appendText(std::string_view text);

  std::string_view view() const { return {bytes_.get(), size_}; }
  std::size_t size() const { return size_; }
  /// Keeps the memory.
  void clear() { size_ = 0; }

 private:
  char* room(std::size_t bytes) {
    if (capacity_ - size_ < bytes) grow(bytes);
    return bytes_.get() + size_;
  }
  void grow(std::size_t bytes);
  void advance(const char* end) { size_ = static_cast<std::size_t>(end - bytes_.get()); }

  std::unique_ptr<char[]> bytes_;
  std::size_t size_ = 0;
  std::size_t capacity_ = 0;
};

}  // namespace cimhost
