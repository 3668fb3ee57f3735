// SPDX-License-Identifier: Apache-2.0
#include "tests/faults/model/Report.h"

#include <TWLog/TWLog.h>

namespace Testing::Model {

namespace {

const std::string rule(78, '=');
constexpr std::size_t longest = 511;

// To the log first, then to the trace.
void send(const std::string& component, const std::string& file, const std::string& function, int level, int line,
          const std::string& text) {
  const std::string cut = text.substr(0, longest);
  TWLog::TWMessageBuffer buffer;
  buffer << cut.c_str();
  TWLog::TWLogger::logLevelMessage(function.c_str(), file.c_str(), line, component, level, nullptr, 0, 0,
                                   TWLog::str(buffer));
  buffer << cut.c_str();
  TWLog::TWLogger::traceLevelMessage(function.c_str(), file.c_str(), line, component, level, nullptr, 0, 0,
                                     TWLog::str(buffer));
}

}  // namespace

std::string Report::place(int line) const {
  return function + "() in " + file + " [Line: " + std::to_string(line) + ']';
}

void Report::entering(int line) const { send(component, file, function, ordinary, line, "ENTERING: " + place(line)); }

void Report::exiting(int line) const { send(component, file, function, ordinary, line, "EXITING: " + place(line)); }

void Report::message(const std::string& text, int level, int line) const {
  send(component, file, function, level, line,
       "MESSAGE [File: " + file + ", Line: " + std::to_string(line) + "]: " + text);
}

void Report::variable(const char* name, const std::string& value, int line) const {
  send(component, file, function, ordinary, line,
       std::string("VARIABLE: '") + name + "' has Value '" + value + "' at line " + std::to_string(line) + " in " +
           file);
}

// The location that the logger sees is the frame's own.
void Report::operationEntry(int line) const {
  send(component, "Trace.h", "markProviderEntry", ordinary, 336, rule);
  send(component, "Trace.h", "markProviderEntry", ordinary, 337, "ENTERING: " + place(line));
}

void Report::operationExit(int line) const {
  send(component, "Trace.h", "markProviderExit", ordinary, 348, "EXITING: " + place(line));
  send(component, "Trace.h", "markProviderExit", ordinary, 349, rule);
}

Report memberReport(const char* function) { return {"Tarnwick.IPObjectFactory", "IPConfigObjectFactory", function}; }

}  // namespace Testing::Model
