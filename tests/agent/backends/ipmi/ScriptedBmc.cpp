// SPDX-License-Identifier: Apache-2.0
#include "tests/agent/backends/ipmi/ScriptedBmc.h"

#include "agent/backends/ipmi/lan/LanParameters.h"

namespace Testing {
namespace {

namespace Code = QV::Ipmi::CompletionCode;

constexpr std::uint8_t setLan = 0x01, getLan = 0x02;

}  // namespace

ScriptedBmc::ScriptedBmc()
    : values{{LanParameter::AddressSource, {1}},
             {LanParameter::IpAddress, {192, 0, 2, 10}},
             {LanParameter::SubnetMask, {255, 255, 255, 0}},
             {LanParameter::DefaultGateway, {192, 0, 2, 1}}} {}

IpmiResponse ScriptedBmc::send(const IpmiRequest& request, QV::Ipmi::Repetition) {
  beforeRequest(++requests);
  IpmiResponse response = answer(request);
  if (requests == lateRequest) {
    response = answer(request);
    response.late = true;
  }
  return response;
}

IpmiResponse ScriptedBmc::answer(const IpmiRequest& request) {
  if (request.networkFunction == QV::Ipmi::NetworkFunction::Application) {
    return channelInfo(request.data.at(0));
  }
  if (!lanChannels.contains(request.data.at(0))) {
    return {Code::invalidData, {}};
  }
  const auto parameter = static_cast<LanParameter>(request.data.at(1));
  if (request.command == getLan) {
    return get(parameter);
  }
  if (request.command == setLan) {
    return {set(parameter, {request.data.begin() + 2, request.data.end()}), {}};
  }
  return {0xC1, {}};
}

IpmiResponse ScriptedBmc::channelInfo(std::uint8_t channel) const {
  constexpr std::uint8_t lanMedium = 4, systemInterfaceMedium = 12;
  if (channel == 0x0E) {
    channel = presentChannel;
  }
  if (channel == 0x0F) {
    return {Code::done, {channel, systemInterfaceMedium, 5, 0, 0, 0, 0, 0, 0}};
  }
  if (!lanChannels.contains(channel)) {
    return {Code::invalidData, {}};
  }
  return {Code::done, {channel, lanMedium, 1, 0x80, 0, 0, 0, 0, 0}};
}

IpmiResponse ScriptedBmc::get(LanParameter parameter) {
  constexpr std::uint8_t revision = 0x11;
  if (const auto refused = readRefused.find(parameter); refused != readRefused.end()) {
    return {refused->second, {}};
  }
  if (parameter == LanParameter::IpAddress && readsUntilApplied > 0 && --readsUntilApplied == 0) {
    earlier_.reset();
  }
  const auto& shown = earlier_ ? *earlier_ : values;
  const auto value = shown.find(parameter);
  if (value == shown.end()) {
    return {Code::parameterNotSupported, {}};
  }
  ParameterData data = {revision};
  data.insert(data.end(), value->second.begin(), value->second.end());
  return {Code::done, data};
}

std::uint8_t ScriptedBmc::set(LanParameter parameter, const ParameterData& data) {
  if (parameter == LanParameter::SetInProgress) {
    return setProgress(data.at(0));
  }
  if (const auto refused = refuses.find(parameter); refused != refuses.end()) {
    return refused->second;
  }
  if (refusesAddressUnderDhcp && parameter == LanParameter::IpAddress) {
    const auto source = staged_.contains(LanParameter::AddressSource) ? staged_ : values;
    if (source.at(LanParameter::AddressSource) != ParameterData{1}) {
      return Code::invalidData;
    }
  }
  written.emplace_back(parameter, data);
  staged_[parameter] = data;
  if (applies == Applies::AtOnce || !hasLock) {
    apply();
  }
  return Code::done;
}

std::uint8_t ScriptedBmc::setProgress(std::uint8_t step) {
  if (!hasLock) {
    return Code::parameterNotSupported;
  }
  if (busy) {
    return 0xC0;
  }
  progress.push_back(step);
  if (step == 1) {
    if (locked || lockedByAnother) {
      return Code::setInProgress;
    }
    locked = true;
  } else if (step == 2) {
    if (applies == Applies::AtOnce) {
      return Code::parameterNotSupported;
    }
    if (applies == Applies::OnCommit) {
      apply();
    }
  } else {
    if (applies == Applies::OnComplete) {
      apply();
    }
    staged_.clear();
    locked = false;
  }
  return Code::done;
}

void ScriptedBmc::apply() {
  if (readsUntilApplied > 0) {
    earlier_ = values;
  }
  for (const auto& [parameter, data] : staged_) {
    values[parameter] = data;
  }
  staged_.clear();
}

}  // namespace Testing
