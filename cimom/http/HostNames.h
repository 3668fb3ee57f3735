// SPDX-License-Identifier: Apache-2.0
#pragma once

#include <set>
#include <string>

#include "cimom/http/Address.h"
#include "ground/Names.h"

namespace Cimom::Http {

// The names under which clients may ask this server. A browser that a foreign page has sent here, its name made to
// resolve to this machine (DNS rebinding), names that page's host.
class HostNames {
 public:
  // Beside these, "localhost", loopback addresses and the address that a request arrived at.
  explicit HostNames(const std::set<std::string, Ground::NameLess>& names);

  // Takes the value of a Host header, with or without a port.
  bool accepts(const std::string& host, const Address& arrivedAt) const;

 private:
  std::set<std::string, Ground::NameLess> names_;
};

}  // namespace Cimom::Http
