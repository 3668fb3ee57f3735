// SPDX-License-Identifier: Apache-2.0
#include "cimom/http/HostNames.h"

#include <algorithm>

namespace Cimom::Http {
namespace {

// "[::1]:5988" is "::1", "localhost:5988" and "localhost." are "localhost"; empty for what is no host.
std::string nameOf(const std::string& host) {
  std::string name = host;
  std::string port;
  if (host.starts_with('[')) {
    const auto end = host.find(']');
    if (end == std::string::npos) {
      return {};
    }
    name = host.substr(1, end - 1);
    port = host.substr(end + 1);
    if (!port.empty() && port.front() != ':') {
      return {};
    }
  } else if (const auto colon = host.find(':'); colon != std::string::npos) {
    name = host.substr(0, colon);
    port = host.substr(colon);
  }
  if (!std::all_of(port.begin() + (port.empty() ? 0 : 1), port.end(), [](char c) { return c >= '0' && c <= '9'; })) {
    return {};
  }
  if (name.ends_with('.')) {
    name.pop_back();
  }
  return name;
}

}  // namespace

HostNames::HostNames(const std::set<std::string, Ground::NameLess>& names) : names_(names) {
  names_.insert("localhost");
}

bool HostNames::accepts(const std::string& host, const Address& arrivedAt) const {
  const std::string name = nameOf(host);
  if (names_.contains(name)) {
    return !name.empty();
  }
  const auto address = Address::parse(name);
  return address && (address->isLoopback() || *address == arrivedAt);
}

}  // namespace Cimom::Http
