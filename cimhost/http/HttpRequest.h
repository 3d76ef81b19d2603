#pragma once

#include "cimhost/http/Rejection.h"
#include "cimhost/xml/CimXmlService.h"

#include <cstdint>
#include <optional>
#include <string>
#include <string_view>

namespace cimhost {

/// One HTTP request as CIM operations are sent (DSP0200, 7): headers first, then body bytes.
///
/// Filled by one thread, read by another one after it.
class HttpRequest final : public CimXmlRequest {
 public:
  /// Method and version as the request line has them.
  void setRequestLine(const std::string& method, const std::string& version) {
    method_ = method;
    version_ = version;
  }
  /// Of a header that comes twice, the first value counts.
  void addHeader(std::string_view name, std::string_view value);
  /// Once all headers are there: why the request cannot be one for CIM operations, whatever its
  /// body is. Reads the Man header of M-POST (RFC 2774).
  std::optional<Rejection> checkHeaders(std::size_t maximumBody);
  void appendBody(const char* bytes, std::size_t size) { body_.append(bytes, size); }
  /// Gives the body's memory back.
  void dropBody() { std::string().swap(body_); }
  void setUser(const std::string& user) { user_ = user; }

  std::optional<std::string> header(std::string_view name) const override;
  std::string_view body() const override { return body_; }
  std::string_view user() const override { return user_; }

  /// True when bytes follow the headers.
  bool hasBody() const;
  /// What Content-Length says; nullopt when it is absent, or no number.
  std::optional<std::uint64_t> contentLength() const;
  /// The headers to send for those of a reply: of M-POST the CIM ones carry the request's prefix.
  HttpHeaders replyHeaders(HttpHeaders headers) const;

 private:
  const std::string* find(std::string_view name) const;
  std::optional<Rejection> checkMandatory();

  std::string method_;
  std::string version_;
  HttpHeaders headers_;
  std::string prefix_;  // "73-" of M-POST
  std::string body_;
  std::string user_;
};

}  // namespace cimhost
