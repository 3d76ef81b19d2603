#include "cimhost/ConfigurationCheck.h"

#include <cstdint>
#include <filesystem>
#include <fstream>

namespace cimhost {

namespace {

constexpr const char* kBlanks = " \t\r";
constexpr const char* kLogLevel = "LogLevel";
constexpr std::size_t kMaximumProblems = 100;
constexpr std::uintmax_t kMaximumSize = 1024 * 1024;

bool isDecimal(const std::string& text) {
  const std::size_t digits = !text.empty() && (text[0] == '-' || text[0] == '+') ? 1 : 0;
  return digits < text.size() && text.find_first_not_of("0123456789", digits) == std::string::npos;
}

class Checker {
 public:
  Checker(std::string file, std::vector<Diagnostic>& problems)
      : file_(std::move(file)), problems_(problems) {}

  void checkLine(const std::string& line) {
    ++number_;
    const std::size_t start = line.find_first_not_of(kBlanks);
    if (start == std::string::npos || std::string("#;[").find(line[start]) != std::string::npos) {
      return;
    }
    const std::size_t equals = line.find('=');
    if (equals == std::string::npos) {
      report(Diagnostic::Severity::error, line, start, "expected key = value");
    } else if (equals == start) {
      report(Diagnostic::Severity::error, line, start, "no key before the equal sign");
    } else {
      checkEntry(line, start, equals);
    }
  }

 private:
  void checkEntry(const std::string& line, std::size_t start, std::size_t equals) {
    const std::size_t keyEnd = line.find_last_not_of(kBlanks, equals - 1) + 1;
    const std::string key = line.substr(start, keyEnd - start);
    if (key != kLogLevel) {
      report(Diagnostic::Severity::warning, line, start,
             "unknown key " + key + "; the only one that is read is LogLevel");
      return;
    }
    const std::size_t valueStart = line.find_first_not_of(kBlanks, equals + 1);
    if (valueStart == std::string::npos) {
      report(Diagnostic::Severity::error, line, equals + 1, "LogLevel has no value");
      return;
    }
    const std::size_t valueEnd = line.find_last_not_of(kBlanks) + 1;
    if (!isDecimal(line.substr(valueStart, valueEnd - valueStart))) {
      report(Diagnostic::Severity::error, line, valueStart, "LogLevel is not a decimal number");
    }
  }

  void report(Diagnostic::Severity severity, const std::string& line, std::size_t position,
              const std::string& message) {
    if (problems_.size() >= kMaximumProblems) return;
    problems_.push_back({severity, file_, number_, static_cast<int>(position) + 1, message, line});
  }

  std::string file_;
  std::vector<Diagnostic>& problems_;
  int number_ = 0;
};

}  // namespace

std::vector<Diagnostic> checkConfiguration(std::istream& text, const std::string& file) {
  std::vector<Diagnostic> problems;
  Checker checker(file, problems);
  for (std::string line; std::getline(text, line);) checker.checkLine(line);
  return problems;
}

std::vector<Diagnostic> checkConfigurationFile(const std::string& path, const std::string& name) {
  namespace fs = std::filesystem;
  const auto problem = [&name](const char* message) {
    return std::vector<Diagnostic>{{Diagnostic::Severity::error, name, 0, 0, message, {}}};
  };
  std::error_code error;
  if (!fs::exists(path, error)) return {};
  // Opening a pipe would wait for a writer.
  if (!fs::is_regular_file(path, error)) return problem("not a regular file");
  const std::uintmax_t size = fs::file_size(path, error);
  if (error || size > kMaximumSize) return problem("larger than 1 MiB");
  std::ifstream file(path);
  if (!file) return problem("cannot be read");
  return checkConfiguration(file, name);
}

}  // namespace cimhost
