// SPDX-License-Identifier: Apache-2.0
#include "agent/backends/ipmi/lan/AddressPlan.h"

namespace QV::Ipmi {
namespace {

std::string sourceText(std::uint8_t source) {
  constexpr const char* names[] = {"unspecified", "static", "DHCP", "BIOS", "other"};
  return source < std::size(names) ? names[source] : "source " + std::to_string(source);
}

std::string valueText(LanParameter parameter, const std::optional<ParameterData>& value) {
  if (!value) {
    return "not reported";
  }
  if (parameter == LanParameter::AddressSource) {
    return sourceText(value->front());
  }
  return toAddress<Ipv4Address>(value)->text();
}

std::optional<ParameterData> data(const std::optional<AddressSource>& source) {
  if (!source) {
    return std::nullopt;
  }
  return ParameterData{static_cast<std::uint8_t>(*source)};
}

template <typename Address>
std::optional<ParameterData> data(const std::optional<Address>& address) {
  if (!address) {
    return std::nullopt;
  }
  return toData(*address);
}

struct Row {
  LanParameter parameter;
  std::optional<ParameterData> from;
  std::optional<ParameterData> to;
};

std::vector<Row> compare(const AddressSettings& from, const AddressSettings& to) {
  return {{LanParameter::AddressSource, data(from.source), data(to.source)},
          {LanParameter::IpAddress, data(from.address), data(to.address)},
          {LanParameter::SubnetMask, data(from.mask), data(to.mask)}};
}

template <typename Address>
void requireSet(const std::optional<Address>& address, const std::string& what) {
  if (address && address->isZero()) {
    throw IpmiError("the interface has no " + what + " yet: give address and mask in one change");
  }
}

}  // namespace

void readInto(AddressSettings& settings, IpmiTransport& transport, std::uint8_t channel, LanParameter parameter) {
  const auto value = getParameter(transport, channel, parameter);
  if (parameter == LanParameter::IpAddress) {
    settings.address = toAddress<Ipv4Address>(value);
  } else if (parameter == LanParameter::SubnetMask) {
    settings.mask = toAddress<SubnetMask>(value);
  } else if (value && !value->empty()) {
    settings.source = static_cast<AddressSource>(value->front() & 0x0F);
  } else {
    settings.source.reset();
  }
}

AddressSettings readAddressSettings(IpmiTransport& transport, std::uint8_t channel) {
  AddressSettings settings;
  for (const LanParameter parameter :
       {LanParameter::AddressSource, LanParameter::IpAddress, LanParameter::SubnetMask}) {
    readInto(settings, transport, channel, parameter);
  }
  return settings;
}

AddressSettings withChange(const AddressSettings& present, const AddressChange& change) {
  AddressSettings wanted = present;
  wanted.source = AddressSource::Static;
  if (change.ipv4Address) {
    wanted.address = change.ipv4Address;
  }
  if (change.ipv4SubnetMask) {
    wanted.mask = change.ipv4SubnetMask;
  }
  requireSet(wanted.address, "IP address");
  requireSet(wanted.mask, "subnet mask");
  return wanted;
}

std::string ParameterWrite::describe() const { return Ipmi::describe(parameter) + ' ' + valueText(parameter, value); }

std::vector<ParameterWrite> planWrites(const AddressSettings& from, const AddressSettings& to) {
  const bool sourceChanges = from.source != to.source;
  std::vector<ParameterWrite> writes;
  for (const Row& row : compare(from, to)) {
    if (row.to && (sourceChanges || row.from != row.to)) {
      writes.push_back({row.parameter, *row.to, row.from});
    }
  }
  return writes;
}

std::string describeDifference(const AddressSettings& present, const AddressSettings& wanted) {
  std::string text;
  for (const Row& row : compare(present, wanted)) {
    if (row.to && row.from != row.to) {
      text += (text.empty() ? "" : ", ") + describe(row.parameter) + " is " + valueText(row.parameter, row.from) +
              ", not " + valueText(row.parameter, row.to);
    }
  }
  return text;
}

}  // namespace QV::Ipmi
