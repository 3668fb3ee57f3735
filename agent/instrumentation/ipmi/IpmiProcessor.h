// The management processor as one thread sees it: what it is asked, what is kept of its answers, and for how long.
#pragma once

#include <atomic>
#include <chrono>
#include <cstdint>
#include <optional>
#include <string>
#include <vector>

#include "instrumentation/ManagementProcessor.h"
#include "instrumentation/ipmi/IpmiConnection.h"
#include "instrumentation/ipmi/IpmiSettings.h"
#include "instrumentation/ipmi/ParameterTransaction.h"

namespace QV::Ipmi {

// Not safe to share between threads without a lock. Every operation sends nothing any more once its deadline has
// passed, save what it needs to give a lock back, and throws IpmiError where it fails.
class IpmiProcessor {
 public:
  explicit IpmiProcessor(const IpmiSettings& settings) : settings_(settings), connection_(settings) {}

  // The processor as it is, or as it was at most the cache time ago and before nobody's change through this object.
  ManagementProcessor read(Deadline deadline);

  // See AddressChanger for `begun`.
  void change(Deadline deadline, const std::string& interfaceName, const AddressChange& change,
              std::atomic<bool>& begun);

  // Gives the processor its session back; the next operation opens another.
  void close() { connection_.close(); }

 private:
  struct Snapshot {
    ManagementProcessor processor;
    std::chrono::steady_clock::time_point taken;
  };

  void startOperation(Deadline deadline);
  const std::vector<std::uint8_t>& channels();

  const IpmiSettings settings_;
  IpmiConnection connection_;
  std::vector<std::uint8_t> channels_;
  unsigned channelsOfSession_ = 0;
  HeldLocks heldLocks_;
  std::optional<Snapshot> snapshot_;
};

}  // namespace QV::Ipmi
