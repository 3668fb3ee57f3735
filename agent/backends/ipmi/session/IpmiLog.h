// The back end's lines in the agent's log and trace, under the component "Tarnwick.Ipmi".
#pragma once

#include <experimental/source_location>
#include <string>

namespace QV::Ipmi {

// What an administrator must know of: level 6000, to the log and to the trace.
void logFailure(const std::string& text,
                std::experimental::source_location where = std::experimental::source_location::current());

// What went its ordinary way: level 4000, to the log and to the trace.
void logProgress(const std::string& text,
                 std::experimental::source_location where = std::experimental::source_location::current());

// What only a look into the exchange with the hardware needs: level 4000, to the trace alone.
void trace(const std::string& text,
           std::experimental::source_location where = std::experimental::source_location::current());

}  // namespace QV::Ipmi
