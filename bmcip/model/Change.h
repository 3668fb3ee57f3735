// SPDX-License-Identifier: Apache-2.0
// A change of an interface's address and mask: what is asked for, and what came of it.
#pragma once

#include <optional>
#include <string>

#include "bmcip/model/Processor.h"

namespace Bmcip {

enum class Outcome { Applied, Unchanged, WouldChange, Refused, Ignored, HalfApplied, Unknown, NotConfirmed };

const char* wordOf(Outcome outcome);  // "applied", "half-applied"
int exitStatusOf(Outcome outcome);

struct Ipv4Settings {
  std::string address;
  std::string mask;
  std::string origin;

  bool operator==(const Ipv4Settings&) const = default;
};

Ipv4Settings settingsOf(const Interface& interface);

struct Change {
  std::string interface;
  ObjectName path;
  Ipv4Settings before;
  Ipv4Settings wanted;

  bool isNeeded() const;
  // Whether these settings are the wanted ones. An origin that nobody shows is as good as the wanted one.
  bool isShownBy(const Ipv4Settings& settings) const;
  // What is sent: always both, where both are known.
  TextValues values() const;
};

// "192.0.2.77/25" as address and mask; without a length the mask stays empty. Throws std::invalid_argument.
Ipv4Settings parseAddressWithPrefix(const std::string& text);

// The change of an interface to the address and the mask that are not empty. Throws std::invalid_argument where no
// management processor would take them.
Change planChange(const Interface& interface, const std::string& address, const std::string& mask);

// @param shown what the processor shows now; nothing if nobody knows
// @param refused whether the object manager answered with an error
Outcome judge(const Change& change, const std::optional<Ipv4Settings>& shown, bool refused);

struct ChangeReport {
  Server server;
  Change change;
  Outcome outcome = Outcome::Unknown;
  std::optional<Ipv4Settings> after;
  std::string message;  // one sentence
};

}  // namespace Bmcip
