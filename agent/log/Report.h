// SPDX-License-Identifier: Apache-2.0
// How the agent's own code reports: one line to the log and the same to the trace, with the place that it comes from.
#pragma once

#include <TWLog/TWLog.h>

#include <exception>
#include <experimental/source_location>
#include <string>
#include <string_view>

namespace TWLog {

// The two levels of the agent's lines, as agent.ini's thresholds count them.
constexpr int progressLevel = 4000;
constexpr int failureLevel = 6000;

using SourceLocation = std::experimental::source_location;

namespace Detail {

using Send = void(const char* function, const char* file, int line, const std::string& component, int level, char*, int,
                  int, const std::string& message);

// The unit is shown by its bare name, without folder and extension. A line that memory runs out for is lost, and what
// it is about goes on.
inline void send(Send& channel, const char* component, int level, std::string_view text,
                 const SourceLocation& where) noexcept {
  try {
    std::string_view unit = where.file_name();
    unit.remove_prefix(unit.find_last_of('/') + 1);
    unit = unit.substr(0, unit.find('.'));
    channel(where.function_name(), std::string(unit).c_str(), static_cast<int>(where.line()), component, level, nullptr,
            0, 0, std::string(text));
  } catch (const std::exception&) {
  }
}

}  // namespace Detail

// A line to the trace alone.
inline void trace(const char* component, int level, std::string_view text,
                  const SourceLocation& where = SourceLocation::current()) noexcept {
  Detail::send(TWLogger::traceLevelMessage, component, level, text, where);
}

// A line to the log and to the trace.
inline void report(const char* component, int level, std::string_view text,
                   const SourceLocation& where = SourceLocation::current()) noexcept {
  Detail::send(TWLogger::logLevelMessage, component, level, text, where);
  trace(component, level, text, where);
}

}  // namespace TWLog
