// The methods of Host_FileSystem, called by the provider's engine.

#include <sys/statvfs.h>

#include <memory>

#include "engine/ProviderDefFunction.h"
#include "engine/ProviderDefModule.h"
#include "tests/engine/ValueText.h"
#include "tests/examples/hostinfo/FakeHost.h"

namespace {

class Methods : public FakeHostTest {
 protected:
  Methods() {
    int consumed = 0;
    module_.reset(new ProviderDefModule(text_.data(), static_cast<int>(text_.size()), &consumed));
  }

  // Outputs as text, and behind them what the method returned.
  std::string findByType(const Values& inputs) const {
    Values outputs;
    ProviderDefFunction find("hostFileSystemFindByType", functionTypeCode("execC"), module_.get());
    const int result = find.exec(inputs, outputs);
    return valueText(outputs) + "-> " + std::to_string(result);
  }
  std::string checkSpace(int index, const Values& inputs) const {
    Values outputs;
    ProviderDefFunction check("hostFileSystemCheckSpace", functionTypeCode("execCi"),
                              module_.get());
    const int result = check.exec(ProviderDefValue(index), inputs, outputs);
    return valueText(outputs) + "-> " + std::to_string(result);
  }

  const std::string text_ = "<module name='" HOSTINFO_LIBRARY "'/>";
  std::unique_ptr<ProviderDefModule> module_;
};

TEST_F(Methods, FindByTypeTakesWhatTheClientSends) {
  const std::string a = host_.makeDirectory("a");
  const std::string b = host_.makeDirectory("b");
  const std::string c = host_.makeDirectory("c");
  host_.writeMounts("x " + a + " ext4 rw 0 0\nx " + b + " xfs rw 0 0\nx " + c + " ext4 rw 0 0\n");
  const std::string both = "0 2; 3 {" + a + ", " + c + "}; -> 0";
  const std::pair<Values, std::string> cases[] = {{{"ext4", 5}, both},
                                                  {{"ext4", 2}, both},
                                                  {{"ext4", -1}, both},
                                                  {{"ext4", 1}, "0 2; 3 {" + a + "}; -> 1"},
                                                  {{2}, "0 3; 3 {" + a + ", " + b + "}; -> 1"},
                                                  {{"", 1}, "0 3; 3 {" + a + "}; -> 1"},
                                                  {{"ext", 5}, "0 0; 3 {}; -> 0"},
                                                  {{5, "ext4"}, "-> 2"},
                                                  {{Ints{5}}, "-> 2"},
                                                  {{"ext4", 5, 5}, "-> 2"}};
  for (const auto& [inputs, expected] : cases) {
    EXPECT_EQ(findByType(inputs), expected) << valueText(inputs);
  }
  host_.writeMounts("x " + b + " xfs rw 0 0\n");
  EXPECT_EQ(findByType({"ext4"}), "0 0; 3 {}; -> 0") << "it looks at the host anew";
}

TEST_F(Methods, FindByTypeNamesAsManyAsFit) {
  const std::string longest = host_.makeDirectory("long") + std::string(850, '/');
  const std::string names = host_.makeDirectory("n");
  std::string mounts = "x " + longest + " ext4 rw 0 0\n";
  for (int i = 10; i < 99; ++i) {
    mounts += "x " + host_.makeDirectory("n/" + std::to_string(i)) + " ext4 rw 0 0\n";
  }
  host_.writeMounts(mounts);
  const std::string result = findByType({"ext4"});
  EXPECT_EQ(result.rfind("0 90; 3 {" + longest + ", " + names + "/10", 0), 0u) << result;
  EXPECT_EQ(result.substr(result.size() - 4), "-> 1");
}

TEST_F(Methods, CheckSpaceAnswersForItsInstance) {
  const std::string directory = host_.makeDirectory("here");
  host_.writeMounts("x / xfs rw 0 0\nx " + directory + " ext4 rw 0 0\n");
  ASSERT_EQ(library_.count("hostFileSystemCount"), 2);
  const long freeMiB = library_.longInteger("hostFileSystemFreeKiB", 1) / 1024;
  const int mib = static_cast<int>(std::min(freeMiB, 2147483646L));
  const std::string told = std::to_string(mib) + "; 1 " + directory + "; -> ";
  const std::tuple<int, Values, std::string> cases[] = {
      {1, {0}, "0 1; 0 " + told + "0"},
      {1, {mib}, "0 1; 0 " + told + "0"},
      {1, {mib + 1}, "0 0; 0 " + told + "1"},
      {1, {-1}, "0 0; 0 " + told + "1"},  // 4294967295 MiB
      {2, {1}, "-> 3"},                   // where a client's path matches no instance
      {1, {}, "-> 2"},
      {1, {"1"}, "-> 2"}};
  for (const auto& [index, inputs, expected] : cases) {
    EXPECT_EQ(checkSpace(index, inputs), expected);
  }
}

}  // namespace
