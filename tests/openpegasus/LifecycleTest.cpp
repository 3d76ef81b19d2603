// The provider in the server over time: disabled and enabled, the server restarted, a plug-in that
// takes its process along, and many clients at once.

#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include <thread>

#include "Deployment.h"

namespace {

const char* const kModule = "CommonProviderModule";

class Lifecycle : public testing::TestWithParam<CimServer::Providers> {
 protected:
  void SetUp() override {
    const std::string reason = CimServer::whyUnavailable();
    if (!reason.empty()) GTEST_SKIP() << "No server to compare with: " << reason;
    Deployment::releaseShared();
    deployment_ = std::make_unique<Deployment>(GetParam());
  }

  ProgramResult parts() const { return deployment_->cimcli({"ei", "Cmp_Part"}); }

  static int count(const std::string& text, const std::string& word) {
    int found = 0;
    for (auto at = text.find(word); at != std::string::npos; at = text.find(word, at + 1)) ++found;
    return found;
  }

  std::unique_ptr<Deployment> deployment_;
};

struct Resources {
  long files = 0;
  long kibibytes = 0;
};

// Of the server's process; of agents the server sees only a pipe.
Resources resources(pid_t process) {
  const std::filesystem::path folder = "/proc/" + std::to_string(process);
  Resources used;
  used.files = std::distance(std::filesystem::directory_iterator(folder / "fd"), {});
  std::istringstream status(TemporaryTree::read(folder / "status"));
  for (std::string line; std::getline(status, line);) {
    if (line.compare(0, 6, "VmRSS:") == 0) used.kibibytes = std::stol(line.substr(6));
  }
  return used;
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

    std::string changed = definitions;
    const std::string call =
        "<functioncall><function name=\"partCount\" type=\"getI\"/></functioncall>";
    for (auto at = changed.find(call); at != std::string::npos; at = changed.find(call)) {
      changed.replace(at, call.size(),
                      std::string("<constant type=\"int\">") + parts + "</constant>");
    }
    TemporaryTree::write(file, changed);
    deployment_->server().mustRun("cimprovider", {"-e", "-m", kModule});
    EXPECT_EQ(count(this->parts().out, "instance of Cmp_Part"), std::stoi(parts));
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
  const Resources once = resources(deployment_->server().process());
  enumerate200();
  const Resources twice = resources(deployment_->server().process());
  // A file or an instance's class left behind at each call would be hundreds of files, or of KiB.
  EXPECT_LT(twice.files, once.files + 20);
  EXPECT_LT(twice.kibibytes, once.kibibytes + 4096);
  EXPECT_TRUE(deployment_->server().stop());
}

INSTANTIATE_TEST_SUITE_P(Server, Lifecycle,
                         testing::Values(CimServer::Providers::inProcess,
                                         CimServer::Providers::inAgents),
                         [](const auto& given) {
                           return given.param == CimServer::Providers::inProcess ? "InProcess"
                                                                                 : "InAgents";
                         });

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

INSTANTIATE_TEST_SUITE_P(Server, Agents, testing::Values(CimServer::Providers::inAgents));
