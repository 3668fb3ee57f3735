// SPDX-License-Identifier: Apache-2.0
#include "tests/support/agent/RecordingLog.h"

#include <TWLog/TWLog.h>
#include <gtest/gtest.h>

#include <algorithm>
#include <mutex>
#include <utility>

namespace Testing {

namespace {

bool recorded = true;
std::mutex mutex;

void record(Channel channel, const char* function, const char* file, int line, const std::string& component, int level,
            const std::string& message) {
  const std::lock_guard lock(mutex);
  if (recorded) {
    logLines().push_back({channel, function, file, line, component, level, message});
  }
}

}  // namespace

UnrecordedLog::UnrecordedLog() { recorded = false; }
UnrecordedLog::~UnrecordedLog() { recorded = true; }

std::vector<LogLine>& logLines() {
  static std::vector<LogLine> lines;
  return lines;
}

std::vector<LogLine> takeLog() {
  const std::lock_guard lock(mutex);
  return std::exchange(logLines(), {});
}

bool contains(const std::vector<LogLine>& lines, const std::string& component, int level, const std::string& text) {
  return std::ranges::any_of(lines, [&](const LogLine& line) {
    return line.channel == Channel::Log && line.component == component && line.level == level &&
           line.message.find(text) != std::string::npos;
  });
}

std::vector<std::string> messages(Channel channel) {
  std::vector<std::string> result;
  for (const LogLine& line : logLines()) {
    if (line.channel == channel) {
      result.push_back(line.message);
    }
  }
  return result;
}

std::vector<std::string> messagesWith(const std::string& prefix) {
  std::vector<std::string> result;
  for (const std::string& message : messages()) {
    if (message.starts_with(prefix)) {
      result.push_back(message);
    }
  }
  return result;
}

LogLine lineWith(const std::string& message) {
  for (const LogLine& line : logLines()) {
    if (line.channel == Channel::Log && line.message == message) {
      return line;
    }
  }
  ADD_FAILURE() << "no line in the log says: " << message;
  return {};
}

}  // namespace Testing

namespace TWLog {

TWMessageBuffer::TWMessageBuffer() = default;
TWMessageBuffer::~TWMessageBuffer() = default;

TWMessageBuffer& TWMessageBuffer::operator<<(const char* text) {
  text_ += text;
  return *this;
}

std::string str(TWMessageBuffer& buffer) { return std::exchange(buffer.text_, {}); }

void TWLogger::logLevelMessage(const char* function, const char* file, int line, const std::string& component,
                               int level, char* text, int first, int second, const std::string& message) {
  EXPECT_EQ(text, nullptr);
  EXPECT_EQ(first, 0);
  EXPECT_EQ(second, 0);
  Testing::record(Testing::Channel::Log, function, file, line, component, level, message);
}

void TWLogger::traceLevelMessage(const char* function, const char* file, int line, const std::string& component,
                                 int level, char* text, int first, int second, const std::string& message) {
  EXPECT_EQ(text, nullptr);
  EXPECT_EQ(first, 0);
  EXPECT_EQ(second, 0);
  Testing::record(Testing::Channel::Trace, function, file, line, component, level, message);
}

}  // namespace TWLog
