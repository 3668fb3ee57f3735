// SPDX-License-Identifier: Apache-2.0
// Two object managers and eight clients on one management processor, for LOAD_SECONDS: readers see no address with
// another's mask, what fails says so, and neither process grows or loses a descriptor.
#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include <algorithm>
#include <atomic>
#include <chrono>
#include <iostream>
#include <memory>
#include <mutex>
#include <thread>

#include "tests/cimom/cimxml/Messages.h"
#include "tests/load/CimClient.h"
#include "tests/load/Endpoints.h"
#include "tests/support/client/CompositeStack.h"
#include "tests/support/system/Footprint.h"
#include "tests/support/system/Poll.h"
#ifdef SIMULATED_BMC
#include "tests/support/agent/SimulatedBmc.h"
#endif

namespace {

using namespace Testing;
using namespace std::chrono_literals;
using Clock = std::chrono::steady_clock;

constexpr std::size_t managers = 2;
constexpr std::size_t loadClients = 8;  // the first two write
constexpr std::size_t shortLoad = 5;
constexpr auto loadWarmUp = 2s;
constexpr auto loadPatience = 60s;  // beyond its time, with a machine that stalls

struct Pair {
  std::string address;
  std::string mask;

  bool operator==(const Pair&) const = default;
};

// What the processor shows from the start, and what the writers write: no two have a mask in common.
const std::vector<Pair>& knownPairs() {
  static const std::vector<Pair> pairs = {{"192.0.2.10", "255.255.255.0"},    {"198.51.100.23", "255.255.255.0"},
                                          {"192.0.2.77", "255.255.255.128"},  {"198.51.100.5", "255.255.0.0"},
                                          {"203.0.113.9", "255.255.255.240"}, {"203.0.113.40", "255.255.255.192"}};
  return pairs;
}

constexpr std::size_t firstWritten = 2;

std::string valueAfter(const std::string& xml, const std::string& property, std::size_t from) {
  const auto at = xml.find("<PROPERTY NAME=\"" + property + "\" TYPE=\"string\"><VALUE>", from);
  if (at == std::string::npos) {
    return {};
  }
  const auto begin = xml.find("<VALUE>", at) + 7;
  return xml.substr(begin, xml.find('<', begin) - begin);
}

// The address and mask of each instance in an answer that has both.
std::vector<Pair> pairsIn(const std::string& xml) {
  std::vector<Pair> pairs;
  for (auto at = xml.find("<INSTANCE "); at != std::string::npos; at = xml.find("<INSTANCE ", at + 1)) {
    const std::string instance = xml.substr(at, xml.find("</INSTANCE>", at) - at);
    Pair pair{valueAfter(instance, "IPv4Address", 0), valueAfter(instance, "SubnetMask", 0)};
    if (!pair.address.empty() && !pair.mask.empty()) {
      pairs.push_back(std::move(pair));
    }
  }
  return pairs;
}

// What there is to ask and to change.
struct Scene {
  std::string section;                  // of both agents' configuration
  std::vector<std::string> interfaces;  // of the two writers
  bool readsBack;                       // whether a writer finds its own change: nobody else writes its interface
};

class LoadTest : public testing::Test {
 protected:
  void run(const Scene& scene) {
    for (std::size_t number = 0; number < managers; ++number) {
      stacks_.push_back(std::make_unique<CompositeStack>(scene.section));
    }
    const auto before = descriptors();
    const auto duration = std::chrono::seconds(configured("LOAD_SECONDS", shortLoad));
    const auto begin = Clock::now();
    end_ = begin + duration;
    std::vector<std::thread> threads;
    for (std::size_t number = 0; number < loadClients; ++number) {
      threads.emplace_back([&, number] { number < managers ? write(scene, number) : read(scene, number); });
    }
    // Once every thread that will be there has started.
    std::this_thread::sleep_until(begin + std::max<Clock::duration>(duration / 10, loadWarmUp));
    const std::vector<long> early = resident();
    std::this_thread::sleep_until(end_);
    const std::vector<long> late = resident();
    for (std::thread& thread : threads) {
      thread.join();
    }
    std::cout << std::chrono::duration_cast<std::chrono::seconds>(Clock::now() - begin).count()
              << " s: " << tally_.summary() << "; changes: " << changes_ << "; pairs seen: " << pairsSeen_ << '\n';
    EXPECT_TRUE(wasBusy());
    EXPECT_THAT(tally_.untold(), testing::IsEmpty());
    EXPECT_THAT(wrong_, testing::IsEmpty());
    for (std::size_t number = 0; number < managers; ++number) {
      std::cout << "manager " << number + 1 << ": " << early[number] << " KiB at a tenth, " << late[number]
                << " KiB at the end" << std::endl;
      EXPECT_LE(late[number] - early[number], toleratedKib);
    }
    expectWorking(scene);
    // A connection is closed a moment after its client has gone, a session with a BMC when it has rested.
    poll([&] { return descriptors() == before; });
    EXPECT_EQ(descriptors(), before);
    for (const auto& stack : stacks_) {
      const auto logged = linesOf(stack->log());
      std::cout << logged.size() << " lines in the log" << (logged.empty() ? "" : ", the first: " + logged.front())
                << '\n';
    }
  }

 private:
  // Whether there was a load to speak of.
  bool wasBusy() const { return pairsSeen_ > loadClients && changes_ > managers; }

  bool isOver() const {
    const auto now = Clock::now();
    return now >= end_ && (wasBusy() || now >= end_ + loadPatience);
  }

  void write(const Scene& scene, std::size_t number) {
    CimClient client(stacks_[number]->port());
    CimClient other(stacks_[1 - number]->port());
    const std::string& interface = scene.interfaces[number];
    std::size_t logged = 0;
    Tally tally;
    for (std::size_t round = number; !isOver(); ++round) {
      const Pair& pair = knownPairs()[firstWritten + round % (knownPairs().size() - firstWritten)];
      const Answer answer = change(client, interface, pair);
      tally.add("ModifyInstance", answer);
      changes_ += answer.kind == Answer::Kind::Fine ? 1 : 0;
      // Such a client is told of success whatever came of it; the log has what did not.
      if (scene.readsBack && shown(other, interface) != std::vector{pair}) {
        const std::string log = stacks_[number]->log();
        expect(log.size() > logged, "a change to " + pair.address + " is neither shown nor in the log");
        logged = log.size();
      }
    }
    merge(tally);
  }

  void read(const Scene& scene, std::size_t number) {
    CimClient client(stacks_[number % managers]->port());
    const std::string name = endpointName(scene.interfaces[number / managers % managers]);
    const std::vector<std::pair<std::string, std::string>> requests = {
        {"GetInstance", parameter("InstanceName", name)},
        {"EnumerateInstances", className(Classes::endpoint)},
        {"EnumerateInstances", className(Classes::staticSetting)},
        {"Associators",
         parameter("ObjectName", name) +
             parameter("AssocClass", "<CLASSNAME NAME=\"" + std::string(Classes::elementSettingData) + "\"/>")},
        {"EnumerateInstanceNames", className(Classes::clientAccess)},
        {"OpenEnumerateInstances", className(Classes::endpoint) + parameter("MaxObjectCount", "<VALUE>100</VALUE>")},
        {"GetInstance", parameter("InstanceName", endpointName("eth9"))},
    };
    Tally tally;
    for (std::size_t round = number; !isOver(); ++round) {
      const auto& [method, parameters] = requests[round % requests.size()];
      const Answer answer = client.ask(method, parameters);
      tally.add(method, answer);
      for (const Pair& pair : pairsIn(answer.body)) {
        ++pairsSeen_;
        expect(std::ranges::find(knownPairs(), pair) != knownPairs().end(),
               method + " shows " + pair.address + " with " + pair.mask);
      }
    }
    merge(tally);
  }

  static Answer change(CimClient& client, const std::string& interface, const Pair& pair) {
    const auto property = [](const std::string& name, const std::string& value) {
      return "<PROPERTY NAME=\"" + name + "\" TYPE=\"string\"><VALUE>" + value + "</VALUE></PROPERTY>";
    };
    return client.ask(
        "ModifyInstance",
        parameter("ModifiedInstance", "<VALUE.NAMEDINSTANCE>" + endpointName(interface) + "<INSTANCE CLASSNAME=\"" +
                                          Classes::endpoint + "\">" + property("IPv4Address", pair.address) +
                                          property("SubnetMask", pair.mask) + "</INSTANCE></VALUE.NAMEDINSTANCE>"));
  }

  static std::vector<Pair> shown(CimClient& client, const std::string& interface) {
    return pairsIn(client.ask("GetInstance", parameter("InstanceName", endpointName(interface))).body);
  }

  // What remains is one pair that both show, and each changes what the other shows.
  void expectWorking(const Scene& scene) const {
    for (std::size_t number = 0; number < managers; ++number) {
      const Pair& pair = knownPairs()[firstWritten + number];
      CimClient changes(stacks_[number]->port());
      CimClient looks(stacks_[1 - number]->port());
      const Answer answer = change(changes, scene.interfaces[0], pair);
      EXPECT_EQ(answer.kind, Answer::Kind::Fine) << answer.body;
      EXPECT_TRUE(shown(looks, scene.interfaces[0]) == std::vector{pair}) << pair.address;
    }
  }

  std::vector<std::vector<std::string>> descriptors() const {
    std::vector<std::vector<std::string>> all;
    for (const auto& stack : stacks_) {
      // The log is opened with its first line.
      auto open = descriptorsOf(stack->cimomd().process().id());
      std::erase(open, stack->directory() / "agent.log");
      all.push_back(std::move(open));
    }
    return all;
  }

  std::vector<long> resident() const {
    std::vector<long> all;
    for (const auto& stack : stacks_) {
      all.push_back(residentKib(stack->cimomd().process().id()));
    }
    return all;
  }

  void expect(bool holds, const std::string& otherwise) {
    if (!holds) {
      const std::lock_guard lock(mutex_);
      ++wrong_[otherwise];
    }
  }

  void merge(const Tally& tally) {
    const std::lock_guard lock(mutex_);
    tally_.add(tally);
  }

  std::vector<std::unique_ptr<CompositeStack>> stacks_;
  Clock::time_point end_;
  std::atomic<std::size_t> pairsSeen_ = 0;
  std::atomic<std::size_t> changes_ = 0;
  std::mutex mutex_;
  Tally tally_;
  std::map<std::string, std::size_t> wrong_;
};

TEST_F(LoadTest, TwoManagersAndEightClientsShareAStateFile) {
  const TemporaryDirectory directory;
  run({simulatedProcessor(directory.path() / "processor.json"), {"eth0", "eth1"}, true});
}

#ifdef SIMULATED_BMC
TEST_F(LoadTest, TwoManagersAndEightClientsShareABmc) {
  const SimulatedBmc bmc;
  std::string section = "[processor]\nbackend = ipmi\n[ipmi]\n";
  for (const auto& [key, value] : bmc.settings()) {
    section += key + " = " + value + '\n';
  }
  run({section, {"lan1", "lan1"}, false});
}
#endif

}  // namespace
