// SPDX-License-Identifier: Apache-2.0
// From the address settings that a channel has and the change that is asked for to the parameters that must be written.
#pragma once

#include <cstdint>
#include <optional>
#include <string>
#include <vector>

#include "agent/backends/ipmi/lan/LanParameters.h"
#include "agent/processor/ManagementProcessor.h"

namespace QV::Ipmi {

// What a channel's static address is made of; absent is what the processor does not support.
struct AddressSettings {
  std::optional<AddressSource> source;
  std::optional<Ipv4Address> address;
  std::optional<SubnetMask> mask;

  bool operator==(const AddressSettings&) const = default;
};

// Reads them in three round trips.
AddressSettings readAddressSettings(IpmiTransport& transport, std::uint8_t channel);

// Reads one of them, in one round trip, into the settings.
void readInto(AddressSettings& settings, IpmiTransport& transport, std::uint8_t channel, LanParameter parameter);

// What the change makes of the settings. Throws IpmiError if the interface would be static without an address or a
// mask, since it has none yet and the change brings none.
AddressSettings withChange(const AddressSettings& present, const AddressChange& change);

struct ParameterWrite {
  LanParameter parameter;
  ParameterData value;
  std::optional<ParameterData> previous;

  // "IP address 192.0.2.7", for messages.
  std::string describe() const;
};

// The writes that lead from one to the other, the source first: some processors refuse an address while it comes from
// DHCP. Only what differs is written; but where the source changes, address and mask are too, because what is stored
// for static use need not be what DHCP gave.
std::vector<ParameterWrite> planWrites(const AddressSettings& from, const AddressSettings& to);

// What of `wanted` is not so in `present`: "IP address is 192.0.2.10, not 192.0.2.7". Empty where all is.
std::string describeDifference(const AddressSettings& present, const AddressSettings& wanted);

}  // namespace QV::Ipmi
