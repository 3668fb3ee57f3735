// SPDX-License-Identifier: Apache-2.0
#pragma once

#include <TWLog/TWLog.h>

#include <string>

namespace Testing {

// Sends that many lines to the trace channel, as a provider's frame is.
inline void sendFrameLines(int count) {
  const std::string component = "Tarnwick.IPConfigProvider";
  const std::string text =
      "ENTERING: IPProtocolendpt_EnumInstances() in IPProtocolEndpointProvider [Line: 123], of the namespace "
      "root/cimv2";
  for (; count > 0; --count) {
    TWLog::TWLogger::traceLevelMessage("IPProtocolendpt_EnumInstances", "IPProtocolEndpointProvider", 123, component,
                                       4000, nullptr, 0, 0, text);
  }
}

}  // namespace Testing
