#include "instrumentation/ipmi/IpmiProcessor.h"

#include <algorithm>

#include "instrumentation/ipmi/AddressChanger.h"
#include "instrumentation/ipmi/ChannelDiscovery.h"
#include "instrumentation/ipmi/InterfaceReader.h"
#include "instrumentation/ipmi/IpmiLog.h"

namespace QV::Ipmi {
namespace {

constexpr std::chrono::milliseconds readBackPatience{1000};

}  // namespace

void IpmiProcessor::startOperation(Deadline deadline) {
  connection_.startOperation(deadline);
  if (!heldLocks_.empty()) connection_.open();
  for (const std::uint8_t channel : HeldLocks(heldLocks_)) releaseLock(connection_, channel, heldLocks_);
}

const std::vector<std::uint8_t>& IpmiProcessor::channels() {
  if (connection_.session() == 0 || channelsOfSession_ != connection_.session()) {
    channels_ = discoverChannels(connection_, settings_.channels);
    channelsOfSession_ = connection_.session();
  }
  return channels_;
}

ManagementProcessor IpmiProcessor::read(Deadline deadline) {
  const auto now = std::chrono::steady_clock::now();
  if (snapshot_ && now - snapshot_->taken < settings_.cache) return snapshot_->processor;
  snapshot_.reset();
  startOperation(deadline);
  ManagementProcessor processor{"BMC", "Management processor reached over IPMI", {}, {}};
  for (const std::uint8_t channel : channels())
    processor.interfaces.push_back(readInterface(connection_, channel, settings_.ipv6));
  trace("read " + std::to_string(processor.interfaces.size()) + " interfaces in " +
        std::to_string(connection_.roundTrips()) + " round trips");
  snapshot_ = {processor, now};
  return processor;
}

void IpmiProcessor::change(Deadline deadline, const std::string& name, const AddressChange& change,
                           std::atomic<bool>& begun) {
  snapshot_.reset();
  startOperation(deadline);
  const auto channel = channelOf(name);
  const auto& known = channels();
  if (!channel || std::find(known.begin(), known.end(), *channel) == known.end())
    throw IpmiError("there is no interface '" + name + '\'');
  AddressChanger(connection_, *channel, heldLocks_, begun, readBackPatience).apply(change);
  trace("changed " + name + " in " + std::to_string(connection_.roundTrips()) + " round trips");
}

}  // namespace QV::Ipmi
