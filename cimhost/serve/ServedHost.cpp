#include "cimhost/serve/ServedHost.h"

#include "cimhost/HostError.h"

#include <algorithm>
#include <filesystem>
#include <utility>

namespace cimhost {

namespace {

// The provider that stays must be usable, or nothing is.
struct Reopen {
  ~Reopen() { gate.open(); }
  RequestGate& gate;
};

bool hasErrors(const std::vector<Diagnostic>& problems) {
  return std::any_of(problems.begin(), problems.end(), [](const Diagnostic& each) {
    return each.severity == Diagnostic::Severity::error;
  });
}

}  // namespace

ServedHost::Served::Served(const std::string& home)
    : host(std::make_unique<Host>(home)), service(host->operations(), host->repository()) {}

ServedHost::ServedHost(const std::string& home, std::string libraryFile)
    // Reading a home directory makes another directory the current one.
    : home_(std::filesystem::absolute(home).string()),
      libraryFile_(std::move(libraryFile)),
      current_(std::make_unique<Served>(home_)) {
  current_->host->loadProvider(libraryFile_);
}

RequestSummary ServedHost::answer(const CimXmlRequest& request, ReplyStream& reply) {
  const RequestGate::Pass pass(gate_);
  return current_->service.answer(request, reply);
}

void ServedHost::reload(std::chrono::milliseconds patience) {
  auto next = std::make_unique<Served>(home_);
  const std::vector<Diagnostic>& problems = next->host->diagnostics();
  if (hasErrors(problems)) throw HostError(problemsText(problems));
  if (!gate_.close(patience)) throw HostError("requests do not end");
  const Reopen reopen{gate_};
  takeOver(std::move(next));
}

void ServedHost::takeOver(std::unique_ptr<Served> next) {
  std::string failure;
  try {
    current_->host->unloadProvider();
  } catch (const HostError& problem) {
    failure = std::string(problem.what()) + "\n";
  }
  try {
    next->host->loadProvider(libraryFile_);
    current_ = std::move(next);
  } catch (const HostError& problem) {
    failure += problem.what();
    try {
      current_->host->loadProvider(libraryFile_);
    } catch (const HostError& again) {
      failure += std::string("\nno provider is loaded now: ") + again.what();
    }
    throw HostError(failure);
  }
}

std::string problemsText(const std::vector<Diagnostic>& problems) {
  std::string text;
  for (const Diagnostic& each : problems) {
    if (!text.empty()) text += '\n';
    text += each.toString();
  }
  return text;
}

}  // namespace cimhost
