#pragma once

#include <arpa/inet.h>
#include <netinet/in.h>
#include <poll.h>
#include <sys/socket.h>
#include <unistd.h>

#include <cstdint>
#include <cstdlib>
#include <map>
#include <stdexcept>
#include <string>

/// One reply, as it came over the wire.
struct HttpReply {
  int status = 0;                              ///< 0: none came.
  std::map<std::string, std::string> headers;  ///< Names as sent.
  std::string body;
  bool complete = false;  ///< Length or last chunk were there.
  bool chunked = false;

  std::string header(const std::string& name) const {
    const auto found = headers.find(name);
    return found == headers.end() ? std::string() : found->second;
  }
};

/// A client on a socket of its own that sends bytes as they are and reads replies one by one.
class HttpClient {
 public:
  static constexpr int kPatience = 20000;

  explicit HttpClient(std::uint16_t port, int receiveBuffer = 0)
      : socket_(socket(AF_INET, SOCK_STREAM | SOCK_CLOEXEC, 0)) {
    if (receiveBuffer > 0) {
      setsockopt(socket_, SOL_SOCKET, SO_RCVBUF, &receiveBuffer, sizeof receiveBuffer);
    }
    sockaddr_in address{};
    address.sin_family = AF_INET;
    address.sin_port = htons(port);
    address.sin_addr.s_addr = htonl(INADDR_LOOPBACK);
    connected_ = connect(socket_, reinterpret_cast<sockaddr*>(&address), sizeof address) == 0;
  }
  ~HttpClient() { close(); }
  HttpClient(const HttpClient&) = delete;
  HttpClient& operator=(const HttpClient&) = delete;

  bool isConnected() const { return connected_; }

  void close() {
    if (socket_ >= 0) ::close(socket_);
    socket_ = -1;
  }

  void send(const std::string& bytes) {
    std::size_t sent = 0;
    while (sent < bytes.size()) {
      const ssize_t part = ::send(socket_, bytes.data() + sent, bytes.size() - sent, MSG_NOSIGNAL);
      if (part <= 0) return;  // What the server answers tells why.
      sent += static_cast<std::size_t>(part);
    }
  }

  HttpReply receive() {
    HttpReply reply;
    std::string line;
    if (!readLine(line) || line.size() < 12) return reply;
    reply.status = std::atoi(line.c_str() + 9);
    if (reply.status == 100) {
      readLine(line);
      return receive();
    }
    while (readLine(line) && !line.empty()) {
      const std::size_t colon = line.find(':');
      const std::size_t value = line.find_first_not_of(' ', colon + 1);
      reply.headers[line.substr(0, colon)] = value == std::string::npos ? "" : line.substr(value);
    }
    readBody(reply);
    return reply;
  }

  HttpReply ask(const std::string& bytes) {
    send(bytes);
    return receive();
  }

  /// True when the server has closed the connection, within the time of patience.
  bool isClosed() {
    while (fill()) buffer_.clear();
    return closed_;
  }

  /// Takes at most `size` bytes off the wire; returns how many came.
  std::size_t take(std::size_t size) {
    if (buffer_.empty()) fill();
    const std::size_t part = std::min(size, buffer_.size());
    buffer_.erase(0, part);
    return part;
  }

 private:
  bool fill() {
    pollfd entry{socket_, POLLIN, 0};
    if (poll(&entry, 1, kPatience) <= 0) return false;
    char bytes[16384];
    const ssize_t got = recv(socket_, bytes, sizeof bytes, 0);
    closed_ = got <= 0;
    if (closed_) return false;
    buffer_.append(bytes, static_cast<std::size_t>(got));
    return true;
  }

  bool readLine(std::string& line) {
    std::size_t end = 0;
    while ((end = buffer_.find("\r\n")) == std::string::npos) {
      if (!fill()) return false;
    }
    line = buffer_.substr(0, end);
    buffer_.erase(0, end + 2);
    return true;
  }

  bool readBytes(std::size_t size, std::string& bytes) {
    while (buffer_.size() < size) {
      if (!fill()) return false;
    }
    bytes.append(buffer_, 0, size);
    buffer_.erase(0, size);
    return true;
  }

  void readBody(HttpReply& reply) {
    reply.chunked = reply.header("Transfer-Encoding") == "chunked";
    if (!reply.chunked) {
      reply.complete =
          readBytes(std::strtoul(reply.header("Content-Length").c_str(), nullptr, 10), reply.body);
      return;
    }
    for (std::string line; readLine(line);) {
      const std::size_t size = std::strtoul(line.c_str(), nullptr, 16);
      if (!readBytes(size, reply.body) || !readLine(line)) return;
      reply.complete = size == 0;
      if (reply.complete) return;
    }
  }

  int socket_;
  bool connected_ = false;
  bool closed_ = false;
  std::string buffer_;
};
