// SPDX-License-Identifier: Apache-2.0
#include "agent/backends/ipmi/IpmiProcessor.h"

#include <algorithm>
#include <exception>
#include <utility>

#include "agent/backends/ipmi/lan/AddressChanger.h"
#include "agent/backends/ipmi/lan/ChannelDiscovery.h"
#include "agent/backends/ipmi/lan/InterfaceReader.h"
#include "agent/backends/ipmi/session/IpmiLog.h"

namespace QV::Ipmi {
namespace {

constexpr std::chrono::milliseconds readBackPatience{1000};

}  // namespace

void IpmiProcessor::startOperation(Deadline deadline) {
  connection_.startOperation(deadline);
  if (heldLocks_.empty()) {
    return;
  }
  connection_.open();
  for (const std::uint8_t channel : HeldLocks(heldLocks_)) {
    releaseLock(connection_, channel, heldLocks_);
  }
  // With its lock a processor applies or drops what an earlier change has left there.
  announceChange();
}

bool IpmiProcessor::snapshotHolds(Clock::time_point now) {
  return snapshot_ && now - snapshot_->begunAt < settings_.cache && generation() == snapshot_->generation;
}

std::optional<ChangeGeneration::Number> IpmiProcessor::generation() {
  if (settings_.cache == std::chrono::milliseconds::zero()) {
    return std::nullopt;
  }
  try {
    const auto number = generation_.current();
    generationFailed_ = false;
    return number;
  } catch (const std::exception& error) {
    reportGenerationFailure(error.what());
    return std::nullopt;
  }
}

// Processes with another agent.ini may keep their looks where this one keeps none.
void IpmiProcessor::announceChange() {
  try {
    generation_.renew();
    generationFailed_ = false;
  } catch (const std::exception& error) {
    reportGenerationFailure(error.what());
  }
}

// Once, until it works again. An administrator who has switched the cache off has dealt with it.
void IpmiProcessor::reportGenerationFailure(const std::string& reason) {
  const bool switchedOff = settings_.cache == std::chrono::milliseconds::zero();
  if (switchedOff || std::exchange(generationFailed_, true)) {
    return;
  }
  logFailure(reason +
             "; until that is mended every read asks the BMC anew, and other processes may show a change late by their "
             "cache time: let all users that object managers run as read and write this file, or name another in "
             "generation_file");
}

const std::vector<std::uint8_t>& IpmiProcessor::channels() {
  if (connection_.session() == 0 || channelsOfSession_ != connection_.session()) {
    channels_ = discoverChannels(connection_, settings_.channels);
    channelsOfSession_ = connection_.session();
  }
  return channels_;
}

ManagementProcessor IpmiProcessor::read(Deadline deadline) {
  const auto now = Clock::now();
  if (snapshotHolds(now)) {
    return snapshot_->processor;
  }
  snapshot_.reset();
  startOperation(deadline);
  const auto generationBefore = generation();
  ManagementProcessor processor{"BMC", "Management processor reached over IPMI", {}, {}};
  for (const std::uint8_t channel : channels()) {
    processor.interfaces.push_back(readInterface(connection_, channel, settings_.ipv6));
  }
  trace("read " + std::to_string(processor.interfaces.size()) + " interfaces in " +
        std::to_string(connection_.roundTrips()) + " round trips");
  if (generationBefore) {
    snapshot_ = {processor, now, *generationBefore};
  }
  return processor;
}

void IpmiProcessor::change(Deadline deadline, const std::string& name, const AddressChange& change,
                           std::atomic<bool>& begun) {
  snapshot_.reset();
  startOperation(deadline);
  const auto channel = channelOf(name);
  const auto& known = channels();
  if (!channel || std::find(known.begin(), known.end(), *channel) == known.end()) {
    throw IpmiError("there is no interface '" + name + '\'');
  }
  const auto onBegin = [&] {
    begun = true;
    announceChange();
  };
  // A look that was begun while the change was under way, or by whom the first announcement has not reached, is not
  // true any more when it is over, however it ended.
  try {
    AddressChanger(connection_, *channel, heldLocks_, onBegin, readBackPatience).apply(change);
  } catch (...) {
    if (begun) {
      announceChange();
    }
    throw;
  }
  if (begun) {
    announceChange();
  }
  trace("changed " + name + " in " + std::to_string(connection_.roundTrips()) + " round trips");
}

}  // namespace QV::Ipmi
