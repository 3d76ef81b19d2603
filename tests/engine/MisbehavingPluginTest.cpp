// Plug-ins that break the contract: a clear error or a harmless value, never a crash. Run these
// under the address and undefined-behaviour sanitizers, too.

#include "tests/engine/PluginTest.h"
#include "tests/support/LogLevel.h"

#include <climits>
#include <functional>

using namespace std::string_literals;

class MisbehavingPlugin : public PluginTest {
 protected:
  static ProviderDefFunction& function(const std::string& name, const std::string& type) {
    return PluginTest::function("misbehaving", name, type);
  }
  static std::string overrun(const std::string& name) {
    return "Function " + name + " wrote past the end of its buffer";
  }
  static std::string noFit(const std::string& name) {
    return "The result of function " + name + " does not fit into its buffer";
  }
};

// Up to 1024 bytes are none of the engine's business where it does not read them.
TEST_F(MisbehavingPlugin, WritingPastABufferIsAnError) {
  Values outputs;
  for (const int size : {1024, 1025, 2024}) {
    const auto expectOverrun = [size](const std::string& name, const std::function<void()>& call) {
      EXPECT_EQ(errorOf(call), size > 1024 ? overrun(name) : "") << size;
    };
    expectOverrun("fill", [&] { function("fill", "setAIi").set(Ints{1}, size); });
    expectOverrun("fill", [&] { function("fill", "setASi").set(Texts{"a"}, size); });
    expectOverrun("fill", [&] { function("fill", "execBi").exec(size, Values()); });
    expectOverrun("fillInputs",
                  [&] { function("fillInputs", "execCi").exec(size, Values(), outputs); });
    EXPECT_EQ(errorOf([&] { function("poke", "getSi").get(size); }), overrun("poke")) << size;
    if (size == 1024) continue;
    expectOverrun("fillOutputs",
                  [&] { function("fillOutputs", "execCi").exec(size, Values(), outputs); });
    for (const char* type : {"getSi", "getAIi", "getASi"}) {
      expectOverrun("fill", [&] { function("fill", type).get(size); });
    }
  }
  EXPECT_TRUE(outputs.empty()) << "a plug-in that writes no outputs has none";
  EXPECT_EQ(errorOf([] { function("poke", "getSi").get(2047); }), overrun("poke"));
  EXPECT_EQ(errorOf([] { function("fillExtra", "getIv").get(Ints{1}); }), overrun("fillExtra"));
  EXPECT_EQ(errorOf([] { function("fillExtra", "getIv").get(Values{1}); }), overrun("fillExtra"));
  EXPECT_EQ(errorOf([] { function("fillExtra", "execAv").exec(Ints{1}); }), overrun("fillExtra"));
}

TEST_F(MisbehavingPlugin, GetResultsStayWithinTheBuffer) {
  const auto ones = [](int count) { return valueText(Ints(static_cast<size_t>(count), 1)); };
  const struct {
    const char *name, *type;
    ProviderDefValue argument;
    std::string expected;  // The value, or the error's message.
  } cases[] = {
      {"fill", "getSi", 3, "1 xxx"},  // The buffer's zero bytes end it.
      {"fill", "getSi", 1023, "1 " + std::string(1023, 'x')},
      {"fill", "getSi", 1024, noFit("fill")},
      {"countIntegers", "getAIi", 127, ones(127)},
      {"countIntegers", "getAIi", 128, noFit("countIntegers")},
      {"countIntegers", "getAIi", INT_MAX, noFit("countIntegers")},
      // Empty strings stand 33 bytes apart: 31 in 1016 bytes.
      {"countStrings", "getASi", 3, "3 {, , }"},
      {"countStrings", "getASi", 32, noFit("countStrings")},
      {"countStrings", "getASi", INT_MAX, noFit("countStrings")},
      // Header, the first string and its stride leave 9 bytes for an empty second one, or less.
      {"longString", "getASi", 974, valueText(Texts{std::string(974, 'x'), ""})},
      {"longString", "getASi", 975, noFit("longString")},
  };
  for (const auto& c : cases) {
    std::string got;
    const std::string error =
        errorOf([&] { got = valueText(function(c.name, c.type).get(c.argument)); });
    EXPECT_EQ(error.empty() ? got : error, c.expected) << c.name << " " << valueText(c.argument);
  }
}

TEST_F(MisbehavingPlugin, OutputListsEndAtAnUnknownTag) {
  const LogLevel level(1);
  Values outputs;
  EXPECT_EQ(function("unknownTag", "execC").exec(Values(), outputs), 1);
  EXPECT_EQ(valueText(outputs), "0 5; ");
  EXPECT_EQ(tree_.log(), "Function unknownTag delivered an item with the unknown tag 77\n");
}

TEST_F(MisbehavingPlugin, OutputListsWithoutEndMarkAreAnError) {
  Values outputs;
  EXPECT_EQ(errorOf([&] { function("noEndMark", "execC").exec(Values(), outputs); }),
            noFit("noEndMark"));
  EXPECT_LE(outputs.size(), 128u);
}

TEST_F(MisbehavingPlugin, TextIsBytes) {
  const LogLevel level(9);
  EXPECT_EQ(function("latin1Text", "getS").get().getStringValue(), "caf\xe9 \xff\xfe");
  const ProviderDefValue format = function("formatText", "getS").get();
  EXPECT_EQ(format.getStringValue(), "%n%s%s%s%100000d");
  format.equal(format);
  // As another type's data the same bytes are numbers and counts: too many of them.
  EXPECT_EQ(errorOf([] { function("formatText", "getAI").get(); }), noFit("formatText"));
  EXPECT_EQ(errorOf([] { function("formatText", "getAS").get(); }), noFit("formatText"));
}
