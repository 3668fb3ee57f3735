// SPDX-License-Identifier: Apache-2.0
// The management processor as one thread sees it: what it is asked, what is kept of its answers, and for how long.
#pragma once

#include <atomic>
#include <chrono>
#include <cstdint>
#include <optional>
#include <string>
#include <vector>

#include "agent/backends/ChangeGeneration.h"
#include "agent/backends/ipmi/lan/InterfaceReader.h"
#include "agent/backends/ipmi/lan/ParameterTransaction.h"
#include "agent/backends/ipmi/session/IpmiConnection.h"
#include "agent/backends/ipmi/settings/IpmiSettings.h"
#include "agent/processor/BackEnd.h"

namespace QV::Ipmi {

// Not safe to share between threads without a lock. Every operation sends nothing any more once its deadline has
// passed, save what it needs to give a lock back, and throws IpmiError if it fails.
class IpmiProcessor {
 public:
  explicit IpmiProcessor(const IpmiSettings& settings)
      : settings_(settings), connection_(settings), generation_(settings.generationFile) {}

  // The processor as it is, or as it was at most the cache time ago where no process of this machine has changed it
  // since.
  ManagementProcessor read(Deadline deadline);

  // The names of its interfaces: no round trip where the channels are known.
  InterfaceNames interfaceNames(Deadline deadline);

  // `begun` becomes true before the first request that may change the configuration, for whoever no longer waits for
  // the outcome.
  void change(Deadline deadline, const std::string& interfaceName, const AddressChange& change,
              std::atomic<bool>& begun);

  // Gives the processor its session back, and before that a lock that a change had to leave; the next operation opens
  // another session.
  void close();

 private:
  using Clock = std::chrono::steady_clock;

  // A look at the processor, and the time and the generation that it was begun at.
  struct Snapshot {
    ManagementProcessor processor;
    Clock::time_point begunAt;
    ChangeGeneration::Number generation;
  };

  bool snapshotHolds(Clock::time_point now);
  // Nothing where the other processes' changes cannot be learned of.
  std::optional<ChangeGeneration::Number> generation();
  void announceChange();
  void reportGenerationFailure(const std::string& reason);

  // A LAN channel, which IPv6 address is read of it, none once the processor is known to have no such parameter, and
  // the address and mask that it was last known to have together.
  struct Channel {
    std::uint8_t number;
    Ipv6Choice ipv6;
    std::optional<AddressPair> known = {};
  };

  void startOperation(Deadline deadline);
  std::vector<Channel>& channels();
  NetworkInterface look(Deadline deadline, Channel& channel);

  const IpmiSettings settings_;
  IpmiConnection connection_;
  std::vector<Channel> channels_;
  Clock::time_point channelsFoundAt_;
  unsigned breaksWhenFound_ = 0;
  HeldLocks heldLocks_;
  std::optional<Snapshot> snapshot_;
  const ChangeGeneration generation_;
  bool generationFailed_ = false;
};

}  // namespace QV::Ipmi
