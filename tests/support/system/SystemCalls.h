// SPDX-License-Identifier: Apache-2.0
// A file system that fails by number: what a piece of work asks of the kernel, one system call after the other, and
// what becomes of it when one of them fails or the process dies there.
#pragma once

#include <array>
#include <cstdint>
#include <functional>
#include <optional>
#include <string>
#include <vector>

namespace Testing {

struct SystemCall {
  long number;
  std::array<std::uint64_t, 6> arguments;
  std::string path;  // of those that name one (open, rename, unlink, …): the last of them
  long result;       // negative: an errno
};

struct Intervention {
  unsigned call;             // counted from 1
  std::optional<int> error;  // what it fails with and does nothing; nothing: the process is killed there
};

struct TracedWork {
  std::vector<SystemCall> calls;  // those before a kill
  bool killed = false;
  std::optional<std::string> failure;  // the text of what it threw
};

// Does the work in a child process and looks at its system calls. Throws std::runtime_error where the machine lets
// nobody trace.
TracedWork traced(const std::function<void()>& work, const std::optional<Intervention>& intervention = std::nullopt);

}  // namespace Testing
