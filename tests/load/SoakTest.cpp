// SPDX-License-Identifier: Apache-2.0
// SOAK_REQUESTS of every kind, hostile ones among them, to one object manager: each is answered, nothing grows, no
// descriptor is lost, and the sanitizers that it is built with have nothing to report at its end.
#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include <algorithm>
#include <atomic>
#include <filesystem>
#include <iostream>
#include <mutex>
#include <thread>

#include "Paths.h"
#include "tests/cimom/cimxml/CostlyRequests.h"
#include "tests/cimom/cimxml/Messages.h"
#include "tests/load/CimClient.h"
#include "tests/load/Endpoints.h"
#include "tests/support/client/CompositeStack.h"
#include "tests/support/system/Footprint.h"
#include "tests/support/system/Poll.h"

namespace {

using namespace Testing;
using namespace std::chrono_literals;

constexpr std::size_t shortSoak = 3000;
constexpr std::size_t soakWarmUp = 1000;
constexpr std::size_t soakClients = 4;
constexpr std::size_t costlyBytes = 4096;

const std::vector<const char*>& classes() {
  static const std::vector<const char*> all = {
      Classes::computerSystem,     Classes::endpoint,          Classes::remoteAccessPoint,
      Classes::sequence,           Classes::staticSetting,     Classes::dhcpSetting,
      Classes::hostedAccessPoint,  Classes::clientAccess,      Classes::remoteHostedAccessPoint,
      Classes::elementSettingData, Classes::dhcpOrderedMember, Classes::staticOrderedMember};
  return all;
}

std::string plain(const std::string& name, const std::string& value) {
  return parameter(name, "<VALUE>" + value + "</VALUE>");
}

std::vector<std::string> contentsOf(const char* directory) {
  std::vector<std::string> all;
  for (const auto& entry : std::filesystem::directory_iterator(directory)) {
    all.push_back(readFile(entry.path().string()));
  }
  return all;
}

std::string modification(const std::string& address) {
  return parameter("ModifiedInstance", "<VALUE.NAMEDINSTANCE>" + endpointName("eth0") + "<INSTANCE CLASSNAME=\"" +
                                           Classes::endpoint +
                                           "\"><PROPERTY NAME=\"IPv4Address\" TYPE=\"string\"><VALUE>" + address +
                                           "</VALUE></PROPERTY></INSTANCE></VALUE.NAMEDINSTANCE>");
}

// One client's requests: which, follows from their number alone.
class Mixture {
 public:
  explicit Mixture(std::uint16_t port) : client_(port) {}

  void request(std::size_t turn) {
    using Kind = void (Mixture::*)(std::size_t);
    static constexpr Kind kinds[] = {&Mixture::read,  &Mixture::traverse, &Mixture::pull,
                                     &Mixture::fail,  &Mixture::read,     &Mixture::change,
                                     &Mixture::spoil, &Mixture::traverse, &Mixture::attack};
    constexpr std::size_t count = std::size(kinds);
    (this->*kinds[turn % count])(turn / count);
  }

  const Tally& tally() const { return tally_; }

 private:
  Answer ask(const std::string& method, const std::string& parameters, const std::string& nameSpace = "cimv2") {
    Answer answer = client_.ask(method, parameters, nameSpace);
    tally_.add(method, answer);
    return answer;
  }

  void read(std::size_t turn) {
    const std::string name = className(classes()[turn % classes().size()]);
    static const char* const methods[] = {"EnumerateInstances", "EnumerateInstanceNames", "GetClass",
                                          "EnumerateClassNames"};
    if (turn % 5 == 4) {
      ask("GetInstance", parameter("InstanceName", endpointName("eth0")));
    } else {
      ask(methods[turn % 5], name);
    }
  }

  void traverse(std::size_t turn) {
    static const char* const methods[] = {"Associators", "AssociatorNames", "References", "ReferenceNames"};
    ask(methods[turn % 4], parameter("ObjectName", endpointName(turn % 3 == 0 ? "eth1" : "eth0")));
  }

  // Read to its end, closed early, or left to the server.
  void pull(std::size_t turn) {
    const Answer opened = ask("OpenEnumerateInstances", className(classes()[turn % classes().size()]));
    const auto at = opened.body.find("<VALUE>", opened.body.find("NAME=\"EnumerationContext\""));
    if (opened.kind != Answer::Kind::Fine || at == std::string::npos || turn % 3 == 0) {
      return;
    }
    const auto begin = at + std::string("<VALUE>").size();
    const std::string context =
        plain("EnumerationContext", opened.body.substr(begin, opened.body.find('<', begin) - begin));
    if (turn % 3 == 1) {
      ask("CloseEnumeration", context);
      return;
    }
    while (ask("PullInstancesWithPath", context + plain("MaxObjectCount", "2")).body.find("<VALUE>FALSE</VALUE>") !=
           std::string::npos) {
    }
  }

  void fail(std::size_t turn) {
    static const std::vector<std::pair<const char*, std::string>> requests = {
        {"GetClass", className("YRNx_Nothing")},
        {"GetInstance", parameter("InstanceName", endpointName("eth9"))},
        {"CreateInstance",
         parameter("NewInstance", std::string("<INSTANCE CLASSNAME=\"") + Classes::endpoint + "\"/>")},
        {"DeleteInstance", parameter("InstanceName", endpointName("eth0"))},
        {"ExecQuery", plain("QueryLanguage", "WQL") + plain("Query", "SELECT * FROM CIM_System")},
        {"PullInstances", plain("EnumerationContext", "nothing") + plain("MaxObjectCount", "1")},
        {"Nonsense", ""}};
    const auto& [method, parameters] = requests[turn % requests.size()];
    Answer answer = client_.ask(method, parameters, turn % 2 == 0 ? "cimv2" : "nowhere");
    if (answer.kind == Answer::Kind::Fine) {
      answer = {Answer::Kind::Untold, "no error", answer.body};
    }
    tally_.add(method, answer);
  }

  void change(std::size_t turn) {
    ask("ModifyInstance",
        modification(turn % 4 == 0 ? "255.255.255.255" : "192.0.2." + std::to_string(11 + turn % 99)));
  }

  // A good message with a byte changed, or without its end.
  void spoil(std::size_t turn) {
    std::string body = messageOf("<IMETHODCALL NAME=\"ModifyInstance\">" + nameSpacePath("cimv2") +
                                 modification("192.0.2.10") + "</IMETHODCALL>");
    constexpr std::size_t stride = 7919;
    const std::size_t at = turn * stride % body.size();
    if (turn % 3 == 0) {
      body.resize(at);
    } else {
      body[at] = static_cast<char>(turn * stride >> 8);
    }
    tally_.add("a spoiled message", client_.send("ModifyInstance", "root%2Fcimv2", body));
  }

  // What is made to cost, and what fuzzing begins with, as messages and as connections.
  void attack(std::size_t turn) {
    static const auto messages = contentsOf(SOURCE_DIR "/tests/cimom/fuzz/cim-xml");
    static const auto connections = contentsOf(SOURCE_DIR "/tests/cimom/fuzz/http");
    switch (turn % 3) {
      case 0: {
        const CostlyRequest& costly = costlyRequests()[turn / 3 % costlyRequests().size()];
        const std::string object =
            costly.method == "Reset" ? "root%2Ftest%3ATEST_Thing.Name=%22thing%22,Number=1" : "root%2Ftest";
        tally_.add(costly.name, client_.send(costly.method, object, costly.body(costlyBytes)));
        break;
      }
      case 1:
        tally_.add("a message", client_.send("GetInstance", "root%2Ftest", messages[turn / 3 % messages.size()]));
        break;
      default:
        tally_.add("a connection", client_.sendRaw(connections[turn / 3 % connections.size()]));
    }
  }

  CimClient client_;
  Tally tally_;
};

TEST(SoakTest, EveryKindOfRequestIsAnsweredInTheSameMemory) {
  const std::size_t requests = configured("SOAK_REQUESTS", shortSoak);
  const TemporaryDirectory directory;
  // What has been freed is kept no longer than reports need.
  ::setenv("ASAN_OPTIONS", "quarantine_size_mb=4", 0);
  std::vector<std::string> more = {"--schema", SOURCE_DIR "/tests/support/probe/Probe.mof", "--registration",
                                   SOURCE_DIR "/tests/support/probe/Probe.reg"};
  CompositeStack stack(simulatedProcessor(directory.path() / "processor.json"), 7000, more);
  Cimomd& cimomd = stack.cimomd();
  const auto before = descriptorsOf(cimomd.process().id());

  std::atomic<std::size_t> next = 0;
  std::atomic<long> early = 0;
  std::mutex mutex;
  Tally tally;
  std::vector<std::thread> threads;
  for (std::size_t client = 0; client < soakClients; ++client) {
    threads.emplace_back([&] {
      Mixture mixture(cimomd.port());
      for (std::size_t turn = next++; turn < requests; turn = next++) {
        mixture.request(turn);
        if (turn == std::max(requests / 10, soakWarmUp)) {
          early = residentKib(cimomd.process().id());
        }
      }
      const std::lock_guard lock(mutex);
      tally.add(mixture.tally());
    });
  }
  for (std::thread& thread : threads) {
    thread.join();
  }
  const long late = residentKib(cimomd.process().id());
  std::cout << tally.summary() << "; " << early << " KiB at a tenth, " << late << " KiB at the end" << std::endl;
  EXPECT_GE(tally.requests(), requests);
  EXPECT_THAT(tally.untold(), testing::IsEmpty());
  EXPECT_LE(late - early, toleratedKib);
  poll([&] { return descriptorsOf(cimomd.process().id()) == before; }, 10s);
  EXPECT_EQ(descriptorsOf(cimomd.process().id()), before);
  EXPECT_EQ(cimomd.stop(), 0);
  EXPECT_EQ(cimomd.process().errors(), "");
}

}  // namespace
