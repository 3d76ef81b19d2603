#include "cimhost/ServeArguments.h"

#include <CLI/CLI.hpp>

namespace cimhost {

namespace {

constexpr std::size_t kMany = 1U << 16U;
constexpr std::size_t kMaximumSize = 1U << 30U;
constexpr std::size_t kMinimumSize = 1U << 10U;
constexpr int kLongestTime = 86400;

void addFile(CLI::App& command, const char* name, std::string& value, const char* description) {
  command.add_option(name, value, description)->type_name("FILE");
}

void addCount(CLI::App& command, const char* name, std::size_t& value, const char* description) {
  command.add_option(name, value, description)
      ->check(CLI::Range(std::size_t{1}, kMany))
      ->capture_default_str()
      ->type_name("N");
}

void addSize(CLI::App& command, const char* name, std::size_t& value, const char* description) {
  command.add_option(name, value, description)
      ->check(CLI::Range(kMinimumSize, kMaximumSize))
      ->capture_default_str()
      ->type_name("BYTES");
}

void addTime(CLI::App& command, const char* name, std::chrono::seconds& value,
             const char* description) {
  command
      .add_option_function<int>(
          name, [&value](int seconds) { value = std::chrono::seconds(seconds); }, description)
      ->check(CLI::Range(1, kLongestTime))
      ->default_str(std::to_string(value.count()))
      ->type_name("SECONDS");
}

}  // namespace

void addServeArguments(CLI::App& command, ServeOptions& options) {
  command.add_option("--bind", options.bind, "IPv4 or IPv6 address to listen on")
      ->capture_default_str()
      ->type_name("ADDRESS");
  command.add_option("--port", options.port, "TCP port; 0: any free one, which is printed")
      ->capture_default_str()
      ->type_name("PORT");
  addFile(command, "--tls-cert", options.tlsCertificate, "Certificate chain (PEM)");
  addFile(command, "--tls-key", options.tlsKey, "Its private key (PEM)");
  addFile(command, "--users", options.users, "Who may come in: an htpasswd file");
  command.add_flag("--insecure", options.insecure,
                   "Allow an address that others reach without TLS or users");
  addFile(command, "--log", options.log, "Where requests are logged; default: standard error");
  ServeLimits& limits = options.limits;
  addCount(command, "--threads", limits.threads, "Requests that run at the same time");
  addCount(command, "--max-waiting", limits.queue, "Requests that wait for a thread");
  addCount(command, "--max-connections", limits.connections, "Connections in all");
  addCount(command, "--max-connections-per-address", limits.connectionsPerAddress,
           "Connections of one client address");
  addSize(command, "--max-request-size", limits.requestSize, "Size of a request's body");
  addSize(command, "--max-header-size", limits.headerSize, "Size of request line and headers");
  addTime(command, "--idle-timeout", limits.idleTimeout, "Silence on a connection");
  addTime(command, "--request-timeout", limits.requestTimeout, "A request and its reply");
  addTime(command, "--shutdown-timeout", options.shutdownTimeout,
          "How long requests may go on after SIGTERM");
}

void requireUsable(const ServeOptions& options) {
  const std::string problem = serveOptionsProblem(options);
  if (!problem.empty()) throw CLI::ValidationError(problem);
}

}  // namespace cimhost
