// SPDX-License-Identifier: Apache-2.0
#include "agent/underlying/Host.h"

#include <QV/ProviderHelper.h>
#include <arpa/inet.h>
#include <ifaddrs.h>
#include <net/if.h>
#include <net/route.h>
#include <netpacket/packet.h>

#include <algorithm>
#include <array>
#include <bit>
#include <cstring>
#include <fstream>
#include <memory>
#include <sstream>

namespace QV {
namespace {

// The kernel holds an IPv4 address as a number whose octets lie in memory in network order.
DottedDecimal::Octets octetsOf(in_addr_t address) { return std::bit_cast<DottedDecimal::Octets>(address); }

template <typename SocketAddress>
SocketAddress as(const sockaddr* address) {
  SocketAddress specific{};
  std::memcpy(&specific, address, sizeof specific);
  return specific;
}

// Takes one of getifaddrs' entries in: each interface has one for its hardware and one for each of its addresses, of
// which the first of a family counts.
void take(const ifaddrs& entry, NetworkInterface& interface) {
  interface.enabled = (entry.ifa_flags & IFF_UP) != 0;
  if (!entry.ifa_addr) {
    return;
  }
  const int family = entry.ifa_addr->sa_family;
  if (family == AF_INET && !interface.ipv4Address) {
    interface.ipv4Address = Ipv4Address(octetsOf(as<sockaddr_in>(entry.ifa_addr).sin_addr.s_addr));
    if (entry.ifa_netmask) {
      interface.ipv4SubnetMask = SubnetMask(octetsOf(as<sockaddr_in>(entry.ifa_netmask).sin_addr.s_addr));
    }
  } else if (family == AF_INET6 && !interface.ipv6Address) {
    interface.ipv6Address = Ipv6Address(std::bit_cast<Ipv6Address::Octets>(as<sockaddr_in6>(entry.ifa_addr).sin6_addr));
    if (entry.ifa_netmask) {
      int length = 0;
      for (const unsigned char byte : as<sockaddr_in6>(entry.ifa_netmask).sin6_addr.s6_addr) {
        length += std::popcount(byte);
      }
      interface.ipv6PrefixLength = static_cast<std::uint8_t>(length);
    }
  } else if (family == AF_PACKET) {
    const auto hardware = as<sockaddr_ll>(entry.ifa_addr);
    MacAddress::Octets octets{};
    if (hardware.sll_halen != octets.size()) {
      return;
    }
    std::copy_n(hardware.sll_addr, octets.size(), octets.begin());
    interface.macAddress = MacAddress(octets);
  }
}

std::vector<NetworkInterface> readInterfaces() {
  std::vector<NetworkInterface> interfaces;
  ifaddrs* entries = nullptr;
  if (::getifaddrs(&entries) != 0) {
    return interfaces;
  }
  const std::unique_ptr<ifaddrs, decltype(&::freeifaddrs)> owner(entries, &::freeifaddrs);
  for (const ifaddrs* entry = entries; entry; entry = entry->ifa_next) {
    const std::string name = entry->ifa_name;
    auto interface = std::find_if(interfaces.begin(), interfaces.end(),
                                  [&](const NetworkInterface& known) { return known.name == name; });
    if (interface == interfaces.end()) {
      interface = interfaces.emplace(interfaces.end());
      interface->name = name;
    }
    take(*entry, *interface);
  }
  return interfaces;
}

}  // namespace

std::vector<std::string> parseResolverConfiguration(std::istream& text) {
  std::vector<std::string> servers;
  for (std::string line; std::getline(text, line);) {
    std::istringstream words(line);
    std::string keyword;
    std::string server;
    if (words >> keyword >> server && keyword == "nameserver") {
      servers.push_back(server);
    }
  }
  if (servers.empty()) {
    servers.emplace_back("127.0.0.1");
  }
  return servers;
}

std::map<std::string, Ipv4Address> parseDefaultGateways(std::istream& text) {
  std::map<std::string, Ipv4Address> gateways;
  for (std::string line; std::getline(text, line);) {
    std::istringstream words(line);
    std::string interface;
    in_addr_t destination = 0;
    in_addr_t gateway = 0;
    unsigned flags = 0;
    const bool route = static_cast<bool>(words >> interface >> std::hex >> destination >> gateway >> flags);
    if (route && destination == 0 && (flags & RTF_GATEWAY) != 0) {
      gateways.emplace(interface, octetsOf(gateway));
    }
  }
  return gateways;
}

ManagementProcessor readHost() {
  std::ifstream resolver("/etc/resolv.conf");
  std::ifstream routes("/proc/net/route");
  ManagementProcessor host{getSystemName(), "Host", parseResolverConfiguration(resolver), readInterfaces()};
  const auto gateways = parseDefaultGateways(routes);
  for (NetworkInterface& interface : host.interfaces) {
    const auto gateway = gateways.find(*interface.name);
    if (gateway != gateways.end()) {
      interface.ipv4Gateway = gateway->second;
    }
  }
  return host;
}

}  // namespace QV
