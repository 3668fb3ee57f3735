// SPDX-License-Identifier: Apache-2.0
#include "agent/backends/ipmi/IpmiProcessor.h"

#include <algorithm>
#include <exception>
#include <thread>
#include <utility>

#include "agent/backends/ipmi/lan/AddressChanger.h"
#include "agent/backends/ipmi/lan/ChannelDiscovery.h"
#include "agent/backends/ipmi/session/IpmiLog.h"

namespace QV::Ipmi {
namespace {

// How long a processor may take to show a change, and another client to end one, where that has to be waited for.
// Within an operation there must be time for it and for what follows, in its cleanup too.
std::chrono::milliseconds patience(const IpmiSettings& settings) {
  return std::min({std::chrono::milliseconds(1000), settings.operationTimeout / 5, settings.sessionTimeout / 3});
}

// The channel that a session runs on is another one where the processor fails over from one port to the other: seldom,
// and to be seen in the end. A channel's name stays its own, so that no change goes astray meanwhile.
constexpr std::chrono::minutes channelsHold{10};

constexpr std::chrono::milliseconds betweenTries{20};

}  // namespace

void IpmiProcessor::startOperation(Deadline deadline) {
  connection_.startOperation(deadline);
  if (heldLocks_.empty()) {
    return;
  }
  connection_.open();
  for (const auto& [channel, holder] : HeldLocks(heldLocks_)) {
    releaseLock(connection_, channel, heldLocks_, patience(settings_));
  }
  // With its lock a processor applies or drops what an earlier change has left there.
  announceChange();
}

void IpmiProcessor::close() {
  if (!heldLocks_.empty()) {
    try {
      startOperation(Deadline(settings_.sessionTimeout));
    } catch (const std::exception& error) {
      logFailure(std::string("a set-in-progress lock that may be ours cannot be given back: ") + error.what());
    }
  }
  connection_.close();
}

bool IpmiProcessor::snapshotHolds(Clock::time_point now) {
  return snapshot_ && now - snapshot_->begunAt < settings_.cache && generation() == snapshot_->generation;
}

std::optional<ChangeGeneration::Number> IpmiProcessor::generation() {
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

std::vector<IpmiProcessor::Channel>& IpmiProcessor::channels() {
  const auto now = Clock::now();
  if (channels_.empty() || now - channelsFoundAt_ >= channelsHold || breaksWhenFound_ != connection_.breaks()) {
    channels_.clear();
    for (const std::uint8_t number : discoverChannels(connection_, settings_.channels)) {
      channels_.push_back({number, settings_.ipv6});
    }
    channelsFoundAt_ = now;
    breaksWhenFound_ = connection_.breaks();
  }
  return channels_;
}

// A processor shows what another client writes, one value after the other or all at once, and that may come between two
// round trips of a look. An address and mask that were not known to belong together do if they stay, nobody is at work
// on them, and no process of this machine has been: two changes in a row may write an address that was there before.
// Who has left a lock behind, and with it values that stay, is waited for once, and not for long. Where they never stay
// the caller hears so while it still listens: no try is begun that may not end by then, going by the longest one, since
// a slow processor or a busy machine takes a good part of the time for each.
NetworkInterface IpmiProcessor::look(Deadline deadline, Channel& channel) {
  struct Seen {
    AddressPair pair;
    std::optional<ChangeGeneration::Number> generation;
    bool operator==(const Seen&) const = default;
  };
  std::optional<Seen> earlier;
  Deadline abandoned(settings_.operationTimeout / 2);
  Clock::duration longest = settings_.operationTimeout / 15;
  do {
    const auto begunAt = Clock::now();
    Seen seen{{}, generation()};
    NetworkInterface interface = readInterface(connection_, channel.number, channel.ipv6);
    seen.pair = {interface.ipv4Address, interface.ipv4SubnetMask};
    if (std::exchange(earlier, seen) != seen) {
      abandoned = Deadline(settings_.operationTimeout / 2);
    }
    if (channel.known == seen.pair ||
        ((abandoned.passed() || !isBeingSet(connection_, channel.number)) &&
         readAddressPair(connection_, channel.number) == seen.pair && generation() == seen.generation)) {
      channel.known = seen.pair;
      return interface;
    }
    std::this_thread::sleep_for(betweenTries);
    longest = std::max(longest, Clock::now() - begunAt);
  } while (deadline.leaves(longest * 3 / 2));
  throw IpmiError("other clients of " + nameOf(settings_) + " change " + interfaceName(channel.number) +
                  " again and again: no address and mask that belong together were seen within operation_timeout");
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
  for (Channel& channel : channels()) {
    processor.interfaces.push_back(look(deadline, channel));
  }
  trace("read " + std::to_string(processor.interfaces.size()) + " interfaces in " +
        std::to_string(connection_.roundTrips()) + " round trips");
  if (generationBefore && settings_.cache > std::chrono::milliseconds::zero()) {
    snapshot_ = {processor, now, *generationBefore};
  }
  return processor;
}

InterfaceNames IpmiProcessor::interfaceNames(Deadline deadline) {
  startOperation(deadline);
  InterfaceNames names;
  for (const Channel& channel : channels()) {
    names.emplace_back(interfaceName(channel.number));
  }
  return names;
}

void IpmiProcessor::change(Deadline deadline, const std::string& name, const AddressChange& change,
                           std::atomic<bool>& begun) {
  snapshot_.reset();
  startOperation(deadline);
  const auto channel = channelOf(name);
  const auto& known = channels();
  if (!channel || std::ranges::find(known, *channel, &Channel::number) == known.end()) {
    throw IpmiError("there is no interface '" + name + '\'');
  }
  const auto onBegin = [&] {
    begun = true;
    announceChange();
  };
  // A look that was begun while the change was under way, or by whom the first announcement has not reached, is not
  // true any more when it is over, however it ended.
  try {
    AddressChanger(connection_, *channel, heldLocks_, onBegin, patience(settings_)).apply(change);
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
