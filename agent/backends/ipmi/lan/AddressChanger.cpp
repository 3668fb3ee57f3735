// SPDX-License-Identifier: Apache-2.0
#include "agent/backends/ipmi/lan/AddressChanger.h"

#include <thread>

#include "agent/backends/ipmi/lan/InterfaceReader.h"
#include "agent/backends/ipmi/session/Deadline.h"
#include "agent/backends/ipmi/session/IpmiLog.h"

namespace QV::Ipmi {
namespace {

constexpr std::chrono::milliseconds betweenLooks{100};

}  // namespace

// Whether the address is one that was neither there nor written by us: another client's, whose change must stand. A
// processor that mangles what it applies shows none.
bool AddressChanger::isAnothers(const AddressSettings& present, const Plan& plan) {
  return present.address && !present.address->isZero() && present.address != plan.earlier.address &&
         present.address != plan.wanted.address;
}

AddressChanger::Plan AddressChanger::planFor(const AddressChange& change) const {
  const AddressSettings earlier = readAddressSettings(transport_, channel_);
  if (earlier == AddressSettings{}) {
    throw noLanChannel(channel_);
  }
  const AddressSettings wanted = withChange(earlier, change);
  return {earlier, wanted, planWrites(earlier, wanted)};
}

void AddressChanger::apply(const AddressChange& change) {
  Plan plan;
  std::string loss;
  try {
    // What is left as it is must not be what another client has half written: it is looked at with the lock.
    ParameterTransaction transaction(transport_, channel_, held_, patience_);
    plan = planFor(change);
    if (!plan.writes.empty()) {
      begun_ = true;
      onBegin_();
      transaction.write(plan.writes);
    }
  } catch (const LockedByAnother&) {
    plan = planFor(change);
    if (!plan.writes.empty()) {
      throw;
    }
  } catch (const ConnectionLost& lost) {
    if (!begun_) {
      throw;
    }
    loss = lost.what();
  }
  if (plan.writes.empty()) {
    logProgress(interfaceName(channel_) + " has these values already: nothing is written");
    return;
  }
  const AddressSettings present = readBack(plan, loss);
  const std::string difference = describeDifference(present, plan.wanted);
  if (!difference.empty()) {
    throw IpmiError("the BMC took the change of " + interfaceName(channel_) + " but does not show it: " + difference +
                    (present == plan.earlier ? "; the earlier values hold" : putBack(plan)));
  }
}

// What was written is what must show. The rest is looked at only where that fails and has to be mended.
AddressSettings AddressChanger::readBack(const Plan& plan, const std::string& loss) try {
  for (const Deadline deadline(patience_);;) {
    AddressSettings present = plan.wanted;
    try {
      for (const ParameterWrite& write : plan.writes) {
        readInto(present, transport_, channel_, write.parameter);
      }
      if (present == plan.wanted) {
        return present;
      }
    } catch (const Refused&) {  // it may be busy
    }
    if (deadline.passed()) {
      return readAddressSettings(transport_, channel_);
    }
    std::this_thread::sleep_for(betweenLooks);
  }
} catch (const IpmiError& error) {
  throw IpmiError("the outcome of the change of " + interfaceName(channel_) +
                  " is unknown: it was sent, but the BMC can no longer be asked (" +
                  (loss.empty() ? error.what() : loss) +
                  "). Where the agent reaches it at the address that was changed, set host to the new one");
}

std::string AddressChanger::putBack(const Plan& plan) try {
  {
    ParameterTransaction transaction(transport_, channel_, held_, patience_);
    const AddressSettings present = readAddressSettings(transport_, channel_);
    if (isAnothers(present, plan)) {
      return "; another client has changed it meanwhile, and its values hold";
    }
    transaction.write(planWrites(present, plan.earlier));
  }
  const std::string difference = describeDifference(readAddressSettings(transport_, channel_), plan.earlier);
  return difference.empty() ? "; the earlier values were put back"
                            : "; the earlier values could not be put back: " + difference;
} catch (const IpmiError& error) {
  return std::string("; the earlier values could not be put back: ") + error.what();
}

}  // namespace QV::Ipmi
