#include "cimhost/serve/ServiceManager.h"

#include <sys/socket.h>
#include <sys/un.h>
#include <unistd.h>

#include <algorithm>
#include <cstddef>
#include <cstdlib>
#include <ctime>

namespace cimhost {

void notifyServiceManager(const std::string& state) {
  const char* const name = std::getenv("NOTIFY_SOCKET");
  if (name == nullptr || (name[0] != '/' && name[0] != '@')) return;
  const std::string path = name;
  sockaddr_un address{};
  address.sun_family = AF_UNIX;
  if (path.size() >= sizeof address.sun_path) return;
  std::copy(path.begin(), path.end(), address.sun_path);
  // An abstract name starts with a NUL.
  if (path[0] == '@') address.sun_path[0] = '\0';
  const int descriptor = socket(AF_UNIX, SOCK_DGRAM | SOCK_CLOEXEC, 0);
  if (descriptor < 0) return;
  const auto size = static_cast<socklen_t>(offsetof(sockaddr_un, sun_path) + path.size());
  static_cast<void>(sendto(descriptor, state.data(), state.size(), MSG_NOSIGNAL,
                           reinterpret_cast<const sockaddr*>(&address), size));
  close(descriptor);
}

std::string reloadingState() {
  timespec now{};
  clock_gettime(CLOCK_MONOTONIC, &now);
  const long long microseconds = static_cast<long long>(now.tv_sec) * 1000000 + now.tv_nsec / 1000;
  return "RELOADING=1\nMONOTONIC_USEC=" + std::to_string(microseconds);
}

}  // namespace cimhost
