// SPDX-License-Identifier: Apache-2.0
#include "agent/backends/ipmi/lan/AddressChanger.h"

#include <thread>

#include "agent/backends/ipmi/lan/InterfaceReader.h"
#include "agent/backends/ipmi/session/Deadline.h"
#include "agent/backends/ipmi/session/IpmiLog.h"

namespace QV::Ipmi {
namespace {

constexpr std::chrono::milliseconds betweenLooks{100};

// Whether the address is one that was neither there nor written by us: another client's, whose change must stand. A
// processor that mangles what it applies shows none.
bool isAnothers(const AddressSettings& present, const AddressSettings& earlier, const AddressSettings& wanted) {
  return present.address && !present.address->isZero() && present.address != earlier.address &&
         present.address != wanted.address;
}

}  // namespace

void AddressChanger::apply(const AddressChange& change) {
  const AddressSettings earlier = readAddressSettings(transport_, channel_);
  if (earlier == AddressSettings{}) {
    throw noLanChannel(channel_);
  }
  const AddressSettings wanted = withChange(earlier, change);
  const auto writes = planWrites(earlier, wanted);
  if (writes.empty()) {
    logProgress(interfaceName(channel_) + " has these values already: nothing is written");
    return;
  }
  std::string loss;
  try {
    write(earlier, wanted);
  } catch (const ConnectionLost& lost) {
    if (!begun_) {
      throw;
    }
    loss = lost.what();
  }
  const AddressSettings present = readBack(writes, wanted, loss);
  const std::string difference = describeDifference(present, wanted);
  if (difference.empty()) {
    return;
  }
  const std::string outcome = present == earlier ? "; the earlier values hold"
                              : isAnothers(present, earlier, wanted)
                                  ? "; another client has changed it meanwhile, and its values hold"
                                  : putBack(present, earlier);
  throw IpmiError("the BMC took the change of " + interfaceName(channel_) + " but does not show it: " + difference +
                  outcome);
}

void AddressChanger::write(const AddressSettings& from, const AddressSettings& to) {
  ParameterTransaction transaction(transport_, channel_, held_, patience_);
  if (!std::exchange(begun_, true)) {
    onBegin_();
  }
  transaction.write(planWrites(from, to));
}

// What was written is what must show. The rest is looked at only where that fails and has to be mended.
AddressSettings AddressChanger::readBack(const std::vector<ParameterWrite>& written, const AddressSettings& wanted,
                                         const std::string& loss) try {
  for (const Deadline deadline(patience_);;) {
    AddressSettings present = wanted;
    try {
      for (const ParameterWrite& write : written) {
        readInto(present, transport_, channel_, write.parameter);
      }
      if (present == wanted) {
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

std::string AddressChanger::putBack(const AddressSettings& present, const AddressSettings& earlier) try {
  write(present, earlier);
  const std::string difference = describeDifference(readAddressSettings(transport_, channel_), earlier);
  return difference.empty() ? "; the earlier values were put back"
                            : "; the earlier values could not be put back: " + difference;
} catch (const IpmiError& error) {
  return std::string("; the earlier values could not be put back: ") + error.what();
}

}  // namespace QV::Ipmi
