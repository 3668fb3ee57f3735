// SPDX-License-Identifier: Apache-2.0
// The back end's lines in the agent's log and trace, under the component "Tarnwick.Ipmi".
#pragma once

#include <string>

#include "agent/log/Report.h"

namespace QV::Ipmi {

inline constexpr const char* logComponent = "Tarnwick.Ipmi";

// What an administrator must know of: level 6000, to the log and to the trace.
inline void logFailure(const std::string& text, const TWLog::SourceLocation& where = TWLog::SourceLocation::current()) {
  TWLog::report(logComponent, TWLog::failureLevel, text, where);
}

// What went its ordinary way: level 4000, to the log and to the trace.
inline void logProgress(const std::string& text,
                        const TWLog::SourceLocation& where = TWLog::SourceLocation::current()) {
  TWLog::report(logComponent, TWLog::progressLevel, text, where);
}

// What only a look into the exchange with the hardware needs: level 4000, to the trace alone.
inline void trace(const std::string& text, const TWLog::SourceLocation& where = TWLog::SourceLocation::current()) {
  TWLog::trace(logComponent, TWLog::progressLevel, text, where);
}

}  // namespace QV::Ipmi
