// SPDX-License-Identifier: Apache-2.0
// An exclusive lock between processes and threads, held while the object lives. A process that dies lets go of it.
#pragma once

#include <chrono>
#include <string>

#include "ground/Descriptor.h"

namespace QV {

class FileLock {
 public:
  // Locks the file, which is created if it is missing and stays. Throws std::runtime_error if it cannot be opened,
  // or if another holder has not let go of it when the time is up.
  FileLock(const std::string& path, std::chrono::milliseconds timeout);
  ~FileLock();
  FileLock(const FileLock&) = delete;
  FileLock& operator=(const FileLock&) = delete;

 private:
  Ground::Descriptor file_;
};

}  // namespace QV
