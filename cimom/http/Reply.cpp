// SPDX-License-Identifier: Apache-2.0
#include "cimom/http/Reply.h"

#include <sys/types.h>

#include <algorithm>
#include <cstdint>
#include <memory>
#include <string>
#include <utility>

namespace Cimom::Http {
namespace {

constexpr std::size_t chunkedFrom = 64 << 10;
constexpr std::size_t replyBlockSize = 16 << 10;

void freeBody(void* body) { delete static_cast<std::string*>(body); }

ssize_t readBody(void* handle, std::uint64_t position, char* buffer, std::size_t size) {
  const auto& body = *static_cast<const std::string*>(handle);
  if (position >= body.size()) {
    return MHD_CONTENT_READER_END_OF_STREAM;
  }
  const std::size_t count = std::min(size, body.size() - static_cast<std::size_t>(position));
  body.copy(buffer, count, static_cast<std::size_t>(position));
  return static_cast<ssize_t>(count);
}

MHD_Response* makeMessage(std::string text, bool isHttp11) {
  auto body = std::make_unique<std::string>(std::move(text));
  MHD_Response* message =
      isHttp11 && body->size() >= chunkedFrom
          ? MHD_create_response_from_callback(MHD_SIZE_UNKNOWN, replyBlockSize, &readBody, body.get(), &freeBody)
          : MHD_create_response_from_buffer_with_free_callback_cls(body->size(), body->data(), &freeBody, body.get());
  if (message) {
    static_cast<void>(body.release());
  }
  return message;
}

}  // namespace

Response refusal(unsigned status, const std::string& reason) {
  Response response{status, {}, reason + "\n"};
  response.headers.add("Content-Type", "text/plain; charset=\"utf-8\"");
  response.headers.add("Connection", "close");
  return response;
}

Response overload(const std::string& reason) {
  Response response = refusal(MHD_HTTP_SERVICE_UNAVAILABLE, reason);
  response.headers.add("Retry-After", "1");
  return response;
}

MHD_Result send(MHD_Connection* connection, Response response, bool isHttp11) {
  const std::unique_ptr<MHD_Response, decltype(&MHD_destroy_response)> message(
      makeMessage(std::move(response.body), isHttp11), &MHD_destroy_response);
  if (!message) {
    return MHD_NO;
  }
  for (const auto& [name, value] : response.headers) {
    if (MHD_add_response_header(message.get(), name.c_str(), value.c_str()) != MHD_YES) {
      return MHD_NO;
    }
  }
  return MHD_queue_response(connection, response.status, message.get());
}

}  // namespace Cimom::Http
