// SPDX-License-Identifier: Apache-2.0
#include "cimom/http/Address.h"

#include <arpa/inet.h>

#include <array>
#include <cstring>

namespace Cimom::Http {
namespace {

constexpr std::size_t sizeOfIpv4 = 4;
constexpr std::size_t mappedPrefix = 12;
constexpr std::size_t networkPrefix = 8;
constexpr unsigned char loopbackNetwork = 127;

}  // namespace

Address::Address(const sockaddr* address) {
  if (address && address->sa_family == AF_INET) {
    family_ = AF_INET;
    std::memcpy(&bytes_, &reinterpret_cast<const sockaddr_in*>(address)->sin_addr, sizeOfIpv4);
  } else if (address && address->sa_family == AF_INET6) {
    family_ = AF_INET6;
    bytes_ = reinterpret_cast<const sockaddr_in6*>(address)->sin6_addr;
    simplify();
  }
}

std::optional<Address> Address::parse(const std::string& text) {
  Address parsed;
  for (const int family : {AF_INET, AF_INET6}) {
    if (inet_pton(family, text.c_str(), &parsed.bytes_) == 1) {
      parsed.family_ = family;
      parsed.simplify();
      return parsed;
    }
  }
  return std::nullopt;
}

bool Address::isLoopback() const {
  return family_ == AF_INET ? bytes_.s6_addr[0] == loopbackNetwork
                            : family_ == AF_INET6 && IN6_IS_ADDR_LOOPBACK(&bytes_) != 0;
}

std::string Address::text() const {
  std::array<char, INET6_ADDRSTRLEN> buffer{};
  return family_ == AF_UNSPEC || !inet_ntop(family_, &bytes_, buffer.data(), buffer.size()) ? "" : buffer.data();
}

std::string Address::group() const {
  Address network = *this;
  if (family_ == AF_INET6) {
    std::memset(network.bytes_.s6_addr + networkPrefix, 0, sizeof network.bytes_ - networkPrefix);
  }
  return network.text();
}

bool Address::operator==(const Address& other) const {
  return family_ == other.family_ && std::memcmp(&bytes_, &other.bytes_, sizeof bytes_) == 0;
}

void Address::simplify() {
  if (family_ == AF_INET6 && IN6_IS_ADDR_V4MAPPED(&bytes_)) {
    in6_addr mapped{};
    std::memcpy(&mapped, bytes_.s6_addr + mappedPrefix, sizeOfIpv4);
    bytes_ = mapped;
    family_ = AF_INET;
  }
}

}  // namespace Cimom::Http
