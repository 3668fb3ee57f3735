#include "agent/backends/ipmi/lan/LanParameters.h"

#include <map>

#include "agent/backends/ipmi/lan/CompletionCode.h"

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
