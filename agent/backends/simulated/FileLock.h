// An exclusive lock between processes, held while the object lives. A process that dies lets go of it.
#pragma once

#include <chrono>
#include <string>

namespace QV {

class FileLock {
 public:
  // Locks the file, which is created where it is missing and stays. Throws std::runtime_error where it cannot be opened
  // or where another holder has not let go of it when the time is up.
  FileLock(const std::string& path, std::chrono::milliseconds timeout);
  ~FileLock();
  FileLock(const FileLock&) = delete;
  FileLock& operator=(const FileLock&) = delete;

 private:
  int descriptor_;
};

}  // namespace QV
