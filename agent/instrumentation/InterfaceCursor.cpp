// SPDX-License-Identifier: Apache-2.0
#include "agent/instrumentation/InterfaceCursor.h"

#include <stdexcept>
#include <utility>

#include "agent/processor/Addresses.h"

namespace QV {
namespace {

template <typename Address>
std::optional<std::string> textOf(const std::optional<Address>& address) {
  return address ? std::optional(address->text()) : std::nullopt;
}

// Nothing too for a property that an interface does not have.
std::optional<std::string> textOf(const NetworkInterface& interface, NodeLexicon::Properties property) {
  switch (property) {
    case NodeLexicon::Ipv4Address:
      return textOf(interface.ipv4Address);
    case NodeLexicon::Ipv4SubnetMask:
      return textOf(interface.ipv4SubnetMask);
    case NodeLexicon::NodeName:
      return interface.name;
  }
  return std::nullopt;
}

// The interface as it will be. An address or mask that it has now and that no host can have (a DHCP client without a
// lease shows 0.0.0.0) says nothing about the new value beside it.
void requireConsistent(const NetworkInterface& current, const AddressChange& change) {
  const auto& address = change.ipv4Address ? change.ipv4Address : current.ipv4Address;
  const auto& mask = change.ipv4SubnetMask ? change.ipv4SubnetMask : current.ipv4SubnetMask;
  if (address && mask && !address->unusable() && !mask->unusable()) {
    requireHostOfSubnet(*address, *mask);
  }
}

// Runs the check of a change, and names the interface where it refuses.
template <typename Check>
auto checked(const NetworkInterface& interface, const Check& check) {
  try {
    return check();
  } catch (const std::invalid_argument& refusal) {
    throw std::invalid_argument("interface " + *interface.name + ": " + refusal.what() + "; nothing was changed");
  }
}

}  // namespace

void InterfaceCursor::select(NodeLexicon::NodeType type) {
  flush();
  position_ = 0;
  interfaces_.clear();
  if (type == NodeLexicon::IpInterfaceNode) {
    interfaces_ = backEnd_->read().interfaces;
  }
}

void InterfaceCursor::advance() {
  flush();
  if (onNode()) {
    ++position_;
  }
}

bool InterfaceCursor::get(NodeLexicon::Properties property, std::string& value) {
  if (!onNode()) {
    return false;
  }
  auto held = textOf(interfaces_[position_], property);
  if (!held) {
    if (property == NodeLexicon::NodeName) {
      advance();
    }
    return false;
  }
  value = *std::move(held);
  return true;
}

bool InterfaceCursor::set(NodeLexicon::Properties property, const std::string& value) {
  const bool settable = property == NodeLexicon::Ipv4Address || property == NodeLexicon::Ipv4SubnetMask;
  if (!onNode() || !settable || !interfaces_[position_].name) {
    return false;
  }
  const NetworkInterface& interface = interfaces_[position_];
  // Refused or not, the value takes the place of what was staged before it.
  auto address = std::exchange(stagedAddress_, {});
  if (property == NodeLexicon::Ipv4Address) {
    stagedAddress_ = checked(interface, [&] { return Ipv4Address::requireHost(value); });
  } else {
    send({address, checked(interface, [&] { return SubnetMask::requireUsable(value); })});
  }
  return true;
}

void InterfaceCursor::flush() {
  if (stagedAddress_) {
    send({std::exchange(stagedAddress_, {}), {}});
  }
}

void InterfaceCursor::send(const AddressChange& change) {
  NetworkInterface& interface = interfaces_[position_];
  checked(interface, [&] { requireConsistent(interface, change); });
  backEnd_->change(*interface.name, change);
  if (change.ipv4Address) {
    interface.ipv4Address = change.ipv4Address;
  }
  if (change.ipv4SubnetMask) {
    interface.ipv4SubnetMask = change.ipv4SubnetMask;
  }
  interface.ipv4Origin = AddressOrigin::Static;
}

}  // namespace QV
