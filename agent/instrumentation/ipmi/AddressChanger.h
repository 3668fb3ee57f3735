// A change of an interface's address from the first look to the confirmation that it holds.
#pragma once

#include <atomic>
#include <chrono>
#include <cstdint>

#include "instrumentation/ManagementProcessor.h"
#include "instrumentation/ipmi/AddressPlan.h"
#include "instrumentation/ipmi/IpmiTransport.h"
#include "instrumentation/ipmi/ParameterTransaction.h"

namespace QV::Ipmi {

class AddressChanger {
 public:
  // `begun` becomes true before the first request that may change the configuration, for whoever no longer waits for
  // the outcome. Processors may take a moment to apply a change: `patience` is how long it is read back.
  AddressChanger(IpmiTransport& transport, std::uint8_t channel, HeldLocks& held, std::atomic<bool>& begun,
                 std::chrono::milliseconds patience)
      : transport_(transport), channel_(channel), held_(held), begun_(begun), patience_(patience) {}

  // Returns once the processor shows the change, which is at once where it has the values already. Throws IpmiError
  // that says whether nothing was changed, the earlier values were put back, or the outcome is unknown.
  void apply(const AddressChange& change);

 private:
  AddressSettings readBack(const AddressSettings& wanted, const std::string& loss);
  std::string putBack(const AddressSettings& present, const AddressSettings& earlier);
  void write(const AddressSettings& from, const AddressSettings& to);

  IpmiTransport& transport_;
  const std::uint8_t channel_;
  HeldLocks& held_;
  std::atomic<bool>& begun_;
  const std::chrono::milliseconds patience_;
};

}  // namespace QV::Ipmi
