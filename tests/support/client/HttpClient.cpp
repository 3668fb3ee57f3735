// SPDX-License-Identifier: Apache-2.0
#include "tests/support/client/HttpClient.h"

#include <arpa/inet.h>
#include <netinet/in.h>
#include <netinet/tcp.h>
#include <sys/socket.h>
#include <unistd.h>

#include <array>
#include <cerrno>
#include <cstring>
#include <stdexcept>

namespace Testing {
namespace {

constexpr timeval patience{10, 0};

[[noreturn]] void fail(const char* what) { throw std::runtime_error(std::string(what) + ": " + std::strerror(errno)); }

}  // namespace

HttpClient::HttpClient(std::uint16_t port, const char* from) : socket_(socket(AF_INET, SOCK_STREAM | SOCK_CLOEXEC, 0)) {
  sockaddr_in address{};
  address.sin_family = AF_INET;
  inet_pton(AF_INET, from, &address.sin_addr);
  const int on = 1;
  setsockopt(socket_, IPPROTO_TCP, TCP_NODELAY, &on, sizeof on);
  setsockopt(socket_, SOL_SOCKET, SO_RCVTIMEO, &patience, sizeof patience);
  setsockopt(socket_, SOL_SOCKET, SO_SNDTIMEO, &patience, sizeof patience);
  const bool bound = bind(socket_, reinterpret_cast<const sockaddr*>(&address), sizeof address) == 0;
  address.sin_port = htons(port);
  address.sin_addr.s_addr = htonl(INADDR_LOOPBACK);
  if (bound && connect(socket_, reinterpret_cast<const sockaddr*>(&address), sizeof address) == 0) {
    return;
  }
  ::close(socket_);
  fail("connect");
}

HttpClient::~HttpClient() { ::close(socket_); }

bool HttpClient::send(std::string_view bytes) {
  while (!bytes.empty()) {
    const ssize_t sent = ::send(socket_, bytes.data(), bytes.size(), MSG_NOSIGNAL);
    if (sent < 0 && (errno == EPIPE || errno == ECONNRESET)) {
      return false;
    }
    if (sent < 0) {
      fail("send");
    }
    bytes.remove_prefix(static_cast<std::size_t>(sent));
  }
  return true;
}

void HttpClient::finish() const { shutdown(socket_, SHUT_WR); }

bool HttpClient::fill() {
  std::array<char, 65536> chunk{};
  const ssize_t received = recv(socket_, chunk.data(), chunk.size(), 0);
  if (received < 0 && errno != ECONNRESET) {
    fail("recv");
  }
  if (received <= 0) {
    return false;
  }
  buffer_.append(chunk.data(), static_cast<std::size_t>(received));
  return true;
}

bool HttpClient::isClosed() { return buffer_.empty() && !fill(); }

Cimom::Http::Response HttpClient::receive() {
  std::size_t end = 0;
  while ((end = buffer_.find("\r\n\r\n")) == std::string::npos) {
    if (!fill()) {
      throw std::runtime_error("the server closed the connection without a response");
    }
  }
  std::string head = buffer_.substr(0, end + 2);
  buffer_.erase(0, end + 4);
  Cimom::Http::Response response;
  response.status = static_cast<unsigned>(std::stoul(head.substr(head.find(' '))));
  for (auto line = head.find("\r\n") + 2; line < head.size(); line = head.find("\r\n", line) + 2) {
    const auto colon = head.find(':', line);
    const auto value = head.find_first_not_of(' ', colon + 1);
    response.headers.add(head.substr(line, colon - line), head.substr(value, head.find("\r\n", value) - value));
  }
  const std::string* length = response.headers.find("Content-Length");
  response.body = response.headers.find("Transfer-Encoding") ? takeChunks() : take(length ? std::stoul(*length) : 0);
  return response;
}

void HttpClient::fillTo(std::size_t size) {
  while (buffer_.size() < size) {
    if (!fill()) {
      throw std::runtime_error("the server closed the connection within a response");
    }
  }
}

std::string HttpClient::take(std::size_t size) {
  fillTo(size);
  std::string bytes = buffer_.substr(0, size);
  buffer_.erase(0, size);
  return bytes;
}

std::string HttpClient::takeChunks() {
  constexpr int hexadecimal = 16;
  std::string body;
  while (true) {
    while (buffer_.find("\r\n") == std::string::npos) {
      fillTo(buffer_.size() + 1);
    }
    const std::size_t size = std::stoul(take(buffer_.find("\r\n") + 2), nullptr, hexadecimal);
    body += take(size);
    take(2);
    if (size == 0) {
      return body;
    }
  }
}

std::string HttpClient::receiveSome() {
  if (buffer_.empty()) {
    fill();
  }
  return take(buffer_.size());
}

Cimom::Http::Response HttpClient::post(const std::string& path, const std::string& body,
                                       const std::string& moreHeaders) {
  send("POST " + path + " HTTP/1.1\r\nHost: localhost\r\nContent-Length: " + std::to_string(body.size()) + "\r\n" +
       moreHeaders + "\r\n" + body);
  return receive();
}

}  // namespace Testing
