#pragma once

#include <stdexcept>
#include <string>

namespace cimhost {

/// A request that is refused before any operation runs: an HTTP status, the value of the header
/// CIMError (DSP0200, 7.3; nullptr for none) and, in what(), the reason for a person.
class HttpError : public std::runtime_error {
 public:
  HttpError(int status, const char* cimError, const std::string& reason)
      : std::runtime_error(reason), status_(status), cimError_(cimError) {}

  int status() const { return status_; }
  const char* cimError() const { return cimError_; }

 private:
  int status_;
  const char* cimError_;
};

[[noreturn]] inline void throwNotValid(const std::string& reason) {
  throw HttpError(400, "request-not-valid", reason);
}

}  // namespace cimhost
