#pragma once

#include <dlfcn.h>

#include <array>
#include <cstdint>
#include <cstring>
#include <stdexcept>
#include <string>
#include <vector>

#include "examples/hostinfo/hostinfo.h"

/// libhostinfo.so as a caller that knows only names and prototypes sees it.
///
/// Each object opens the library anew; the plug-in starts without snapshots when no other is open.
class HostinfoLibrary {
 public:
  HostinfoLibrary() : handle_(dlopen(HOSTINFO_LIBRARY, RTLD_NOW)) {
    if (handle_ == nullptr) throw std::runtime_error(dlerror());
  }
  ~HostinfoLibrary() { dlclose(handle_); }
  HostinfoLibrary(const HostinfoLibrary&) = delete;
  HostinfoLibrary& operator=(const HostinfoLibrary&) = delete;

  /// The exported function of that name, or null.
  template <class Function>
  Function* function(const char* name) const {
    return reinterpret_cast<Function*>(dlsym(handle_, name));
  }

  int count(const char* name) const { return function<int()>(name)(); }
  int integer(const char* name, int index) const { return function<int(int)>(name)(index); }
  long longInteger(const char* name, int index) const { return function<long(int)>(name)(index); }

  /// The 1024 bytes that a function wrote; throws when it wrote beyond them.
  std::string bytes(const char* name, int index) const {
    std::array<char, 1024 + 64> buffer;
    buffer.fill('\x5A');
    function<int(void*, int)>(name)(buffer.data(), index);
    for (std::size_t i = 1024; i < buffer.size(); ++i) {
      if (buffer[i] != '\x5A') throw std::runtime_error(std::string(name) + " wrote too much");
    }
    return std::string(buffer.data(), 1024);
  }

  std::string text(const char* name, int index) const {
    const std::string all = bytes(name, index);
    return all.substr(0, all.find('\0'));
  }

  std::vector<int> integers(const char* name, int index) const {
    const std::string all = bytes(name, index);
    std::vector<int> result;
    for (int i = 0; i < word(all, 4); ++i) {
      result.push_back(word(all, 8 + 8 * static_cast<std::size_t>(i) + 4));
    }
    return result;
  }

  /// Elements of a string array, each 33 bytes plus its length after the one before.
  std::vector<std::string> texts(const char* name, int index) const {
    const std::string all = bytes(name, index);
    std::vector<std::string> result;
    std::size_t at = 8;
    for (int i = 0; i < word(all, 4); ++i) {
      const std::size_t end = all.find('\0', at + 8);
      if (end == std::string::npos) throw std::runtime_error("text without an end");
      result.push_back(all.substr(at + 8, end - at - 8));
      at += 33 + result.back().size();
    }
    return result;
  }

  std::vector<std::string> textsOfAll(const char* countName, const char* name) const {
    std::vector<std::string> result;
    const int n = count(countName);
    for (int i = 0; i < n; ++i) result.push_back(text(name, i));
    return result;
  }

  /// The 32-bit word at a byte position; throws outside the buffer.
  static std::int32_t word(const std::string& bytes, std::size_t at) {
    std::int32_t value = 0;
    std::memcpy(&value, bytes.substr(at, 4).append(4, '\0').data(), 4);
    return value;
  }

 private:
  void* handle_;
};
