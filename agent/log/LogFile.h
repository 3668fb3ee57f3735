// SPDX-License-Identifier: Apache-2.0
// A log file that several processes may share and that may be rotated away at any time.
#pragma once

#include <sys/types.h>

#include <chrono>
#include <mutex>
#include <string>
#include <string_view>

#include "ground/Descriptor.h"

namespace TWLog {

class LogFile {
 public:
  explicit LogFile(std::string path) : path_(std::move(path)) {}
  LogFile(const LogFile&) = delete;
  LogFile& operator=(const LogFile&) = delete;

  const std::string& path() const { return path_; }

  // Appends a line with a single write, so that the lines of several processes do not mix. Opens the file on first use,
  // and again if the path no longer names the open file, which is looked at every `lookInterval`: until then lines go
  // to the file that they went to. Returns 0, else the errno that kept the line out; the next line tries again. Safe to
  // call from several threads at once.
  int append(std::string_view line);

  static constexpr std::chrono::milliseconds lookInterval{10};

 private:
  int openIfNeeded();
  bool isCurrent() const;

  const std::string path_;
  std::mutex mutex_;
  Ground::Descriptor file_;
  dev_t device_ = 0;
  ino_t inode_ = 0;
  std::chrono::nanoseconds lookedAt_{0};
};

}  // namespace TWLog
