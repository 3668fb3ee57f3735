// SPDX-License-Identifier: Apache-2.0
#include "bmcip/model/Vocabulary.h"

namespace Bmcip {
namespace {

struct Word {
  std::string_view property;
  std::string_view code;
  const char* word;
};

// As the DMTF's value maps have them.
constexpr Word words[] = {
    {"AccessContext", "0", "unknown"},
    {"AccessContext", "1", "other"},
    {"AccessContext", "2", gatewayContext},
    {"AccessContext", "3", dnsContext},
    {"AccessContext", "4", "SNMP trap destination"},
    {"AccessContext", "5", "MPLS tunnel destination"},
    {"AddressOrigin", "0", "unknown"},
    {"AddressOrigin", "1", "other"},
    {"AddressOrigin", "2", "not applicable"},
    {"AddressOrigin", "3", staticOrigin},
    {"AddressOrigin", "4", "DHCP"},
    {"AddressOrigin", "5", "BOOTP"},
    {"AddressOrigin", "6", "IPv4 link local"},
    {"AddressOrigin", "7", "DHCPv6"},
    {"AddressOrigin", "8", "IPv6 autoconfiguration"},
    {"AddressOrigin", "9", "stateless"},
    {"AddressOrigin", "10", "link local"},
    {"AddressOrigin", "11", "cumulative configuration"},
    {"Dedicated", "14", "management"},
    {"Dedicated", "28", "management controller"},
    {"EnabledState", "0", "unknown"},
    {"EnabledState", "1", "other"},
    {"EnabledState", "2", "enabled"},
    {"EnabledState", "3", "disabled"},
    {"EnabledState", "4", "shutting down"},
    {"EnabledState", "5", "not applicable"},
    {"EnabledState", "6", "enabled but offline"},
    {"EnabledState", "7", "in test"},
    {"EnabledState", "8", "deferred"},
    {"EnabledState", "9", "quiesce"},
    {"EnabledState", "10", "starting"},
    // 0 is the product's own.
    {"ProtocolIFType", "0", "no IP"},
    {"ProtocolIFType", "4096", "IPv4"},
    {"ProtocolIFType", "4097", "IPv6"},
    {"ProtocolIFType", "4098", "IPv4 and IPv6"},
};

}  // namespace

std::string wordOf(std::string_view property, const std::string& code) {
  for (const Word& row : words) {
    if (row.property == property && row.code == code) {
      return row.word;
    }
  }
  return code.empty() ? "" : "code " + code;
}

}  // namespace Bmcip
