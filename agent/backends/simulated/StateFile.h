// SPDX-License-Identifier: Apache-2.0
// A file that is always one whole text, the old or the new one, whatever happens to its writers.
#pragma once

#include <sys/types.h>

#include <chrono>
#include <filesystem>
#include <functional>
#include <optional>
#include <string>

namespace QV {

class StateFile {
 public:
  // What tells the file from every other that has its name at another time, and its content from every other.
  struct Version {
    dev_t device;
    ino_t inode;
    off_t size;
    std::chrono::nanoseconds changedAt;  // the time that the system itself sets with every change

    bool operator==(const Version&) const = default;
  };

  // `path` may be a symbolic link: its target, as it is at each use, is what is read and replaced.
  explicit StateFile(std::filesystem::path path) : path_(std::move(path)) {}

  const std::filesystem::path& path() const { return path_; }

  // Throws std::runtime_error if this user cannot read or replace the file. A missing directory is made, else
  // nothing.
  void requireWritable() const;

  // The text; nothing if there is no file. Throws std::runtime_error if it cannot be read.
  std::optional<std::string> read() const;

  // The version that a following read() returns, or an earlier one; nothing where there is no file or where it has
  // changed just now: the system's clock of changes is coarse, and the next change might look the same.
  std::optional<Version> version() const;

  // Replaces the text by what `edit` makes of the current one, alone among all processes (the lock is the file's name
  // with ".lock" after it), and leaves it where `edit` returns the current one; a missing directory is made. What
  // `edit` throws passes through, and the file stays. Returns when the new text is on the disk; a new file is for its
  // owner and group, an existing one keeps mode and owner. Throws std::runtime_error if it cannot be written; the file
  // is then the old one, or the text says that it is replaced and that only its new name may not be on the disk.
  void update(const std::function<std::string(const std::optional<std::string>& current)>& edit) const;

 private:
  std::filesystem::path path_;
};

}  // namespace QV
