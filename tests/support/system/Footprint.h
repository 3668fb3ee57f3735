// SPDX-License-Identifier: Apache-2.0
// What a process holds: its memory and its descriptors.
#pragma once

#include <sys/types.h>

#include <cstddef>
#include <string>
#include <vector>

#include "tests/support/system/Build.h"

namespace Testing {

// What it has in memory, in KiB, and the most that it ever had; 0 if it has ended.
long residentKib(pid_t process);
long peakResidentKib(pid_t process);

// How much more it may have at the end: an allocator grows in steps, and the sanitizers keep what has been freed and
// where it came from.
inline const long toleratedKib = sanitized() ? 256 << 10 : 2 << 10;

// What its descriptors lead to, sorted: "socket", "/var/log/agent.log" and the like. Without what is open for a moment.
std::vector<std::string> descriptorsOf(pid_t process);

// A number that the environment gives to a long run; else the one of the short run, which the suite has.
std::size_t configured(const char* variable, std::size_t otherwise);

}  // namespace Testing
