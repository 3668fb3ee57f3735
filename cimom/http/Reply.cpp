// SPDX-License-Identifier: Apache-2.0
#include "cimom/http/Reply.h"

#include <sys/types.h>

#include <algorithm>
#include <cstdint>
#include <memory>
#include <string>
#include <utility>
#include <vector>

namespace Cimom::Http {
namespace {

constexpr std::size_t chunkedFrom = 64 << 10;
constexpr std::size_t replyBlockSize = 16 << 10;

// A body that comes in pieces, and how far it has been read.
struct Reading {
  std::vector<std::string> pieces;
  std::size_t piece = 0;
  std::size_t position = 0;  // in the piece
};

void freeReading(void* reading) { delete static_cast<Reading*>(reading); }

// The HTTP library reads a body once, from its beginning to its end. What it has read is freed.
ssize_t readPieces(void* handle, std::uint64_t, char* buffer, std::size_t size) {
  auto& [pieces, piece, position] = *static_cast<Reading*>(handle);
  std::size_t filled = 0;
  while (filled < size && piece < pieces.size()) {
    const std::size_t count = pieces[piece].copy(buffer + filled, size - filled, position);
    filled += count;
    position += count;
    if (position == pieces[piece].size()) {
      std::string().swap(pieces[piece++]);
      position = 0;
    }
  }
  return filled > 0 ? static_cast<ssize_t>(filled) : MHD_CONTENT_READER_END_OF_STREAM;
}

void freeBody(void* body) { delete static_cast<std::string*>(body); }

MHD_Response* makeChunked(Response& response) {
  auto reading = std::make_unique<Reading>(Reading{std::move(response.more)});
  reading->pieces.insert(reading->pieces.begin(), std::move(response.body));
  MHD_Response* message =
      MHD_create_response_from_callback(MHD_SIZE_UNKNOWN, replyBlockSize, &readPieces, reading.get(), &freeReading);
  if (message) {
    static_cast<void>(reading.release());
  }
  return message;
}

MHD_Response* makeWhole(Response& response) {
  auto body = std::make_unique<std::string>(std::move(response.body));
  for (std::string& piece : response.more) {
    body->append(std::exchange(piece, {}));
  }
  MHD_Response* message =
      MHD_create_response_from_buffer_with_free_callback_cls(body->size(), body->data(), &freeBody, body.get());
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
      isHttp11 && response.size() >= chunkedFrom ? makeChunked(response) : makeWhole(response), &MHD_destroy_response);
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
