// SPDX-License-Identifier: Apache-2.0
#include "bmcip/output/Json.h"

#include <nlohmann/json.hpp>

#include "bmcip/model/Vocabulary.h"

namespace Bmcip {
namespace {

using Json = nlohmann::ordered_json;

// A value that nobody shows is null.
Json textOrNull(const std::string& text) { return text.empty() ? Json(nullptr) : Json(text); }

Json jsonOf(const Ipv4Settings& settings) {
  const auto length = prefixLength(settings.mask);
  return {{"address", textOrNull(settings.address)},
          {"prefix", length ? Json(*length) : Json(nullptr)},
          {"mask", textOrNull(settings.mask)},
          {"origin", textOrNull(settings.origin)}};
}

Json jsonOf(const Interface& interface) {
  Json object = {{"name", interface.name}};
  object.update(jsonOf(settingsOf(interface)));
  object["ipv6"] = textOrNull(interface.ipv6WithPrefix());
  object["protocol"] = textOrNull(interface.protocol);
  object["state"] = textOrNull(interface.state);
  return object;
}

Json jsonOf(const std::vector<AccessPoint>& accessPoints) {
  Json array = Json::array();
  for (const AccessPoint& accessPoint : accessPoints) {
    array.push_back({{"name", accessPoint.name}, {"address", textOrNull(accessPoint.address)}});
  }
  return array;
}

std::string lineOf(const Json& object) { return object.dump(-1, ' ', false, Json::error_handler_t::replace); }

}  // namespace

std::string jsonOf(const Reading& reading) {
  Json object = {{"server", reading.server.given}};
  if (reading.failure) {
    object["error"] = {{"kind", wordOf(reading.failure->kind())}, {"message", reading.failure->what()}};
    return lineOf(object);
  }
  const Processor& processor = reading.processor;
  object["systems"] = Json::array();
  for (const System& system : processor.systems) {
    object["systems"].push_back(
        {{"name", system.name}, {"description", textOrNull(system.description)}, {"roles", system.roles}});
  }
  object["interfaces"] = Json::array();
  for (const Interface& interface : processor.interfaces) {
    object["interfaces"].push_back(jsonOf(interface));
  }
  object["gateways"] = jsonOf(processor.accessPointsOf(gatewayContext));
  object["dns"] = jsonOf(processor.accessPointsOf(dnsContext));
  return lineOf(object);
}

std::string jsonOf(const ChangeReport& report) {
  const bool isApplied = report.outcome == Outcome::Applied;
  return lineOf({{"server", report.server.given},
                 {"interface", report.change.interface},
                 {"outcome", wordOf(report.outcome)},
                 {"changed", isApplied || report.outcome == Outcome::WouldChange},
                 {"before", jsonOf(report.change.before)},
                 {"wanted", jsonOf(report.change.wanted)},
                 {"after", report.after ? jsonOf(*report.after) : Json(nullptr)},
                 {"message", report.message}});
}

std::string jsonOf(const Graph& graph, const Server& server) {
  Json nodes = Json::array();
  for (const Graph::Node& node : graph.nodes) {
    nodes.push_back({{"class", node.className}, {"name", node.name}});
  }
  Json edges = Json::array();
  for (const Graph::Edge& edge : graph.edges) {
    edges.push_back({{"association", edge.association}, {"source", edge.source}, {"target", edge.target}});
  }
  return lineOf({{"server", server.given}, {"nodes", nodes}, {"edges", edges}});
}

std::string jsonOf(const Event& event) {
  return lineOf({{"time", event.time},
                 {"server", event.server},
                 {"what", event.what},
                 {"before", textOrNull(event.before)},
                 {"after", textOrNull(event.after)}});
}

}  // namespace Bmcip
