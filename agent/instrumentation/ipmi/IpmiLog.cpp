#include "instrumentation/ipmi/IpmiLog.h"

#include <TWLog/TWLog.h>

#include <string_view>

namespace QV::Ipmi {
namespace {

constexpr int progressLevel = 4000;
constexpr int failureLevel = 6000;

const std::string& component() {
  static const std::string name = "Tarnwick.Ipmi";
  return name;
}

// The bare unit name, without folder and extension, as the agent's other lines show it.
std::string unitOf(std::string_view file) {
  file.remove_prefix(file.find_last_of('/') + 1);
  return std::string(file.substr(0, file.find('.')));
}

void toTrace(const std::string& text, int level, const std::experimental::source_location& where) {
  TWLog::TWLogger::traceLevelMessage(where.function_name(), unitOf(where.file_name()).c_str(),
                                     static_cast<int>(where.line()), component(), level, nullptr, 0, 0, text);
}

void toLogAndTrace(const std::string& text, int level, const std::experimental::source_location& where) {
  TWLog::TWLogger::logLevelMessage(where.function_name(), unitOf(where.file_name()).c_str(),
                                   static_cast<int>(where.line()), component(), level, nullptr, 0, 0, text);
  toTrace(text, level, where);
}

}  // namespace

void logFailure(const std::string& text, std::experimental::source_location where) {
  toLogAndTrace(text, failureLevel, where);
}
void logProgress(const std::string& text, std::experimental::source_location where) {
  toLogAndTrace(text, progressLevel, where);
}
void trace(const std::string& text, std::experimental::source_location where) { toTrace(text, progressLevel, where); }

}  // namespace QV::Ipmi
