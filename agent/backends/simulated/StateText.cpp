// SPDX-License-Identifier: Apache-2.0
#include "agent/backends/simulated/StateText.h"

#include <initializer_list>
#include <limits>
#include <nlohmann/json.hpp>
#include <set>
#include <stdexcept>
#include <utility>

#include "agent/processor/Addresses.h"

namespace QV {
namespace {

// Keeps the fields in the order in which they are written.
using Json = nlohmann::ordered_json;

constexpr std::pair<const char*, AddressOrigin> origins[] = {
    {"static", AddressOrigin::Static}, {"dhcp", AddressOrigin::Dhcp}, {"unknown", AddressOrigin::Unknown}};

// A JSON object whose fields are taken by name; `path` says where it stands, for the messages.
class Fields {
 public:
  Fields(const Json& object, std::string path, std::initializer_list<const char*> known)
      : object_(object), path_(std::move(path)) {
    if (!object.is_object()) {
      throw std::runtime_error(place() + " is not an object");
    }
    const std::set<std::string> names(known.begin(), known.end());
    for (const auto& item : object.items()) {
      if (!names.contains(item.key())) {
        throw std::runtime_error("the field " + pathOf(item.key()) + " is not known");
      }
    }
  }

  std::string pathOf(const std::string& name) const { return path_.empty() ? name : path_ + '.' + name; }

  [[noreturn]] void refuse(const std::string& name, const std::string& reason) const {
    throw std::runtime_error("the field " + pathOf(name) + ' ' + reason);
  }

  const Json& required(const char* name) const {
    const auto found = object_.find(name);
    if (found == object_.end()) {
      refuse(name, "is missing");
    }
    return *found;
  }

  std::string text(const char* name) const { return text(name, required(name)); }

  std::optional<std::string> optionalText(const char* name) const {
    const auto found = object_.find(name);
    if (found == object_.end()) {
      return std::nullopt;
    }
    return text(name, *found);
  }

  bool boolean(const char* name) const {
    const Json& value = required(name);
    if (!value.is_boolean()) {
      refuse(name, "is neither true nor false");
    }
    return value.get<bool>();
  }

  const Json& array(const char* name) const {
    const Json& value = required(name);
    if (!value.is_array()) {
      refuse(name, "is not an array");
    }
    return value;
  }

  template <typename Address>
  std::optional<Address> address(const char* name, const char* kind) const {
    const auto value = optionalText(name);
    const auto parsed = value ? Address::parse(*value) : std::nullopt;
    if (value && !parsed) {
      refuse(name, "is not " + std::string(kind) + ": '" + *value + '\'');
    }
    return parsed;
  }

  std::optional<std::uint8_t> prefixLength(const char* name) const {
    const auto found = object_.find(name);
    if (found == object_.end()) {
      return std::nullopt;
    }
    if (!found->is_number_unsigned() || found->get<std::uint64_t>() > 128) {
      refuse(name, "is not a whole number from 0 to 128");
    }
    return found->get<std::uint8_t>();
  }

  AddressOrigin origin(const char* name) const {
    const std::string value = text(name);
    for (const auto& [word, meaning] : origins) {
      if (value == word) {
        return meaning;
      }
    }
    refuse(name, "is not static, dhcp or unknown: '" + value + '\'');
  }

 private:
  std::string place() const { return path_.empty() ? "the state" : "the field " + path_; }

  std::string text(const char* name, const Json& value) const {
    if (!value.is_string()) {
      refuse(name, "is not a text");
    }
    return value.get<std::string>();
  }

  const Json& object_;
  const std::string path_;
};

NetworkInterface parseInterface(const Json& json, const std::string& path) {
  constexpr const char* dotted = "a dotted IPv4 address";
  const Fields fields(json, path, {"name", "macAddress", "enabled", "ipv4", "ipv6"});
  const Fields ipv4(fields.required("ipv4"), fields.pathOf("ipv4"), {"origin", "address", "subnetMask", "gateway"});
  const Fields ipv6(fields.required("ipv6"), fields.pathOf("ipv6"), {"origin", "address", "prefixLength"});
  NetworkInterface interface;
  interface.name = fields.optionalText("name");
  // The name becomes a field of identifiers that are separated by colons.
  if (interface.name && (interface.name->empty() || interface.name->find(':') != std::string::npos)) {
    fields.refuse("name", "is empty or holds a colon: '" + *interface.name + '\'');
  }
  interface.macAddress = fields.address<MacAddress>("macAddress", "a MAC address");
  interface.enabled = fields.boolean("enabled");
  interface.ipv4Address = ipv4.address<Ipv4Address>("address", dotted);
  interface.ipv4SubnetMask = ipv4.address<SubnetMask>("subnetMask", dotted);
  interface.ipv4Gateway = ipv4.address<Ipv4Address>("gateway", dotted);
  interface.ipv4Origin = ipv4.origin("origin");
  interface.ipv6Address = ipv6.address<Ipv6Address>("address", "an IPv6 address");
  interface.ipv6PrefixLength = ipv6.prefixLength("prefixLength");
  interface.ipv6Origin = ipv6.origin("origin");
  return interface;
}

std::string parseDnsServer(const Json& json, const std::string& path) {
  if (json.is_string()) {
    const auto server = json.get<std::string>();
    if (Ipv4Address::parse(server) || Ipv6Address::parse(server)) {
      return server;
    }
  }
  throw std::runtime_error("the field " + path + " is not an IP address");
}

std::string element(const std::string& array, std::size_t index) { return array + '[' + std::to_string(index) + ']'; }

ManagementProcessor parseProcessor(const Json& json) {
  const Fields fields(json, "", {"name", "description", "dnsServers", "interfaces"});
  ManagementProcessor processor;
  processor.name = fields.text("name");
  processor.description = fields.text("description");
  for (const Json& server : fields.array("dnsServers")) {
    processor.dnsServers.push_back(parseDnsServer(server, element("dnsServers", processor.dnsServers.size())));
  }
  std::set<std::string> names;
  for (const Json& item : fields.array("interfaces")) {
    const std::string path = element("interfaces", processor.interfaces.size());
    processor.interfaces.push_back(parseInterface(item, path));
    const auto& name = processor.interfaces.back().name;
    if (name && !names.insert(*name).second) {
      throw std::runtime_error("the field " + path + ".name is the name of another interface: '" + *name + '\'');
    }
  }
  return processor;
}

template <typename Value>
void put(Json& object, const char* name, const std::optional<Value>& value) {
  if (value) {
    object[name] = *value;
  }
}

template <typename Address>
void putAddress(Json& object, const char* name, const std::optional<Address>& address) {
  if (address) {
    object[name] = address->text();
  }
}

const char* wordOf(AddressOrigin origin) {
  for (const auto& [word, meaning] : origins) {
    if (origin == meaning) {
      return word;
    }
  }
  return "unknown";
}

Json write(const NetworkInterface& interface) {
  Json json = Json::object();
  put(json, "name", interface.name);
  putAddress(json, "macAddress", interface.macAddress);
  json["enabled"] = interface.enabled;
  Json& ipv4 = json["ipv4"] = Json::object();
  ipv4["origin"] = wordOf(interface.ipv4Origin);
  putAddress(ipv4, "address", interface.ipv4Address);
  putAddress(ipv4, "subnetMask", interface.ipv4SubnetMask);
  putAddress(ipv4, "gateway", interface.ipv4Gateway);
  Json& ipv6 = json["ipv6"] = Json::object();
  ipv6["origin"] = wordOf(interface.ipv6Origin);
  putAddress(ipv6, "address", interface.ipv6Address);
  put(ipv6, "prefixLength", interface.ipv6PrefixLength);
  return json;
}

}  // namespace

std::string writeState(const ManagementProcessor& processor) {
  Json json = Json::object();
  json["name"] = processor.name;
  json["description"] = processor.description;
  json["dnsServers"] = processor.dnsServers;
  json["interfaces"] = Json::array();
  for (const NetworkInterface& interface : processor.interfaces) {
    json["interfaces"].push_back(write(interface));
  }
  return json.dump(2) + '\n';
}

ManagementProcessor parseState(const std::string& text) {
  try {
    return parseProcessor(Json::parse(text));
  } catch (const Json::exception& error) {
    throw std::runtime_error(error.what());
  }
}

}  // namespace QV
