#include "agent/backends/ipmi/lan/LanParameters.h"

#include <algorithm>
#include <map>
#include <stdexcept>

#include "agent/backends/ipmi/lan/CompletionCode.h"
#include "agent/processor/AddressValidation.h"

namespace QV::Ipmi {
namespace {

constexpr std::uint8_t setLanConfigurationParameters = 0x01;
constexpr std::uint8_t getLanConfigurationParameters = 0x02;

// BMCs refuse a parameter that they do not have with one of these.
bool meansUnsupported(std::uint8_t completionCode) {
  return completionCode == CompletionCode::parameterNotSupported ||
         completionCode == CompletionCode::parameterOutOfRange || completionCode == CompletionCode::invalidData;
}

}  // namespace

std::optional<ParameterData> getParameter(IpmiTransport& transport, std::uint8_t channel, LanParameter parameter) {
  constexpr std::uint8_t firstSet = 0;
  constexpr std::uint8_t firstBlock = 0;
  const IpmiResponse response = transport.send({NetworkFunction::Transport,
                                                getLanConfigurationParameters,
                                                {channel, static_cast<std::uint8_t>(parameter), firstSet, firstBlock}},
                                               Repetition::Allowed);
  if (meansUnsupported(response.completionCode)) return std::nullopt;
  if (response.completionCode != CompletionCode::done)
    throw IpmiError("the BMC does not tell the " + describe(parameter) + " of LAN channel " + std::to_string(channel) +
                    ": " + CompletionCode::describe(response.completionCode));
  if (response.data.empty()) return std::nullopt;
  return ParameterData(response.data.begin() + 1, response.data.end());
}

IpmiResponse setParameter(IpmiTransport& transport, std::uint8_t channel, LanParameter parameter,
                          const ParameterData& data, Repetition repetition) {
  ParameterData request = {channel, static_cast<std::uint8_t>(parameter)};
  request.insert(request.end(), data.begin(), data.end());
  return transport.send({NetworkFunction::Transport, setLanConfigurationParameters, request}, repetition);
}

std::optional<Ipv4Octets> toOctets(const std::optional<ParameterData>& data) {
  Ipv4Octets octets;
  if (!data || data->size() < octets.size()) return std::nullopt;
  std::copy_n(data->begin(), octets.size(), octets.begin());
  return octets;
}

Ipv4Octets parseOctets(const std::string& text) {
  const auto number = parseIpv4(text);
  if (!number) throw std::invalid_argument('\'' + text + "' is no dotted decimal IPv4 address");
  const auto octet = [&](int shift) { return static_cast<std::uint8_t>(*number >> shift); };
  return {octet(24), octet(16), octet(8), octet(0)};
}

std::string toText(const Ipv4Octets& octets) {
  std::string text;
  for (const std::uint8_t octet : octets) text += (text.empty() ? "" : ".") + std::to_string(octet);
  return text;
}

std::string describe(LanParameter parameter) {
  static const std::map<LanParameter, std::string> names = {{LanParameter::SetInProgress, "set-in-progress state"},
                                                            {LanParameter::IpAddress, "IP address"},
                                                            {LanParameter::AddressSource, "IP address source"},
                                                            {LanParameter::MacAddress, "MAC address"},
                                                            {LanParameter::SubnetMask, "subnet mask"},
                                                            {LanParameter::DefaultGateway, "default gateway"},
                                                            {LanParameter::Ipv6StaticAddress, "static IPv6 address"},
                                                            {LanParameter::Ipv6DynamicAddress, "dynamic IPv6 address"}};
  return names.at(parameter);
}

}  // namespace QV::Ipmi
