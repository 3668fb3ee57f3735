#include "agent/instrumentation/InterfaceCursor.h"

#include <stdexcept>
#include <utility>

#include "agent/processor/AddressValidation.h"

namespace QV {
namespace {

// The member that holds a readable property; null for a property that an interface does not have.
using Member = std::optional<std::string> NetworkInterface::*;

Member memberOf(NodeLexicon::Properties property) {
  switch (property) {
    case NodeLexicon::Ipv4Address:
      return &NetworkInterface::ipv4Address;
    case NodeLexicon::Ipv4SubnetMask:
      return &NetworkInterface::ipv4SubnetMask;
    case NodeLexicon::NodeName:
      return &NetworkInterface::name;
  }
  return nullptr;
}

// The interface as it will be. An address or mask that it has now and that no host can have (a DHCP client without a
// lease shows 0.0.0.0) tells nothing about the new value beside it.
void requireConsistent(const NetworkInterface& current, const AddressChange& change) {
  const auto usable = [](const auto& require, const std::optional<std::string>& text) -> std::optional<Ipv4> {
    try {
      if (text) return require(*text);
    } catch (const std::invalid_argument&) {
    }
    return std::nullopt;
  };
  const auto address = usable(requireHostAddress, change.ipv4Address ? change.ipv4Address : current.ipv4Address);
  const auto mask = usable(requireSubnetMask, change.ipv4SubnetMask ? change.ipv4SubnetMask : current.ipv4SubnetMask);
  if (address && mask) requireHostOfSubnet(*address, *mask);
}

}  // namespace

void InterfaceCursor::select(NodeLexicon::NodeType type) {
  flush();
  position_ = 0;
  interfaces_.clear();
  if (type == NodeLexicon::IpInterfaceNode) interfaces_ = backEnd_->read().interfaces;
}

void InterfaceCursor::advance() {
  flush();
  if (onNode()) ++position_;
}

bool InterfaceCursor::get(NodeLexicon::Properties property, std::string& value) {
  const Member member = memberOf(property);
  if (!onNode() || !member) return false;
  const auto& held = interfaces_[position_].*member;
  if (!held) {
    if (property == NodeLexicon::NodeName) advance();
    return false;
  }
  value = *held;
  return true;
}

bool InterfaceCursor::set(NodeLexicon::Properties property, const std::string& value) {
  const bool settable = property == NodeLexicon::Ipv4Address || property == NodeLexicon::Ipv4SubnetMask;
  if (!onNode() || !settable || !interfaces_[position_].name) return false;
  if (property == NodeLexicon::Ipv4Address)
    stageAddress(value);
  else
    sendWithMask(value);
  return true;
}

void InterfaceCursor::flush() {
  if (stagedAddress_) send({std::exchange(stagedAddress_, {}), {}});
}

void InterfaceCursor::stageAddress(const std::string& address) {
  stagedAddress_.reset();
  try {
    requireHostAddress(address);
  } catch (const std::invalid_argument& refusal) {
    throw std::invalid_argument("interface " + *interfaces_[position_].name + ": " + refusal.what() +
                                "; nothing was changed");
  }
  stagedAddress_ = address;
}

void InterfaceCursor::sendWithMask(const std::string& mask) { send({std::exchange(stagedAddress_, {}), mask}); }

void InterfaceCursor::send(AddressChange change) {
  NetworkInterface& interface = interfaces_[position_];
  try {
    if (change.ipv4SubnetMask) requireSubnetMask(*change.ipv4SubnetMask);
    requireConsistent(interface, change);
  } catch (const std::invalid_argument& refusal) {
    throw std::invalid_argument("interface " + *interface.name + ": " + refusal.what() + "; nothing was changed");
  }
  backEnd_->change(*interface.name, change);
  if (change.ipv4Address) interface.ipv4Address = std::move(change.ipv4Address);
  if (change.ipv4SubnetMask) interface.ipv4SubnetMask = std::move(change.ipv4SubnetMask);
  interface.ipv4Origin = AddressOrigin::Static;
}

}  // namespace QV
