// SPDX-License-Identifier: Apache-2.0
// What a server shows of its management processor, as plain values. A value that the server does not show is empty.
#pragma once

#include <functional>
#include <optional>
#include <string>
#include <utility>
#include <vector>

#include "bmcip/client/Operations.h"
#include "bmcip/client/Transport.h"

namespace Bmcip {

struct System {
  std::string name;
  std::string description;
  std::vector<std::string> roles;
};

struct Interface {
  std::string name;
  std::string address;
  std::string mask;
  std::string origin;
  std::string ipv6Address;
  std::string ipv6Prefix;
  std::string state;
  std::string protocol;
  ObjectName path;

  // "192.0.2.10/24"; without a length if the mask has none. Empty without an address.
  std::string addressWithPrefix() const;
  std::string ipv6WithPrefix() const;
};

// A gateway or a DNS server.
struct AccessPoint {
  std::string name;
  std::string address;
  std::string context;
};

struct Processor {
  std::vector<System> systems;
  std::vector<Interface> interfaces;
  std::vector<AccessPoint> accessPoints;

  const Interface* findInterface(const std::string& name) const;
  std::vector<AccessPoint> accessPointsOf(const std::string& context) const;

  // Everything as "what" and its value: "eth0 address", "192.0.2.10/24".
  std::vector<std::pair<std::string, std::string>> facts() const;
};

// The length of a mask's prefix, if it is one.
std::optional<int> prefixLength(const std::string& mask);

// What came of asking one server.
struct Reading {
  Server server;
  std::optional<Failure> failure;  // then the processor is of no meaning
  Processor processor;
  std::string peer;  // the numeric address that answered
};

// Asks for the processor; `done` is called from the transport's run().
void readProcessor(Transport& transport, const Server& server, std::function<void(Reading)> done);

// The same, and waits. Throws Failure.
Reading readProcessor(Transport& transport, const Server& server);

}  // namespace Bmcip
