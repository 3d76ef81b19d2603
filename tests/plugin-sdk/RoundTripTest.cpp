// Plug-ins written with the header, called by the provider's engine.

#include <gtest/gtest.h>

#include <memory>

#include "commonprovider/plugin.h"
#include "engine/ProviderDefFunction.h"
#include "engine/ProviderDefModule.h"
#include "tests/engine/ValueText.h"

namespace {

// The parameter is the language in which the plug-in was compiled.
class RoundTrip : public testing::TestWithParam<const char*> {
 protected:
  RoundTrip() {
    const std::string text =
        std::string("<module name='" TEST_PLUGIN_FOLDER "/libsdk_") + GetParam() + ".so'/>";
    int consumed = 0;
    module_.reset(new ProviderDefModule(text.data(), static_cast<int>(text.size()), &consumed));
  }

  ProviderDefFunction function(const char* name, const char* type) const {
    return {name, functionTypeCode(type), module_.get()};
  }

  // The outputs of an execC function as text, and behind them what it returned.
  std::string exec(const char* name, const Values& inputs) const {
    Values outputs;
    const int result = function(name, "execC").exec(inputs, outputs);
    return valueText(outputs) + "-> " + std::to_string(result);
  }

  std::unique_ptr<ProviderDefModule> module_;
};

INSTANTIATE_TEST_SUITE_P(As, RoundTrip, testing::Values("c", "cpp"),
                         [](const auto& testCase) { return std::string(testCase.param); });

// What an item needs depends on the one before it: every sequence of three.
TEST_P(RoundTrip, ListsOfEveryShapeComeBack) {
  const Values shapes{7, "", "ab", Ints(), Ints{1, -2}, Texts(), Texts{"a", "", "bcd"}};
  Values list;
  for (size_t i = 0; i < 8 * 8 * 8; ++i) {
    list.clear();
    for (const size_t pick : {i / 64, i / 8 % 8, i % 8}) {
      if (pick < shapes.size()) list.push_back(shapes[pick]);
    }
    EXPECT_EQ(exec("echo", list), valueText(list) + "-> 0");
    EXPECT_EQ(exec("echoWhole", list), valueText(list) + "-> 0");
  }
}

TEST_P(RoundTrip, WhatDoesNotFitAListEndsIt) {
  const Values over{7, Texts{std::string(972, 'x')}, 8};
  EXPECT_EQ(exec("echoWhole", over), "0 7; -> 4") << "8 is not the second parameter";
  EXPECT_EQ(exec("echo", over), "0 7; 3 {}; 0 8; -> 0") << "only the element is left out";
}

TEST_P(RoundTrip, AddedTextsComeBack) {
  const auto echo = [this](const Texts& texts) {
    return function("echoStrings", "getASv").get(ProviderDefValue(texts)).getStringArray();
  };
  const std::string half(490, 'x');
  EXPECT_EQ(echo({}), Texts());
  EXPECT_EQ(echo({"", "a", ""}), (Texts{"", "a", ""}));
  EXPECT_EQ(echo({half, half, "y"}), (Texts{half, "y"})) << "what does not fit is left out";
}

}  // namespace
