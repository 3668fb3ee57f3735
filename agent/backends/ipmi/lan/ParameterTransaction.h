// SPDX-License-Identifier: Apache-2.0
// Several LAN parameters of one channel written under the processor's set-in-progress lock (IPMI 2.0, table 23-4,
// parameter 0).
#pragma once

#include <chrono>
#include <cstdint>
#include <map>
#include <string>
#include <vector>

#include "agent/backends/ipmi/lan/AddressPlan.h"
#include "agent/backends/ipmi/session/IpmiTransport.h"

namespace QV::Ipmi {

// The channels whose lock is ours, or may be because the answer to the request for it never came. The lock knows no
// time-out: one that could not be given back shuts every client out until somebody gives it back, so it is remembered
// until that has happened.
enum class LockHolder { Us, PerhapsAnother };
using HeldLocks = std::map<std::uint8_t, LockHolder>;

// Gives the lock of a channel back and strikes it from `held`. Where another client may hold it, that one is given
// `patience` to end its change first. A failure is logged, and the lock stays in `held`.
void releaseLock(IpmiTransport& transport, std::uint8_t channel, HeldLocks& held, std::chrono::milliseconds patience);

// Nothing was sent but the request for the lock.
class LockedByAnother : public IpmiError {
 public:
  using IpmiError::IpmiError;
};

// Holds the lock from its construction to its destruction, whatever happens in between. A processor without the lock is
// written to all the same.
class ParameterTransaction {
 public:
  // Throws LockedByAnother, or IpmiError if the lock cannot be taken; nothing has been written then. Where an answer
  // that came late leaves open whose the lock is, it is ours if it does not go within `patience`.
  ParameterTransaction(IpmiTransport& transport, std::uint8_t channel, HeldLocks& held,
                       std::chrono::milliseconds patience);
  ~ParameterTransaction();
  ParameterTransaction(const ParameterTransaction&) = delete;
  ParameterTransaction& operator=(const ParameterTransaction&) = delete;

  // Writes the values in their order and commits them. Where one is refused or the operation's time ends, what was
  // written before it is put back, and IpmiError is thrown. Throws ConnectionLost if an answer did not come; what
  // the processor has then is unknown.
  void write(const std::vector<ParameterWrite>& writes);

 private:
  void take();
  void giveBack();
  void writeOne(const ParameterWrite& write);
  std::string putBack(const std::vector<ParameterWrite>& writes, std::size_t count);
  void commit();

  IpmiTransport& transport_;
  const std::uint8_t channel_;
  HeldLocks& held_;
  const std::chrono::milliseconds patience_;
};

}  // namespace QV::Ipmi
