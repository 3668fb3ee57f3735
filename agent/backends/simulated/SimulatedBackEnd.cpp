// SPDX-License-Identifier: Apache-2.0
#include "agent/backends/simulated/SimulatedBackEnd.h"

#include <string.h>
#include <unistd.h>

#include <algorithm>
#include <stdexcept>

#include "agent/backends/simulated/StateText.h"
#include "ground/Settings.h"

namespace QV {

SimulatedBackEnd::SimulatedBackEnd(const std::string& stateFile) : file_(stateFile) {
  try {
    file_.requireWritable();
  } catch (const std::runtime_error& error) {
    throw std::runtime_error(std::string(error.what()) + "; let the object manager's user, " +
                             std::to_string(::geteuid()) +
                             ", write there, or name another file with state in [simulated] of agent.ini");
  }
}

ManagementProcessor SimulatedBackEnd::read() {
  const auto version = file_.version();
  if (version) {
    const std::lock_guard lock(mutex_);
    if (known_ && known_->version == *version) {
      return known_->processor;
    }
  }
  ManagementProcessor processor = readState();
  processor.description = describedAsSimulated(processor.description);
  if (version) {
    const std::lock_guard lock(mutex_);
    known_ = {*version, processor};
  }
  return processor;
}

ManagementProcessor SimulatedBackEnd::readState() {
  if (const auto text = file_.read()) {
    return parse(*text);
  }
  ManagementProcessor processor;
  file_.update([&](const std::optional<std::string>& current) {
    processor = current ? parse(*current) : factoryConfiguration();
    return current ? *current : writeState(processor);
  });
  return processor;
}

void SimulatedBackEnd::change(const std::string& interfaceName, const AddressChange& change) {
  file_.update([&](const std::optional<std::string>& current) {
    ManagementProcessor processor = current ? parse(*current) : factoryConfiguration();
    const auto interface =
        std::find_if(processor.interfaces.begin(), processor.interfaces.end(),
                     [&](const NetworkInterface& candidate) { return candidate.name == interfaceName; });
    if (interface == processor.interfaces.end()) {
      throw std::runtime_error(file_.path().string() + ": there is no interface '" + interfaceName + '\'');
    }
    if (change.ipv4Address) {
      interface->ipv4Address = change.ipv4Address;
    }
    if (change.ipv4SubnetMask) {
      interface->ipv4SubnetMask = change.ipv4SubnetMask;
    }
    interface->ipv4Origin = AddressOrigin::Static;
    return writeState(processor);
  });
}

ManagementProcessor SimulatedBackEnd::parse(const std::string& text) const {
  try {
    return parseState(text);
  } catch (const std::runtime_error& error) {
    throw std::runtime_error(file_.path().string() + ": " + error.what());
  }
}

std::string parseSimulatedSettings(const BackEndSettings& section) {
  const Ground::Settings settings("agent.ini, [simulated]", section);
  for (const auto& [key, value] : section) {
    if (key != "state") {
      settings.refuse(key, value, "there is no such key: must be one of state");
    }
  }
  std::string state = "/var/lib/compositeipconfig/management-processor.json";
  settings.absolutePath("state", state);
  return state;
}

std::string describedAsSimulated(const std::string& description) {
  return description.empty() || ::strcasestr(description.c_str(), "simulated") ? description
                                                                               : description + " (simulated)";
}

ManagementProcessor factoryConfiguration() {
  NetworkInterface fixed;
  fixed.name = "eth0";
  fixed.macAddress = MacAddress::parse("02:00:00:00:00:01").value();
  fixed.ipv4Address = Ipv4Address({192, 0, 2, 10});
  fixed.ipv4SubnetMask = SubnetMask({255, 255, 255, 0});
  fixed.ipv4Gateway = Ipv4Address({192, 0, 2, 1});
  fixed.ipv4Origin = AddressOrigin::Static;
  fixed.ipv6Address = Ipv6Address::parse("2001:db8::10").value();
  fixed.ipv6PrefixLength = std::uint8_t{64};
  fixed.ipv6Origin = AddressOrigin::Static;

  NetworkInterface leased;
  leased.name = "eth1";
  leased.macAddress = MacAddress::parse("02:00:00:00:00:02").value();
  leased.ipv4Address = Ipv4Address({198, 51, 100, 23});
  leased.ipv4SubnetMask = SubnetMask({255, 255, 255, 0});
  leased.ipv4Origin = AddressOrigin::Dhcp;

  return {"BMC", "Simulated management processor", {"192.0.2.53", "2001:db8::53"}, {fixed, leased}};
}

}  // namespace QV
