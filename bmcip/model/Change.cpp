// SPDX-License-Identifier: Apache-2.0
#include "bmcip/model/Change.h"

#include <algorithm>
#include <stdexcept>

#include "agent/processor/Addresses.h"
#include "bmcip/model/Vocabulary.h"
#include "ground/Values.h"

namespace Bmcip {
namespace {

using QV::Ipv4Address;
using QV::SubnetMask;

struct OutcomeRow {
  const char* word;
  Outcome outcome;
  int exitStatus;
};

constexpr OutcomeRow outcomes[] = {
    {"applied", Outcome::Applied, 0},          {"unchanged", Outcome::Unchanged, 0},
    {"would-change", Outcome::WouldChange, 0}, {"refused", Outcome::Refused, 3},
    {"ignored", Outcome::Ignored, 4},          {"half-applied", Outcome::HalfApplied, 5},
    {"unknown", Outcome::Unknown, 6},          {"not-confirmed", Outcome::NotConfirmed, 7},
};

const OutcomeRow& rowOf(Outcome outcome) { return *std::ranges::find(outcomes, outcome, &OutcomeRow::outcome); }

std::string maskOfLength(std::uint64_t length) {
  const auto number = static_cast<std::uint32_t>(~std::uint64_t{0} << (32 - length));
  return SubnetMask({static_cast<std::uint8_t>(number >> 24), static_cast<std::uint8_t>(number >> 16),
                     static_cast<std::uint8_t>(number >> 8), static_cast<std::uint8_t>(number)})
      .text();
}

}  // namespace

const char* wordOf(Outcome outcome) { return rowOf(outcome).word; }

int exitStatusOf(Outcome outcome) { return rowOf(outcome).exitStatus; }

Ipv4Settings settingsOf(const Interface& interface) { return {interface.address, interface.mask, interface.origin}; }

bool Change::isNeeded() const { return !isShownBy(before); }

bool Change::isShownBy(const Ipv4Settings& settings) const {
  return settings.address == wanted.address && settings.mask == wanted.mask &&
         (settings.origin == wanted.origin || settings.origin.empty() || settings.origin == "unknown");
}

TextValues Change::values() const {
  TextValues values;
  if (Ipv4Address::parse(wanted.address) && !Ipv4Address::parse(wanted.address)->unusable()) {
    values.emplace_back("IPv4Address", wanted.address);
  }
  if (SubnetMask::parse(wanted.mask) && !SubnetMask::parse(wanted.mask)->unusable()) {
    values.emplace_back("SubnetMask", wanted.mask);
  }
  return values;
}

Ipv4Settings parseAddressWithPrefix(const std::string& text) {
  const auto slash = text.find('/');
  if (slash == std::string::npos) {
    return {text, "", ""};
  }
  const std::string length = text.substr(slash + 1);
  try {
    return {text.substr(0, slash), maskOfLength(Ground::parseNumber(length, 1, 31)), ""};
  } catch (const std::invalid_argument& refusal) {
    throw std::invalid_argument("the prefix length \"" + length + "\" " + refusal.what());
  }
}

Change planChange(const Interface& interface, const std::string& address, const std::string& mask) {
  Change change{interface.name, interface.path, settingsOf(interface), settingsOf(interface)};
  change.wanted.origin = staticOrigin;
  if (!address.empty()) {
    change.wanted.address = Ipv4Address::requireHost(address).text();
  }
  if (!mask.empty()) {
    change.wanted.mask = SubnetMask::requireUsable(mask).text();
  }
  const auto wantedAddress = Ipv4Address::parse(change.wanted.address);
  const auto wantedMask = SubnetMask::parse(change.wanted.mask);
  if (wantedAddress && !wantedAddress->unusable() && wantedMask && !wantedMask->unusable()) {
    requireHostOfSubnet(*wantedAddress, *wantedMask);
  }
  return change;
}

Outcome judge(const Change& change, const std::optional<Ipv4Settings>& shown, bool refused) {
  if (!shown) {
    return refused ? Outcome::Refused : Outcome::Unknown;
  }
  if (change.isShownBy(*shown)) {
    return Outcome::Applied;
  }
  if (*shown != change.before) {
    return Outcome::HalfApplied;
  }
  return refused ? Outcome::Refused : Outcome::Ignored;
}

}  // namespace Bmcip
