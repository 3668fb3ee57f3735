// The agent's log, as a list that tests read.
#pragma once

#include <string>
#include <vector>

namespace IpmiFixture {

struct LogLine {
  bool trace;  // else the log
  std::string component;
  int level;
  std::string text;
};

// What has been logged and traced since the list was last taken.
std::vector<LogLine> takeLog();

// Whether a line of the log, not of the trace, has that level and contains that text.
bool contains(const std::vector<LogLine>& log, int level, const std::string& text);

}  // namespace IpmiFixture
