// SPDX-License-Identifier: Apache-2.0
#pragma once

#include <chrono>
#include <cstdint>
#include <string>
#include <string_view>

#include "cimom/http/Message.h"

namespace Testing {

// A client's end of a connection to 127.0.0.1, byte by byte, so that a test can send what no decent client would.
// What fails, or takes longer than its patience, throws std::runtime_error.
class HttpClient {
 public:
  // @param from the address that it comes from, any of 127.0.0.0/8
  explicit HttpClient(std::uint16_t port, const char* from = "127.0.0.1",
                      std::chrono::seconds patience = std::chrono::seconds(60));
  ~HttpClient();
  HttpClient(const HttpClient&) = delete;
  HttpClient& operator=(const HttpClient&) = delete;

  // Returns false if the server has closed its end.
  bool send(std::string_view bytes);

  // Sends no more: the server reads the end of what there is.
  void finish() const;

  // The next response, its body decoded where it is chunked; one with status 100 counts.
  Cimom::Http::Response receive();

  // Bytes of a response, at least one; empty once the server has closed the connection.
  std::string receiveSome();

  // Whether the server closes the connection without another byte.
  bool isClosed();

  // POST with a Content-Length, on this connection.
  Cimom::Http::Response post(const std::string& path, const std::string& body, const std::string& moreHeaders = {});

 private:
  bool fill();
  void fillTo(std::size_t size);
  std::string take(std::size_t size);
  std::string takeChunks();

  int socket_;
  std::string buffer_;
};

}  // namespace Testing
