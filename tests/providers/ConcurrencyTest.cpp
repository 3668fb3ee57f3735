// SPDX-License-Identifier: Apache-2.0
// The whole product in one process, asked from several threads at once: what object managers do. Meant for the thread
// sanitizer, under which only the frame's two trace buffers may be shared without a lock (tests/tsan.supp).
#include <cmpimacs.h>
#include <gtest/gtest.h>

#include <atomic>
#include <cstdlib>
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

  // The number of instances of a class, as a client's request counts them; -1 if the request failed.
  int count(const std::string& className) {
    const CMPIBroker* broker = manager_.broker();
    Cimom::RequestScope scope(broker);
    CMPIStatus status = {CMPI_RC_OK, nullptr};
    const CMPIObjectPath* path = CMNewObjectPath(broker, "root/cimv2", className.c_str(), &status);
    const CMPIEnumeration* answer = CBEnumInstances(broker, scope.context(), path, nullptr, &status);
    if (status.rc != CMPI_RC_OK || !answer) {
      return -1;
    }
    int instances = 0;
    for (; CMHasNext(answer, &status); CMGetNext(answer, &status)) {
      ++instances;
    }
    return instances;
  }

  // Writes an address through the endpoint's ModifyInstance.
  CMPIrc modify(const std::string& interface, const std::string& address) {
    const CMPIBroker* broker = manager_.broker();
    Cimom::RequestScope scope(broker);
    const CMPIObjectPath* path = endpointOf(broker, scope.context(), interface);
    if (!path) {
      return CMPI_RC_ERR_NOT_FOUND;
    }
    const CMPIInstance* instance = CMNewInstance(broker, path, nullptr);
    CMSetProperty(instance, "IPv4Address", address.c_str(), CMPI_chars);
    CMSetProperty(instance, "SubnetMask", "255.255.255.0", CMPI_chars);
    return CBModifyInstance(broker, scope.context(), path, instance, nullptr).rc;
  }

 private:
  static const CMPIObjectPath* endpointOf(const CMPIBroker* broker, const CMPIContext* context,
                                          const std::string& interface) {
    const CMPIObjectPath* all = CMNewObjectPath(broker, "root/cimv2", Classes::endpoint, nullptr);
    CMPIEnumeration* names = CBEnumInstanceNames(broker, context, all, nullptr);
    while (names && CMHasNext(names, nullptr)) {
      const CMPIObjectPath* path = CMGetNext(names, nullptr).value.ref;
      if (interface == CMGetCharsPtr(CMGetKey(path, "Name", nullptr).value.string, nullptr)) {
        return path;
      }
    }
    return nullptr;
  }

  TemporaryDirectory directory_;
  Cimom::ObjectManager manager_;
};

TEST_F(ConcurrentRequestsTest, ReadersOfEveryClassAndAWriterGetInNobodysWay) {
  std::vector<std::pair<std::string, int>> expected;
  for (const Unit& unit : allUnits()) {
    expected.emplace_back(unit.className, count(unit.className));
    EXPECT_GT(expected.back().second, 0) << unit.className;
  }
  std::atomic<int> wrong = 0;
  std::vector<std::thread> threads;
  for (int reader = 0; reader < 4; ++reader) {
    threads.emplace_back([&] {
      for (int round = 0; round < 5; ++round) {
        for (const auto& [className, instances] : expected) {
          wrong += count(className) == instances ? 0 : 1;
        }
      }
    });
  }
  threads.emplace_back([&] {
    for (int round = 1; round <= 20; ++round) {
      wrong += modify("eth0", "192.0.2." + std::to_string(round)) == CMPI_RC_OK ? 0 : 1;
    }
  });
  for (std::thread& thread : threads) {
    thread.join();
  }
  EXPECT_EQ(wrong, 0);
}

}  // namespace
