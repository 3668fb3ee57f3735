// SPDX-License-Identifier: Apache-2.0
// Several LAN parameters of one channel written under the processor's set-in-progress lock (IPMI 2.0, table 23-4,
// parameter 0).
#pragma once

#include <cstdint>
#include <set>
#include <string>
#include <vector>

#include "agent/backends/ipmi/lan/AddressPlan.h"
#include "agent/backends/ipmi/session/IpmiTransport.h"

namespace QV::Ipmi {

// The channels whose lock is, or may be, ours. The lock knows no time-out: one that could not be given back shuts every
// client out until somebody gives it back, so it is remembered until that has happened.
using HeldLocks = std::set<std::uint8_t>;

// Gives the lock of a channel back and strikes it from `held`. A failure is logged, and the lock stays in `held`.
void releaseLock(IpmiTransport& transport, std::uint8_t channel, HeldLocks& held);

// Holds the lock from its construction to its destruction, whatever happens in between. A processor without the lock is
// written to all the same.
class ParameterTransaction {
 public:
  // Throws IpmiError, and nothing has been written, if another client holds the lock or it cannot be taken.
  ParameterTransaction(IpmiTransport& transport, std::uint8_t channel, HeldLocks& held);
  ~ParameterTransaction();
  ParameterTransaction(const ParameterTransaction&) = delete;
  ParameterTransaction& operator=(const ParameterTransaction&) = delete;

  // Writes the values in their order and commits them. Where one is refused or the operation's time ends, what was
  // written before it is put back, and IpmiError is thrown. Throws ConnectionLost if an answer did not come; what
  // the processor has then is unknown.
  void write(const std::vector<ParameterWrite>& writes);

 private:
  void take();
  void writeOne(const ParameterWrite& write);
  std::string putBack(const std::vector<ParameterWrite>& writes, std::size_t count);
  void commit();

  IpmiTransport& transport_;
  const std::uint8_t channel_;
  HeldLocks& held_;
};

}  // namespace QV::Ipmi
