// SPDX-License-Identifier: Apache-2.0
// A change of an interface's address from the lock to the confirmation that it holds.
#pragma once

#include <chrono>
#include <cstdint>
#include <functional>
#include <string>
#include <utility>
#include <vector>

#include "agent/backends/ipmi/lan/AddressPlan.h"
#include "agent/backends/ipmi/lan/ParameterTransaction.h"
#include "agent/backends/ipmi/session/IpmiTransport.h"
#include "agent/processor/ManagementProcessor.h"

namespace QV::Ipmi {

class AddressChanger {
 public:
  // `onBegin` is called before the first request that may change the configuration, once. Processors may take a moment
  // to apply a change: `patience` is how long it is read back, and see ParameterTransaction.
  AddressChanger(IpmiTransport& transport, std::uint8_t channel, HeldLocks& held, std::function<void()> onBegin,
                 std::chrono::milliseconds patience)
      : transport_(transport), channel_(channel), held_(held), onBegin_(std::move(onBegin)), patience_(patience) {}

  // Returns once the processor shows the change, which is at once where it has the values already, whoever holds the
  // lock. Throws IpmiError that says whether nothing was changed, the earlier values were put back, or the outcome is
  // unknown.
  void apply(const AddressChange& change);

 private:
  struct Plan {
    AddressSettings earlier;
    AddressSettings wanted;
    std::vector<ParameterWrite> writes;
  };

  static bool isAnothers(const AddressSettings& present, const Plan& plan);

  Plan planFor(const AddressChange& change) const;
  AddressSettings readBack(const Plan& plan, const std::string& loss);
  std::string putBack(const Plan& plan);

  IpmiTransport& transport_;
  const std::uint8_t channel_;
  HeldLocks& held_;
  const std::function<void()> onBegin_;
  const std::chrono::milliseconds patience_;
  bool begun_ = false;
};

}  // namespace QV::Ipmi
