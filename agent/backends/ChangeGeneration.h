// SPDX-License-Identifier: Apache-2.0
// A number in a small file, by which processes tell each other that something they all look at was changed: a look is
// still true where the number is what it was before the look was begun.
#pragma once

#include <cstdint>
#include <filesystem>

namespace QV {

// Nothing is kept between two calls, neither descriptor nor mapping: the file may be removed, replaced or cut short at
// any time, and a process may fork. Safe to call from several threads and processes at once.
class ChangeGeneration {
 public:
  using Number = std::uint64_t;

  explicit ChangeGeneration(std::filesystem::path file) : file_(std::move(file)) {}

  // The number as it is now. The first call of all makes the file, for its owner and group, and a directory that is
  // missing. Throws std::runtime_error that names the file and why it cannot be used: it cannot be opened for reading
  // and writing, is a link or anything else that is no regular file, or has content that is not ours.
  Number current() const;

  // Gives it a number that it never had. Throws as current() does, and if the file cannot be written.
  void renew() const;

 private:
  const std::filesystem::path file_;
};

}  // namespace QV
