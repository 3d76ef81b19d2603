#pragma once

#include <stdexcept>

namespace cimhost {

/// Why the host cannot start or stop properly: home directory, provider library, configuration.
/// what() is one line for the user, without the program's name.
class HostError : public std::runtime_error {
 public:
  using std::runtime_error::runtime_error;
};

}  // namespace cimhost
