// SPDX-License-Identifier: Apache-2.0
// Stands in for the agent's logging library: keeps every line that reaches either channel, in order.
#pragma once

#include <string>
#include <vector>

namespace Testing {

enum class Channel { Log, Trace };

struct LogLine {
  Channel channel;
  std::string function;
  std::string file;
  int line;
  std::string component;
  int level;
  std::string message;
};

// Everything sent since the last clear or takeLog().
std::vector<LogLine>& logLines();

// The same, and nothing is kept of it. Lines may come in from other threads meanwhile.
std::vector<LogLine> takeLog();

// Whether a line of the log, not of the trace, has that component and level and contains that text.
bool contains(const std::vector<LogLine>& lines, const std::string& component, int level, const std::string& text);

// While one lives, nothing is kept: the lines of a walk over tens of thousands of instances cost more than the walk.
class UnrecordedLog {
 public:
  UnrecordedLog();
  ~UnrecordedLog();
  UnrecordedLog(const UnrecordedLog&) = delete;
  UnrecordedLog& operator=(const UnrecordedLog&) = delete;
};

// The messages of one channel, in order.
std::vector<std::string> messages(Channel channel = Channel::Log);

// The messages of the log that begin with a prefix, in order.
std::vector<std::string> messagesWith(const std::string& prefix);

// The first line of the log with that message; fails the running test and yields an empty line if there is none.
LogLine lineWith(const std::string& message);

}  // namespace Testing
