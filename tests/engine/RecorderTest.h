#pragma once

#include "tests/engine/PluginTest.h"
#include "tests/plugins/recorder.h"

#include <cstring>

/// Tests with the plug-in "alltypes", whose function of each type has the type's name.
class RecorderTest : public PluginTest {
 protected:
  RecorderTest() : library_(dlopen(pluginFile("alltypes").c_str(), RTLD_NOW)) {
    if (library_ == nullptr) throw std::runtime_error(dlerror());
    recorder_ = static_cast<Recorder*>(dlsym(library_, "recorder"));
    *recorder_ = Recorder();
  }
  ~RecorderTest() override { dlclose(library_); }

  static ProviderDefFunction& function(const std::string& type) {
    ProviderDefFunction* known = getFunction(type);
    return known != nullptr ? *known : PluginTest::function("alltypes", type, type);
  }

  /// What the functions with an output buffer write.
  void answer(const std::string& bytes) {
    std::memset(recorder_->out, 0, sizeof recorder_->out);
    std::memcpy(recorder_->out, bytes.data(), bytes.size());
  }

  /// The content of a recorded buffer without the zero bytes behind its end, which `expected` has
  /// not either: compare both with this.
  static std::string trimmed(std::string bytes) {
    bytes.resize(bytes.find_last_not_of('\0') + 1);
    return bytes;
  }
  static std::string trimmed(const unsigned char (&buffer)[1024]) {
    return trimmed(std::string(reinterpret_cast<const char*>(buffer), sizeof buffer));
  }

  void* library_;
  Recorder* recorder_;
};
