// SPDX-License-Identifier: Apache-2.0
#include "bmcip/model/Graph.h"

#include <map>
#include <optional>
#include <string_view>

#include "bmcip/client/Operations.h"
#include "bmcip/model/Vocabulary.h"

namespace Bmcip {
namespace {

constexpr const char* classes[] = {"ComputerSystem",
                                   "IPProtocolEndPoint",
                                   "RemoteServiceAccessPoint",
                                   "IPAssignmentSettingSequence",
                                   "StaticIPAssignmentSettingData",
                                   "DHCPAssignmentSettingData"};

constexpr std::size_t maxNodes = 1000;

// An association, the class at the end that is asked, that at the other one, and whether the edge leads away from the
// asked one. A setting knows the sequence of its own kind; a sequence, asked for its members, answers settings of
// either kind.
struct Association {
  const char* name;
  std::string_view asked;
  std::string_view answered;
  bool leadsAway;
};

constexpr Association associations[] = {
    {"IPHostedAccessPoint", "ComputerSystem", "IPProtocolEndPoint", true},
    {"IPRemoteHostedAccessPoint", "ComputerSystem", "RemoteServiceAccessPoint", true},
    {"ClientAccess", "IPProtocolEndPoint", "RemoteServiceAccessPoint", true},
    {"IPElementSettingData", "IPProtocolEndPoint", "IPAssignmentSettingSequence", true},
    {"StaticIPOrderedMemberOfCollection", "StaticIPAssignmentSettingData", "IPAssignmentSettingSequence", false},
    {"DHCPOrderedMemberOfCollection", "DHCPAssignmentSettingData", "IPAssignmentSettingSequence", false},
};

Graph::Node nodeOf(const ObjectName& name) {
  std::string className = name.className;
  if (className.starts_with(classPrefix)) {
    className.erase(0, std::string_view(classPrefix).size());
  }
  const std::string id = keyOf(name, "InstanceID");
  return {className, id.empty() ? keyOf(name, "Name") : id};
}

// Names come in the order in which they are asked for, whatever the order of the answers.
class Questions {
 public:
  Questions(Transport& transport, const Server& server) : transport_(transport), server_(server) {}

  void ask(const Call& call) {
    const std::size_t place = answers_.size();
    answers_.emplace_back();
    transport_.send(server_, call, [this, place](const Reply& reply) {
      try {
        if (reply.failure) {
          throw Failure(*reply.failure);
        }
        answers_[place] = readNames(reply.message);
      } catch (const Failure& failure) {
        failure_ = failure;
      }
    });
  }

  std::vector<std::vector<ObjectName>> answers() {
    transport_.run();
    if (failure_) {
      throw Failure(*failure_);
    }
    return std::move(answers_);
  }

 private:
  Transport& transport_;
  const Server& server_;
  std::vector<std::vector<ObjectName>> answers_;
  std::optional<Failure> failure_;
};

}  // namespace

Graph readGraph(Transport& transport, const Server& server) {
  Questions instances(transport, server);
  for (const char* name : classes) {
    instances.ask(enumerateInstanceNames(server.nameSpace, std::string(classPrefix) + name));
  }
  Graph graph;
  std::vector<ObjectName> names;
  std::map<std::string, std::size_t> places;
  for (auto& answer : instances.answers()) {
    for (ObjectName& name : answer) {
      places.emplace(identityOf(name), graph.nodes.size());
      graph.nodes.push_back(nodeOf(name));
      names.push_back(std::move(name));
    }
  }

  if (graph.nodes.size() > maxNodes) {
    throw Failure(FailureKind::Malformed, "the server shows more than " + std::to_string(maxNodes) +
                                              " instances: no management processor has as many");
  }

  Questions far(transport, server);
  std::vector<std::pair<const Association*, std::size_t>> asked;
  for (const Association& association : associations) {
    for (std::size_t node = 0; node < graph.nodes.size(); ++node) {
      if (graph.nodes[node].className == association.asked) {
        far.ask(associatorNames(server.nameSpace, names[node], std::string(classPrefix) + association.name));
        asked.emplace_back(&association, node);
      }
    }
  }
  const auto answers = far.answers();
  for (std::size_t i = 0; i < asked.size(); ++i) {
    const auto& [association, node] = asked[i];
    for (const ObjectName& name : answers[i]) {
      const auto found = places.find(identityOf(name));
      if (found == places.end() || graph.nodes[found->second].className != association->answered) {
        throw Failure(FailureKind::Error, std::string(association->name) +
                                              " answers an instance that is none of its far end: " + identityOf(name));
      }
      const bool leadsAway = association->leadsAway;
      graph.edges.push_back({association->name, leadsAway ? node : found->second, leadsAway ? found->second : node});
    }
  }
  return graph;
}

}  // namespace Bmcip
