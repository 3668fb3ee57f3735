// SPDX-License-Identifier: Apache-2.0
// One open session with the management processor: the thin layer over libfreeipmi.
#pragma once

#include <chrono>
#include <memory>

#include "agent/backends/ipmi/session/IpmiTransport.h"
#include "agent/backends/ipmi/settings/IpmiSettings.h"

struct ipmi_ctx;

namespace QV::Ipmi {

// Not safe to share between threads without a lock. Closed by its destructor, which over LAN takes one round trip and
// at most a retransmission time-out more.
class IpmiSession {
 public:
  // Opens the session. Over LAN that costs `openingRoundTrips` and ends within the session time-out and two
  // retransmission time-outs. Throws NotSent in words that name the processor and what to do.
  explicit IpmiSession(const IpmiSettings& settings);

  // Throws ConnectionLost if no answer came within the session time-out; the session is of no use any more then.
  IpmiResponse send(const IpmiRequest& request);

  // libfreeipmi counts the session time-out from the last answer, even while nothing is asked, and sends nothing any
  // more once it is over, not even a close. A session that has been idle for half of it is therefore to be closed while
  // that is possible; until then a request has at least the other half to be answered in.
  static std::chrono::milliseconds longestIdle(const IpmiSettings& settings) { return settings.sessionTimeout / 2; }

  std::chrono::steady_clock::duration idle() const { return Clock::now() - lastAnswer_; }

  // Get Channel Authentication Capabilities, Open Session, RAKP 1 and 3, Set Session Privilege Level (IPMI 2.0, 13.15);
  // the operating system's driver needs none.
  static unsigned openingRoundTrips(const IpmiSettings& settings);

 private:
  using Clock = std::chrono::steady_clock;
  struct Close {
    void operator()(ipmi_ctx* context) const;
  };

  std::unique_ptr<ipmi_ctx, Close> context_;
  std::chrono::milliseconds retransmissionTimeout_;
  Clock::time_point lastAnswer_;
};

// The processor's name in messages: "the BMC at host:port" or "the BMC behind device".
std::string nameOf(const IpmiSettings& settings);

}  // namespace QV::Ipmi
