// SPDX-License-Identifier: Apache-2.0
// How a message becomes one line of text.
#pragma once

#include <chrono>
#include <string>

namespace TWLog {

// What a caller of the logger hands over. The pointers may be null.
struct Message {
  const char* function;
  const char* file;
  int line;
  const std::string& component;
  int level;
  const std::string& text;
};

// "LEVEL COMPONENT FUNCTION (FILE:LINE): TEXT", without a line feed. Control characters are escaped as in C, and the
// backslash with them, so that one message is one line whatever it holds; bytes beyond ASCII stay as they are.
std::string describe(const Message& message);

// A line of a log file, line feed included: the time in UTC to the microsecond (ISO 8601), the process, the message.
std::string fileLine(std::chrono::system_clock::time_point time, int process, const Message& message);

}  // namespace TWLog
