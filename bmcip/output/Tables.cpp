// SPDX-License-Identifier: Apache-2.0
#include "bmcip/output/Tables.h"

#include <algorithm>

#include "bmcip/model/Vocabulary.h"

namespace Bmcip {
namespace {

using Rows = std::vector<std::vector<std::string>>;

std::string joined(const std::vector<std::string>& texts, const char* separator) {
  std::string all;
  for (const std::string& text : texts) {
    all += (all.empty() ? "" : separator) + text;
  }
  return all;
}

std::string section(const std::string& title, const Rows& rows, const Colours& colours) {
  return colours.bold + title + colours.plain + '\n' + tableOf(rows, colours, "  ");
}

// A word of a line: blanks would be another column to awk and column.
std::string withoutBlanks(std::string text) {
  std::ranges::replace(text, ' ', '-');
  return text;
}

std::vector<std::string> addressesOf(const std::vector<AccessPoint>& accessPoints) {
  std::vector<std::string> addresses;
  addresses.reserve(accessPoints.size());
  for (const AccessPoint& accessPoint : accessPoints) {
    addresses.push_back(withoutBlanks(accessPoint.address));
  }
  return addresses;
}

std::vector<std::string> rowOf(const std::string& what, const Ipv4Settings& settings) {
  return {what, settings.address, settings.mask, settings.origin};
}

}  // namespace

std::string tablesOf(const Processor& processor, const Colours& colours) {
  Rows systems = {{"NAME", "ROLES", "DESCRIPTION"}};
  for (const System& system : processor.systems) {
    systems.push_back({system.name, joined(system.roles, ", "), system.description});
  }
  Rows interfaces = {{"NAME", "ADDRESS", "MASK", "ORIGIN", "IPV6", "STATE"}};
  for (const Interface& interface : processor.interfaces) {
    interfaces.push_back({interface.name, interface.addressWithPrefix(), interface.mask, interface.origin,
                          interface.ipv6WithPrefix(), interface.state});
  }
  std::string text =
      section("Management processor", systems, colours) + '\n' + section("IP interfaces", interfaces, colours);
  Rows gateways = {{"NAME", "ADDRESS"}};
  Rows servers = gateways;
  Rows others = {{"NAME", "ADDRESS", "KIND"}};
  for (const AccessPoint& accessPoint : processor.accessPoints) {
    if (accessPoint.context == gatewayContext) {
      gateways.push_back({accessPoint.name, accessPoint.address});
    } else if (accessPoint.context == dnsContext) {
      servers.push_back({accessPoint.name, accessPoint.address});
    } else {
      others.push_back({accessPoint.name, accessPoint.address, accessPoint.context});
    }
  }
  for (const auto& [title, rows] :
       {std::pair("Gateways", gateways), {"DNS servers", servers}, {"Other access points", others}}) {
    if (rows.size() > 1) {
      text += '\n' + section(title, rows, colours);
    }
  }
  return text;
}

std::vector<std::string> fleetHeading() { return {"SERVER", "INTERFACES", "GATEWAYS", "DNS"}; }

std::vector<std::string> fleetRowOf(const Reading& reading) {
  if (reading.failure) {
    return {reading.server.given, std::string("failed:") + wordOf(reading.failure->kind()), "", ""};
  }
  std::vector<std::string> interfaces;
  for (const Interface& interface : reading.processor.interfaces) {
    interfaces.push_back(withoutBlanks(interface.name + "=" + interface.addressWithPrefix() +
                                       (interface.origin.empty() ? "" : ":" + interface.origin)));
  }
  return {reading.server.given, joined(interfaces, ","),
          joined(addressesOf(reading.processor.accessPointsOf(gatewayContext)), ","),
          joined(addressesOf(reading.processor.accessPointsOf(dnsContext)), ",")};
}

std::string tableOf(const ChangeReport& report, const Colours& colours) {
  const Change& change = report.change;
  Rows rows = {{harmless(change.interface), "ADDRESS", "MASK", "ORIGIN"}, rowOf("before", change.before)};
  if (report.outcome != Outcome::Applied && report.outcome != Outcome::Unchanged) {
    rows.push_back(rowOf("wanted", change.wanted));
  }
  if (report.after && report.outcome != Outcome::WouldChange) {
    rows.push_back(rowOf("now", *report.after));
  }
  return tableOf(rows, colours);
}

}  // namespace Bmcip
