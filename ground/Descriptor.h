// SPDX-License-Identifier: Apache-2.0
// An open file, closed with the object.
#pragma once

#include <fcntl.h>
#include <unistd.h>

#include <filesystem>
#include <utility>

namespace Ground {

class Descriptor {
 public:
  Descriptor() = default;  // not open
  // Takes over an open descriptor, or -1.
  explicit Descriptor(int number) : number_(number) {}
  // Opens the file as open(2) does, not to be inherited by programs that the process starts. `errno` says why a
  // descriptor is not open.
  Descriptor(const std::filesystem::path& path, int flags, mode_t mode = 0)
      : number_(::open(path.c_str(), flags | O_CLOEXEC, mode)) {}
  Descriptor(Descriptor&& other) noexcept : number_(std::exchange(other.number_, -1)) {}
  Descriptor& operator=(Descriptor&& other) noexcept {
    std::swap(number_, other.number_);
    return *this;
  }
  ~Descriptor() {
    if (isOpen()) {
      ::close(number_);
    }
  }
  Descriptor(const Descriptor&) = delete;
  Descriptor& operator=(const Descriptor&) = delete;

  bool isOpen() const { return number_ >= 0; }
  int number() const { return number_; }

 private:
  int number_ = -1;
};

}  // namespace Ground
