#include "agent/backends/ipmi/session/IpmiLog.h"

#include "agent/log/Report.h"

namespace QV::Ipmi {
namespace {

constexpr const char* component = "Tarnwick.Ipmi";

}  // namespace

void logFailure(const std::string& text, std::experimental::source_location where) {
  TWLog::report(component, TWLog::failureLevel, text, where);
}

void logProgress(const std::string& text, std::experimental::source_location where) {
  TWLog::report(component, TWLog::progressLevel, text, where);
}

void trace(const std::string& text, std::experimental::source_location where) {
  TWLog::trace(component, TWLog::progressLevel, text, where);
}

}  // namespace QV::Ipmi
