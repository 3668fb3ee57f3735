// SPDX-License-Identifier: Apache-2.0
#include "agent/instrumentation/InterfaceCursor.h"

#include <algorithm>
#include <stdexcept>
#include <utility>

#include "agent/processor/Addresses.h"

namespace QV {
namespace {

template <typename Address>
std::optional<std::string> textOf(const std::optional<Address>& address) {
  return address ? std::optional(address->text()) : std::nullopt;
}

bool isAddressProperty(NodeLexicon::Properties property) {
  return property == NodeLexicon::Ipv4Address || property == NodeLexicon::Ipv4SubnetMask;
}

// What a change leaves as it is. An address or mask that no host can have (a DHCP client without a lease shows 0.0.0.0)
// says nothing about the new value beside it.
void requireConsistent(const std::optional<Ipv4Address>& address, const std::optional<SubnetMask>& mask) {
  if (address && mask && !address->unusable() && !mask->unusable()) {
    requireHostOfSubnet(*address, *mask);
  }
}

// Runs the check of a change, and names the interface where it refuses.
template <typename Check>
auto checked(const std::string& interfaceName, const Check& check) {
  try {
    return check();
  } catch (const std::invalid_argument& refusal) {
    throw std::invalid_argument("interface " + interfaceName + ": " + refusal.what() + "; nothing was changed");
  }
}

}  // namespace

void InterfaceCursor::select(NodeLexicon::NodeType type) {
  flush();
  position_ = 0;
  names_.clear();
  interfaces_.reset();
  if (type == NodeLexicon::IpInterfaceNode) {
    names_ = backEnd_->interfaceNames();
  }
}

const NetworkInterface* InterfaceCursor::current() {
  if (!interfaces_) {
    interfaces_ = backEnd_->read().interfaces;
  }
  const auto& name = names_[position_];
  if (position_ < interfaces_->size() && (*interfaces_)[position_].name == name) {
    return &(*interfaces_)[position_];
  }
  const auto found = std::ranges::find(*interfaces_, name, &NetworkInterface::name);
  return name && found != interfaces_->end() ? &*found : nullptr;
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
  std::optional<std::string> held;
  if (property == NodeLexicon::NodeName) {
    held = names_[position_];
    if (!held) {
      advance();
    }
  } else if (isAddressProperty(property)) {
    if (const NetworkInterface* interface = current()) {
      held = property == NodeLexicon::Ipv4Address ? textOf(interface->ipv4Address) : textOf(interface->ipv4SubnetMask);
    }
  }
  if (!held) {
    return false;
  }
  value = *std::move(held);
  return true;
}

bool InterfaceCursor::set(NodeLexicon::Properties property, const std::string& value) {
  if (!onNode() || !isAddressProperty(property) || !names_[position_]) {
    return false;
  }
  const std::string& name = *names_[position_];
  // Refused or not, the value takes the place of what was staged before it.
  auto address = std::exchange(stagedAddress_, {});
  if (property == NodeLexicon::Ipv4Address) {
    stagedAddress_ = checked(name, [&] { return Ipv4Address::requireHost(value); });
  } else {
    send({address, checked(name, [&] { return SubnetMask::requireUsable(value); })});
  }
  return true;
}

void InterfaceCursor::flush() {
  if (stagedAddress_) {
    send({std::exchange(stagedAddress_, {}), {}});
  }
}

// The value that does not change is looked at only where the other comes alone.
void InterfaceCursor::send(const AddressChange& change) {
  const std::string& name = *names_[position_];
  const bool whole = change.ipv4Address && change.ipv4SubnetMask;
  const NetworkInterface* const present = whole ? nullptr : current();
  checked(name, [&] {
    requireConsistent(change.ipv4Address || !present ? change.ipv4Address : present->ipv4Address,
                      change.ipv4SubnetMask || !present ? change.ipv4SubnetMask : present->ipv4SubnetMask);
  });
  backEnd_->change(name, change);
  interfaces_.reset();
}

}  // namespace QV
