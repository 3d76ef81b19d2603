#include "cimhost/http/HttpRequest.h"

#include <strings.h>

#include <algorithm>
#include <charconv>

namespace cimhost {

namespace {

constexpr const char* kMandatoryUri = "http://www.dmtf.org/cim/mapping/http/v1.0";
constexpr std::size_t kUsualHeaders = 12;
constexpr const char* kReplyUri = "http://www.dmtf.org/cim/operation";

bool isDigit(char character) {
  return character >= '0' && character <= '9';
}

std::string_view trimmed(std::string_view text) {
  constexpr const char* kBlanks = " \t";
  const std::size_t first = text.find_first_not_of(kBlanks);
  if (first == std::string_view::npos) return {};
  return text.substr(first, text.find_last_not_of(kBlanks) - first + 1);
}

std::string_view unquoted(std::string_view text) {
  const bool quoted = text.size() >= 2 && text.front() == '"' && text.back() == '"';
  return quoted ? text.substr(1, text.size() - 2) : text;
}

// The declaration's number in `http://... ; ns=73`: two digits (RFC 2774, 3).
std::string_view namespaceNumber(std::string_view parameters) {
  while (!parameters.empty()) {
    const std::size_t end = std::min(parameters.find(';'), parameters.size());
    const std::string_view parameter = trimmed(parameters.substr(0, end));
    parameters.remove_prefix(std::min(end + 1, parameters.size()));
    const std::size_t equals = parameter.find('=');
    if (equals == std::string_view::npos || trimmed(parameter.substr(0, equals)) != "ns") continue;
    const std::string_view number = trimmed(parameter.substr(equals + 1));
    const bool valid = number.size() == 2 && isDigit(number[0]) && isDigit(number[1]);
    return valid ? number : std::string_view();
  }
  return {};
}

bool startsWithCim(const std::string& name) {
  return strncasecmp(name.c_str(), "CIM", 3) == 0;
}

}  // namespace

void HttpRequest::addHeader(std::string_view name, std::string_view value) {
  if (headers_.empty()) headers_.reserve(kUsualHeaders);
  headers_.emplace_back(name, value);
}

const std::string* HttpRequest::find(std::string_view name) const {
  for (const auto& [each, value] : headers_) {
    const bool same =
        each.size() == name.size() && strncasecmp(each.data(), name.data(), name.size()) == 0;
    if (same) return &value;
  }
  return nullptr;
}

std::optional<std::string> HttpRequest::header(std::string_view name) const {
  const std::string* value = prefix_.empty() ? find(name) : find(prefix_ + std::string(name));
  if (value == nullptr) return std::nullopt;
  return *value;
}

bool HttpRequest::hasBody() const {
  const std::string* length = find("Content-Length");
  return (length != nullptr && *length != "0") || find("Transfer-Encoding") != nullptr;
}

std::optional<std::uint64_t> HttpRequest::contentLength() const {
  const std::string* text = find("Content-Length");
  std::uint64_t length = 0;
  if (text == nullptr) return std::nullopt;
  const char* end = text->data() + text->size();
  const auto [stop, error] = std::from_chars(text->data(), end, length);
  if (error != std::errc() || stop != end) return std::nullopt;
  return length;
}

std::optional<Rejection> HttpRequest::checkHeaders(std::size_t maximumBody) {
  if (method_ != "POST" && method_ != "M-POST") {
    return Rejection{501, "only POST and M-POST carry CIM operations", {}};
  }
  const bool version10 = version_ == "HTTP/1.0";
  if (!version10 && find("Host") == nullptr) return Rejection{400, "no Host header", {}};
  if (method_ == "M-POST") {
    if (version10) return Rejection{400, "M-POST needs HTTP/1.1", {}};
    if (auto problem = checkMandatory()) return problem;
  }
  if (contentLength().value_or(0) > maximumBody) {
    return Rejection{
        413, "requests may have " + std::to_string(maximumBody) + " bytes at most", {}};
  }
  return std::nullopt;
}

std::optional<Rejection> HttpRequest::checkMandatory() {
  const std::string* text = find("Man");
  if (text == nullptr) return Rejection{400, "M-POST without a Man header", {}};
  const std::string_view all = *text;
  const std::size_t end = std::min(all.find(';'), all.size());
  if (unquoted(trimmed(all.substr(0, end))) != kMandatoryUri) {
    return Rejection{510, "the Man header names an unknown extension", {}};
  }
  const std::string_view number = namespaceNumber(all.substr(std::min(end + 1, all.size())));
  if (number.empty()) return Rejection{400, "the Man header has no ns=NN", {}};
  prefix_ = std::string(number) + "-";
  return std::nullopt;
}

HttpHeaders HttpRequest::replyHeaders(HttpHeaders headers) const {
  if (prefix_.empty()) return headers;
  // RFC 2774, 5: the reply tells that the mandatory extension has been applied.
  HttpHeaders result = {
      {"Ext", ""},
      {"Cache-Control", "no-cache"},
      {"Man", std::string(kReplyUri) + "; ns=" + prefix_.substr(0, 2)},
  };
  for (const auto& [name, value] : headers) {
    result.emplace_back(startsWithCim(name) ? prefix_ + name : name, value);
  }
  return result;
}

}  // namespace cimhost
