// SPDX-License-Identifier: Apache-2.0
// The way to the processor over many operations: holds one session, opens another where it broke, counts what goes over
// the wire and keeps every operation to its time.
#pragma once

#include <memory>

#include "agent/backends/ipmi/session/Deadline.h"
#include "agent/backends/ipmi/session/IpmiSession.h"
#include "agent/backends/ipmi/session/IpmiTransport.h"
#include "agent/backends/ipmi/settings/IpmiSettings.h"

namespace QV::Ipmi {

// Not safe to share between threads without a lock.
class IpmiConnection : public IpmiTransport {
 public:
  explicit IpmiConnection(const IpmiSettings& settings) : settings_(settings) {}

  // From here on requests belong to an operation that ends at the deadline; afterwards they are NotSent.
  void startOperation(Deadline deadline);

  // Makes sure that a session is open. Throws NotSent.
  void open();

  IpmiResponse send(const IpmiRequest& request, Repetition repetition) override;

  // The time of its own is the session time-out: enough to open one session and to use it.
  void beginCleanup() override;

  // The round trips of the operation so far, those that opened sessions included.
  unsigned roundTrips() const { return roundTrips_; }

  // How often the processor could not be reached or stopped answering. What was learned of its build holds while this
  // stays the same.
  unsigned breaks() const { return breaks_; }

  // Ends the session: the processor has few of them. The next request opens another.
  void close() { session_.reset(); }

 private:
  void requireTime() const;

  const IpmiSettings settings_;
  Deadline deadline_{std::chrono::milliseconds{0}};
  std::unique_ptr<IpmiSession> session_;
  unsigned roundTrips_ = 0;
  unsigned breaks_ = 0;
};

}  // namespace QV::Ipmi
