// SPDX-License-Identifier: Apache-2.0
// The [ipmi] section of agent.ini: how the management processor is reached and how long it may take.
#pragma once

#include <chrono>
#include <cstdint>
#include <string>
#include <vector>

#include "agent/processor/BackEnd.h"

namespace QV::Ipmi {

// Which LAN channels of the processor are its interfaces.
struct ChannelChoice {
  enum class Mode {
    InUse,  // over LAN the channel that the session runs on; in-band the first LAN channel
    All,    // every LAN channel that the processor has
    Listed
  };
  Mode mode = Mode::InUse;
  std::vector<std::uint8_t> listed;  // ascending, without duplicates, each 1 to 11
};

// Which IPv6 address of an interface is read. One costs a round trip, so one kind is chosen.
enum class Ipv6Choice { Off, Static, Dynamic };

struct IpmiSettings {
  enum class Connection { InBand, Lan };
  Connection connection = Connection::InBand;

  // In-band: the character device of the operating system's IPMI driver.
  std::string device = "/dev/ipmi0";

  // LAN: an RMCP+ session (IPMI 2.0).
  std::string host;  // a name, an IPv4 or an IPv6 address
  std::uint16_t port = 623;
  std::string user;          // at most 16 bytes
  std::string passwordFile;  // read whenever a session opens, so a new password needs no restart
  std::string keyFile;       // the BMC key K_g; empty: the BMC has none
  std::uint8_t cipherSuite = 17;
  std::uint8_t privilege = 4;  // IPMI's numbers: 2 user, 3 operator, 4 administrator
  unsigned workarounds = 0;    // libfreeipmi's flags for RMCP+ sessions

  ChannelChoice channels;
  Ipv6Choice ipv6 = Ipv6Choice::Static;

  std::chrono::milliseconds operationTimeout{5000};
  std::chrono::milliseconds sessionTimeout{3000};
  std::chrono::milliseconds retransmissionTimeout{500};
  std::chrono::milliseconds cache{1000};

  // Where all processes of the machine tell each other of changes, so that a look is kept no longer than it is true.
  std::string generationFile = "/var/lib/compositeipconfig/ipmi-generation";
};

// The settings that the section tells, checked. Throws std::runtime_error that names the key and what is wrong with its
// value: an unknown key, a value of another form or out of range, a key that the other kind of connection has, a key
// that is missing, a password file that others can read.
IpmiSettings parseSettings(const BackEndSettings& section);

// The secrets of a session: the first lines of their files. Throw std::runtime_error as Ground::readSecretFile does,
// and if a line is empty or longer than IPMI allows (20 bytes each). The key may be given as text or, after 0x, as
// hexadecimal digits.
std::string readPassword(const IpmiSettings& settings);
std::string readKey(const IpmiSettings& settings);

}  // namespace QV::Ipmi
