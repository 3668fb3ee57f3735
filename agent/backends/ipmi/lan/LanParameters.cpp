// SPDX-License-Identifier: Apache-2.0
#include "agent/backends/ipmi/lan/LanParameters.h"

#include <array>
#include <cstdio>
#include <map>

#include "agent/backends/ipmi/session/IpmiLog.h"

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
  const auto notReported = [&] {
    return "the BMC did not report the " + describe(parameter) + " of LAN channel " + std::to_string(channel) + ": " +
           CompletionCode::describe(response.completionCode);
  };
  const bool done = response.completionCode == CompletionCode::done;
  if (meansUnsupported(response.completionCode) || (done && response.data.empty())) {
    trace(notReported());
    return std::nullopt;
  }
  if (!done) {
    throw Refused(notReported());
  }
  return ParameterData(response.data.begin() + 1, response.data.end());
}

IpmiResponse setParameter(IpmiTransport& transport, std::uint8_t channel, LanParameter parameter,
                          const ParameterData& data, Repetition repetition) {
  ParameterData request = {channel, static_cast<std::uint8_t>(parameter)};
  request.insert(request.end(), data.begin(), data.end());
  return transport.send({NetworkFunction::Transport, setLanConfigurationParameters, request}, repetition);
}

IpmiError noLanChannel(std::uint8_t channel) {
  return IpmiError("the BMC has no LAN channel " + std::to_string(channel) + ": check channels");
}

std::string describe(LanParameter parameter) {
  static const std::map<LanParameter, std::string> names = {{LanParameter::SetInProgress, "set-in-progress state"},
                                                            {LanParameter::IpAddress, "IP address"},
                                                            {LanParameter::AddressSource, "IP address source"},
                                                            {LanParameter::SubnetMask, "subnet mask"},
                                                            {LanParameter::DefaultGateway, "default gateway"},
                                                            {LanParameter::Ipv6StaticAddress, "static IPv6 address"},
                                                            {LanParameter::Ipv6DynamicAddress, "dynamic IPv6 address"}};
  return names.at(parameter);
}

namespace CompletionCode {
namespace {

const std::map<std::uint8_t, const char*> meanings = {{done, "done"},
                                                      {parameterNotSupported, "parameter not supported"},
                                                      {setInProgress, "another client's change is in progress"},
                                                      {readOnly, "parameter is read-only"},
                                                      {0xC0, "the BMC is busy"},
                                                      {0xC1, "command not known"},
                                                      {0xC3, "the BMC timed out itself"},
                                                      {parameterOutOfRange, "parameter out of range"},
                                                      {notFound, "not there"},
                                                      {invalidData, "invalid value"},
                                                      {0xD4, "privilege too low: the session needs privilege = admin"},
                                                      {0xD5, "not possible in the present state"},
                                                      {0xFF, "unspecified error"}};

}  // namespace

std::string describe(std::uint8_t code) {
  std::array<char, 8> number;
  std::snprintf(number.data(), number.size(), "0x%02X", code);
  const auto meaning = meanings.find(code);
  if (meaning == meanings.end()) {
    return std::string("completion code ") + number.data();
  }
  return std::string(meaning->second) + " (" + number.data() + ')';
}

}  // namespace CompletionCode

}  // namespace QV::Ipmi
