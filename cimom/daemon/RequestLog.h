// SPDX-License-Identifier: Apache-2.0
#pragma once

#include <filesystem>
#include <mutex>

#include "cimom/http/Server.h"
#include "ground/Descriptor.h"

namespace Cimom {

// A line for each request: time, address, user, HTTP status, milliseconds, and what was asked. The file is made where
// it is not there, for its owner and group to read.
class RequestLog {
 public:
  // "-" is the standard output. Throws Http::ServerError.
  explicit RequestLog(std::filesystem::path file);

  // May be called from several threads at once.
  void write(const Http::RequestRecord& record);

  // Goes on in the file that has the name now, as log rotation wants it. Throws Http::ServerError, and goes on in the
  // old one.
  void reopen();

 private:
  Ground::Descriptor open() const;

  const std::filesystem::path file_;
  std::mutex mutex_;
  Ground::Descriptor descriptor_;
};

}  // namespace Cimom
