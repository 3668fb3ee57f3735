#include "tests/agent/backends/ipmi/RecordedLog.h"

#include <TWLog/TWLog.h>

#include <algorithm>
#include <mutex>
#include <utility>

namespace {

std::mutex mutex;
std::vector<IpmiFixture::LogLine> lines;

void record(bool trace, const std::string& component, int level, const std::string& text) {
  const std::lock_guard lock(mutex);
  lines.push_back({trace, component, level, text});
}

}  // namespace

namespace TWLog {

void TWLogger::logLevelMessage(const char*, const char*, int, const std::string& component, int level, char*, int, int,
                               const std::string& message) {
  record(false, component, level, message);
}

void TWLogger::traceLevelMessage(const char*, const char*, int, const std::string& component, int level, char*, int,
                                 int, const std::string& message) {
  record(true, component, level, message);
}

}  // namespace TWLog

namespace IpmiFixture {

std::vector<LogLine> takeLog() {
  const std::lock_guard lock(mutex);
  return std::exchange(lines, {});
}

bool contains(const std::vector<LogLine>& log, int level, const std::string& text) {
  return std::any_of(log.begin(), log.end(), [&](const LogLine& line) {
    return !line.trace && line.component == "Tarnwick.Ipmi" && line.level == level &&
           line.text.find(text) != std::string::npos;
  });
}

}  // namespace IpmiFixture
