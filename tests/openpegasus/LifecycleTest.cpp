// The provider in the server over time: disabled and enabled, the server restarted, a plug-in that
// takes its process along, and many clients at once.

#include <thread>

#include "ServerTest.h"

namespace {

const char* const kModule = "CommonProviderModule";

class Lifecycle : public WithServer<testing::TestWithParam<CimServer::Providers>> {
 protected:
  void SetUp() override {
    WithServer::SetUp();
    if (IsSkipped()) return;
    Deployment::releaseShared();
    deployment_ = std::make_unique<Deployment>(GetParam());
  }

  ProgramResult parts() const { return deployment_->cimcli({"ei", "Cmp_Part"}); }

  static long count(const std::string& text, const std::string& word) {
    const std::regex each(word);
    return std::distance(std::sregex_iterator(text.begin(), text.end(), each), {});
  }

  std::unique_ptr<Deployment> deployment_;
};

// The open files and the resident KiB of the server's process; of agents the server sees only a
// pipe.
std::pair<long, long> resources(pid_t process) {
  const std::filesystem::path folder = "/proc/" + std::to_string(process);
  const std::string status = TemporaryTree::read(folder / "status");
  return {std::distance(std::filesystem::directory_iterator(folder / "fd"), {}),
          std::stol(status.substr(status.find("VmRSS:") + 6))};
}

}  // namespace

// A provider that is enabled again reads its definition files anew: nothing of the old is left.
TEST_P(Lifecycle, DisabledAndEnabledTwice) {
  const std::filesystem::path file = deployment_->server().home() / "run/compare.xml";
  const std::string definitions = TemporaryTree::read(file);
  for (const char* parts : {"3", "5"}) {
    deployment_->server().mustRun("cimprovider", {"-d", "-m", kModule});
    const ProgramResult disabled = this->parts();
    EXPECT_THAT(disabled.out + disabled.err, testing::HasSubstr("Code= 7"));

    const std::regex call("<functioncall><function name=\"partCount\"[^>]*></functioncall>");
    const std::string constant = std::string("<constant type=\"int\">") + parts + "</constant>";
    TemporaryTree::write(file, std::regex_replace(definitions, call, constant));
    deployment_->server().mustRun("cimprovider", {"-e", "-m", kModule});
    EXPECT_EQ(count(this->parts().out, "instance of Cmp_Part"), std::stol(parts));
  }
}

TEST_P(Lifecycle, ServerRestarted) {
  const std::string path = R"(Cmp_Stored.Name="plain")";
  const std::string before = parts().out;
  EXPECT_EQ(count(before, "instance of Cmp_Part"), 6);
  EXPECT_EQ(deployment_->cimcli({"mi", path, "Text=kept"}).code, 0);
  EXPECT_TRUE(deployment_->server().stop());
  deployment_->server().start();
  EXPECT_EQ(parts().out, before);
  EXPECT_THAT(deployment_->cimcli({"gi", path}).out, testing::HasSubstr("Text = \"kept\""));
}

TEST_P(Lifecycle, ManyClientsAtOnce) {
  const std::string expected = deployment_->cimcli({"ei", "Cmp_Stored"}).out;
  EXPECT_EQ(count(expected, "instance of Cmp_Stored"), 4);
  const auto enumerate200 = [&] {
    std::vector<std::thread> clients;
    std::vector<std::string> wrong(8);
    for (std::string& each : wrong) {
      clients.emplace_back([&] {
        for (int i = 0; i < 25; ++i) {
          const ProgramResult result = deployment_->cimcli({"ei", "Cmp_Stored"});
          if (result.out != expected) each += result.out + result.err;
        }
      });
    }
    for (std::thread& client : clients) client.join();
    EXPECT_THAT(wrong, testing::Each(""));
  };
  enumerate200();
  const auto [files, kibibytes] = resources(deployment_->server().process());
  enumerate200();
  const auto [filesLater, kibibytesLater] = resources(deployment_->server().process());
  // A file or an instance's class left behind at each call would be hundreds of files, or of KiB.
  EXPECT_LT(filesLater, files + 20);
  EXPECT_LT(kibibytesLater, kibibytes + 4096);
  EXPECT_TRUE(deployment_->server().stop());
}

constexpr auto kInProcess = CimServer::Providers::inProcess;
constexpr auto kInAgents = CimServer::Providers::inAgents;

INSTANTIATE_TEST_SUITE_P(Server, Lifecycle, testing::Values(kInProcess, kInAgents));

using Agents = Lifecycle;

// The request that crashed the agent fails; the server lives on and starts another.
TEST_P(Agents, SurviveACrashOfThePlugIn) {
  for (int i = 0; i < 2; ++i) {
    EXPECT_EQ(count(parts().out, "instance of Cmp_Part"), 6);
    const ProgramResult crashed = deployment_->cimcli({"im", "Cmp_Element", "Die"});
    EXPECT_THAT(crashed.out + crashed.err, testing::HasSubstr("Code= 1"));
  }
  EXPECT_EQ(count(parts().out, "instance of Cmp_Part"), 6);
  EXPECT_TRUE(deployment_->server().stop());
}

INSTANTIATE_TEST_SUITE_P(Server, Agents, testing::Values(kInAgents));
