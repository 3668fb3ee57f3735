// SPDX-License-Identifier: Apache-2.0
// The whole product in one process, asked from several threads at once: what object managers do. Meant for the thread
// sanitizer, under which only the frame's two trace buffers may be shared without a lock (tests/tsan.supp).
#include <cmpimacs.h>
#include <gtest/gtest.h>

#include <algorithm>
#include <atomic>
#include <cstdlib>
#include <map>
#include <memory>
#include <mutex>
#include <string>
#include <thread>
#include <vector>

#include "Paths.h"
#include "cimom/ObjectManager.h"
#include "cimom/broker/RequestScope.h"
#include "tests/support/composite/Units.h"
#include "tests/support/system/TemporaryDirectory.h"

extern "C" Testing::CreateInstanceMI UnderlyingIPConfigProvider_Create_InstanceMI;

namespace {

using namespace Testing;

constexpr std::size_t readers = 14;
constexpr std::size_t writers = 2;

struct Release {
  void operator()(CMPIObjectPath* path) const { CMRelease(path); }
};
using Path = std::unique_ptr<CMPIObjectPath, Release>;

std::string textOf(const CMPIObjectPath* path) { return CMGetCharsPtr(CMObjectPathToString(path, nullptr), nullptr); }

// One client: each of its requests is a request of its own, as object managers make them.
class Client {
 public:
  explicit Client(const CMPIBroker* broker) : broker_(broker) {}

  // Every operation on the unit's class, on its objects, and of the associations from there: the paths of what is
  // answered, and the status where nothing is. Values are not among them, which others change meanwhile.
  // @param most how many of the objects
  std::string everythingOf(const Unit& unit, std::size_t most) const {
    const Path all = classPath(unit.className);
    std::string answers = enumerated([&](const CMPIContext* context, CMPIStatus* status) {
      return CBEnumInstances(broker_, context, all.get(), nullptr, status);
    });
    answers += enumerated([&](const CMPIContext* context, CMPIStatus* status) {
      return CBExecQuery(broker_, context, all.get(), "SELECT * FROM CIM_System", "WQL", status);
    });
    std::vector<Path> objects = objectsOf(unit.className);
    objects.resize(std::min(objects.size(), most));
    for (const Path& object : objects) {
      answers += operationsOn(object.get());
      for (const Unit& association : associationUnits()) {
        answers += traversed(object.get(), association.className.c_str());
      }
    }
    return answers;
  }

  // Writes address and mask of an object through its ModifyInstance.
  CMPIrc modify(const CMPIObjectPath* object, const std::string& address) const {
    Cimom::RequestScope scope(broker_);
    const CMPIInstance* instance = CMNewInstance(broker_, object, nullptr);
    CMSetProperty(instance, "IPv4Address", address.c_str(), CMPI_chars);
    CMSetProperty(instance, "SubnetMask", "255.255.255.0", CMPI_chars);
    return CBModifyInstance(broker_, scope.context(), object, instance, nullptr).rc;
  }

  std::vector<Path> objectsOf(const std::string& className) const {
    Cimom::RequestScope scope(broker_);
    const Path all = classPath(className);
    CMPIEnumeration* names = CBEnumInstanceNames(broker_, scope.context(), all.get(), nullptr);
    std::vector<Path> objects;
    while (names && CMHasNext(names, nullptr)) {
      const CMPIObjectPath* object = CMGetNext(names, nullptr).value.ref;
      objects.emplace_back(CMClone(object, nullptr));
    }
    return objects;
  }

 private:
  Path classPath(const std::string& className) const {
    Cimom::RequestScope scope(broker_);
    const CMPIObjectPath* path = CMNewObjectPath(broker_, "root/cimv2", className.c_str(), nullptr);
    return Path(CMClone(path, nullptr));
  }

  template <typename Request>
  std::string enumerated(Request request) const {
    Cimom::RequestScope scope(broker_);
    CMPIStatus status = {CMPI_RC_OK, nullptr};
    CMPIEnumeration* answer = request(scope.context(), &status);
    std::string text = '\n' + std::to_string(status.rc);
    while (answer && CMHasNext(answer, nullptr)) {
      const CMPIData item = CMGetNext(answer, nullptr);
      text += ' ' + textOf(item.type == CMPI_ref ? item.value.ref : CMGetObjectPath(item.value.inst, nullptr));
    }
    return text;
  }

  std::string operationsOn(const CMPIObjectPath* object) const {
    Cimom::RequestScope scope(broker_);
    const CMPIContext* context = scope.context();
    CMPIStatus status = {CMPI_RC_OK, nullptr};
    const CMPIInstance* instance = CBGetInstance(broker_, context, object, nullptr, &status);
    std::string text = '\n' + textOf(object) + ' ' + std::to_string(status.rc);
    if (instance) {
      text += ' ' + textOf(CMGetObjectPath(instance, nullptr));
      CBCreateInstance(broker_, context, object, instance, &status);
      text += ' ' + std::to_string(status.rc);
    }
    CBGetProperty(broker_, context, object, "InstanceID", &status);
    text += ' ' + std::to_string(status.rc);
    text += ' ' + std::to_string(CBDeleteInstance(broker_, context, object).rc);
    return text;
  }

  std::string traversed(const CMPIObjectPath* object, const char* association) const {
    return enumerated([&](const CMPIContext* context, CMPIStatus* status) {
             return CBAssociators(broker_, context, object, association, nullptr, nullptr, nullptr, nullptr, status);
           }) +
           enumerated([&](const CMPIContext* context, CMPIStatus* status) {
             return CBAssociatorNames(broker_, context, object, association, nullptr, nullptr, nullptr, status);
           }) +
           enumerated([&](const CMPIContext* context, CMPIStatus* status) {
             return CBReferences(broker_, context, object, association, nullptr, nullptr, status);
           }) +
           enumerated([&](const CMPIContext* context, CMPIStatus* status) {
             return CBReferenceNames(broker_, context, object, association, nullptr, status);
           });
  }

  const CMPIBroker* broker_;
};

class ConcurrentRequestsTest : public ::testing::Test {
 protected:
  ConcurrentRequestsTest() {
    const std::string agent =
        directory_.write("agent.ini",
                         "[system]\nname = concurrency\n[log]\ndestination = file\n"
                         "threshold = 4000\nfile = " +
                             directory_ / "log" +
                             "\n[processor]\nbackend = simulated\n[simulated]\nstate = " + directory_ / "state" + "\n");
    ::setenv("QV_AGENT_INI", agent.c_str(), 1);
    manager_.loadSchema(SOURCE_DIR "/schema");
    for (const Unit& unit : allUnits()) {
      manager_.addProvider({.className = unit.className,
                            .provider = unit.provider,
                            .location = "compositeipconfigprovider",
                            .instance = true,
                            .association = unit.createAssociationMI != nullptr,
                            .namespaces = {"root/cimv2"},
                            .registeredAt = "here"},
                           unit.createInstanceMI, unit.createAssociationMI);
    }
    for (const char* name :
         {"YRNQV_SPComputerSystem", "YRNQV_IPProtocolEndpoint", "YRNQV_IPAssignmentSettingData",
          "YRNQV_StaticIPAssignmentSettingData", "YRNQV_DHCPSettingData", "YRNQV_IPRemoteServiceAccessPoint"}) {
      manager_.addProvider({.className = name,
                            .provider = "UnderlyingIPConfigProvider",
                            .location = "underlyingipconfigprovider",
                            .instance = true,
                            .association = false,
                            .namespaces = {"root/yrnse"},
                            .registeredAt = "here"},
                           UnderlyingIPConfigProvider_Create_InstanceMI, nullptr);
    }
  }

  TemporaryDirectory directory_;
  Cimom::ObjectManager manager_;
};

TEST_F(ConcurrentRequestsTest, SixteenThreadsWithEveryOperationGetInNobodysWay) {
  const std::vector<Unit> units = allUnits();
  const char* configured = std::getenv("CONCURRENCY_ROUNDS");
  const std::size_t rounds = configured ? std::stoul(configured) : 1;
  const std::size_t most = configured ? 100 : 1;
  // The first requests come at once, too: what a unit answered first is what it is to answer ever after.
  std::mutex mutex;
  std::map<std::string, std::string> expected;
  std::atomic<int> wrong = 0;
  std::atomic<std::size_t> reading = readers;
  std::vector<std::thread> threads;
  for (std::size_t reader = 0; reader < readers; ++reader) {
    threads.emplace_back([&, reader] {
      const Client client(manager_.broker());
      for (std::size_t round = 0; round < rounds; ++round) {
        const Unit& unit = units[(reader + round) % units.size()];
        const std::string answers = client.everythingOf(unit, most);
        const std::lock_guard lock(mutex);
        wrong += expected.try_emplace(unit.className, answers).first->second == answers ? 0 : 1;
      }
      --reading;
    });
  }
  for (std::size_t writer = 0; writer < writers; ++writer) {
    threads.emplace_back([&, writer] {
      const Client client(manager_.broker());
      const auto objects = client.objectsOf(writer == 0 ? Classes::endpoint : Classes::staticSetting);
      wrong += objects.empty() ? 1 : 0;
      for (std::size_t round = 1; reading > 0 && !objects.empty(); ++round) {
        wrong += client.modify(objects.at(0).get(), "192.0.2." + std::to_string(1 + round % 200)) == CMPI_RC_OK ? 0 : 1;
      }
    });
  }
  for (std::thread& thread : threads) {
    thread.join();
  }
  EXPECT_EQ(wrong, 0);
  // And nobody was in the way of the first either.
  const Client client(manager_.broker());
  for (const Unit& unit : units) {
    const std::string alone = client.everythingOf(unit, most);
    EXPECT_EQ(expected[unit.className], alone) << unit.className;
    EXPECT_NE(alone.find("root/cimv2:" + unit.className + '.'), std::string::npos) << alone;
  }
}

}  // namespace
