// SPDX-License-Identifier: Apache-2.0
#include "bmcip/model/Processor.h"

#include <memory>
#include <sstream>

#include "agent/processor/Addresses.h"
#include "bmcip/model/Vocabulary.h"

namespace Bmcip {
namespace {

void takeSystem(Processor& processor, const Instance& instance) {
  System system{textOf(instance, "Name"), textOf(instance, "Description"), {}};
  std::istringstream codes(textOf(instance, "Dedicated"));
  for (std::string code; std::getline(codes, code, ',');) {
    system.roles.push_back(wordOf("Dedicated", code));
  }
  processor.systems.push_back(std::move(system));
}

void takeInterface(Processor& processor, const Instance& instance) {
  const auto word = [&](const char* property) { return wordOf(property, textOf(instance, property)); };
  Interface interface;
  interface.name = textOf(instance, "Name");
  interface.address = textOf(instance, "IPv4Address");
  interface.mask = textOf(instance, "SubnetMask");
  interface.origin = word("AddressOrigin");
  interface.ipv6Address = textOf(instance, "IPv6Address");
  interface.ipv6Prefix = textOf(instance, "PrefixLength");
  interface.state = word("EnabledState");
  interface.protocol = word("ProtocolIFType");
  interface.path = instance.path;
  processor.interfaces.push_back(std::move(interface));
}

void takeAccessPoint(Processor& processor, const Instance& instance) {
  std::string context = wordOf("AccessContext", textOf(instance, "AccessContext"));
  if (context == "other" && !textOf(instance, "OtherAccessContext").empty()) {
    context = textOf(instance, "OtherAccessContext");
  }
  processor.accessPoints.push_back({textOf(instance, "Name"), textOf(instance, "AccessInfo"), std::move(context)});
}

struct Question {
  const char* className;
  void (*take)(Processor& processor, const Instance& instance);
};

constexpr Question questions[] = {
    {systemClass, &takeSystem},
    {endpointClass, &takeInterface},
    {accessPointClass, &takeAccessPoint},
};

// One question after the other, over one connection.
class Reader : public std::enable_shared_from_this<Reader> {
 public:
  Reader(Transport& transport, const Server& server, std::function<void(Reading)> done)
      : transport_(transport), done_(std::move(done)) {
    reading_.server = server;
  }

  void askNext() {
    const Question& question = questions[next_++];
    transport_.send(reading_.server, enumerateInstances(reading_.server.nameSpace, question.className),
                    [self = shared_from_this(), &question](const Reply& reply) { self->take(reply, question); });
  }

 private:
  void take(const Reply& reply, const Question& question) {
    try {
      if (reply.failure) {
        throw Failure(*reply.failure);
      }
      for (const Instance& instance : readInstances(reply.message)) {
        question.take(reading_.processor, instance);
      }
      reading_.peer = reply.peer;
      if (next_ < std::size(questions)) {
        askNext();
        return;
      }
      if (reading_.processor.systems.empty() && reading_.processor.interfaces.empty()) {
        throw Failure(FailureKind::NotServed,
                      "the server answers, but shows no management processor: the class is there and its provider, or "
                      "that of the classes in root/yrnse, is not registered; see compositeipconfig-register");
      }
    } catch (const Failure& failure) {
      reading_.failure = failure;
    }
    done_(std::move(reading_));
  }

  Transport& transport_;
  std::function<void(Reading)> done_;
  Reading reading_;
  std::size_t next_ = 0;
};

std::string withPrefix(const std::string& address, const std::string& prefix) {
  return address.empty() || prefix.empty() ? address : address + "/" + prefix;
}

}  // namespace

std::optional<int> prefixLength(const std::string& mask) {
  const auto parsed = QV::SubnetMask::parse(mask);
  return parsed ? parsed->prefixLength() : std::nullopt;
}

std::string Interface::addressWithPrefix() const {
  const auto length = prefixLength(mask);
  return withPrefix(address, length ? std::to_string(*length) : "");
}

std::string Interface::ipv6WithPrefix() const { return withPrefix(ipv6Address, ipv6Prefix); }

const Interface* Processor::findInterface(const std::string& name) const {
  for (const Interface& interface : interfaces) {
    if (interface.name == name) {
      return &interface;
    }
  }
  return nullptr;
}

std::vector<AccessPoint> Processor::accessPointsOf(const std::string& context) const {
  std::vector<AccessPoint> found;
  for (const AccessPoint& accessPoint : accessPoints) {
    if (accessPoint.context == context) {
      found.push_back(accessPoint);
    }
  }
  return found;
}

std::vector<std::pair<std::string, std::string>> Processor::facts() const {
  std::vector<std::pair<std::string, std::string>> facts;
  for (const System& system : systems) {
    facts.emplace_back("system " + system.name, system.description);
  }
  for (const Interface& interface : interfaces) {
    facts.emplace_back(interface.name + " address", interface.address);
    facts.emplace_back(interface.name + " mask", interface.mask);
    facts.emplace_back(interface.name + " origin", interface.origin);
    facts.emplace_back(interface.name + " IPv6", interface.ipv6WithPrefix());
    facts.emplace_back(interface.name + " state", interface.state);
  }
  for (const AccessPoint& accessPoint : accessPoints) {
    facts.emplace_back(accessPoint.context + " " + accessPoint.name, accessPoint.address);
  }
  return facts;
}

void readProcessor(Transport& transport, const Server& server, std::function<void(Reading)> done) {
  std::make_shared<Reader>(transport, server, std::move(done))->askNext();
}

Reading readProcessor(Transport& transport, const Server& server) {
  Reading answer;
  readProcessor(transport, server, [&answer](Reading reading) { answer = std::move(reading); });
  transport.run();
  if (answer.failure) {
    throw Failure(*answer.failure);
  }
  return answer;
}

}  // namespace Bmcip
