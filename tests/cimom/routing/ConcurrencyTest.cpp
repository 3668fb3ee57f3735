// SPDX-License-Identifier: Apache-2.0
#include <atomic>
#include <thread>

#include "tests/support/broker/ManagedElements.h"
#include "tests/support/broker/RecordingProvider.h"

namespace {

using namespace Cimom;
using namespace Testing;

// A provider that keeps no state and answers with one system, whose name it takes from the request's context.
struct StatelessProvider {
  static CMPIStatus cleanup(CMPIInstanceMI*, const CMPIContext*, CMPIBoolean) { return ok; }

  static CMPIStatus enumerateInstances(CMPIInstanceMI* self, const CMPIContext* context, const CMPIResult* result,
                                       const CMPIObjectPath* asked, const char**) {
    const auto* broker = static_cast<const CMPIBroker*>(self->hdl);
    const CMPIInstance* system = CMNewInstance(broker, asked, nullptr);
    const CMPIData name = CMGetContextEntry(context, CMPIPrincipal, nullptr);
    CMSetProperty(system, "Name", &name.value.string, CMPI_string);
    CMReturnInstance(result, system);
    return ok;
  }

  static inline CMPIInstanceMIFT table = {CMPICurrentVersion,
                                          CMPICurrentVersion,
                                          "instanceStateless",
                                          cleanup,
                                          nullptr,
                                          enumerateInstances,
                                          nullptr,
                                          nullptr,
                                          nullptr,
                                          nullptr,
                                          nullptr};
  static inline CMPIInstanceMI mi = {nullptr, &table};
  static inline std::atomic<int> made = 0;
};

TEST(ConcurrencyTest, RequestsOnSeveralThreadsKeepApart) {
  ObjectManager manager;
  manager.loadSchemaText(testSchema, testNamespace);
  manager.addProvider(
      {"TST_Processor", "Stateless", "", true, false, {testNamespace}, ""},
      [](const CMPIBroker* broker, const CMPIContext*, CMPIStatus*) {
        ++StatelessProvider::made;
        StatelessProvider::mi.hdl = broker;
        return &StatelessProvider::mi;
      },
      nullptr);
  std::atomic<int> wrong = 0;
  const auto work = [&](const std::string& name) {
    const std::string expected = "root/test:TST_Processor.Name=\"" + name + "\"";
    for (int round = 0; round < 200; ++round) {
      RequestScope scope(manager.broker());
      CMPIContext* context = scope.context();
      CMAddContextEntry(context, CMPIPrincipal, name.c_str(), CMPI_chars);
      const auto* path = CMNewObjectPath(manager.broker(), testNamespace, "TST_Processor", nullptr);
      const auto found = pathsOf(CBEnumInstances(manager.broker(), context, path, nullptr, nullptr));
      wrong += found != std::vector<std::string>{expected};
    }
  };
  std::vector<std::thread> threads;
  for (const char* name : {"a", "b", "c", "d"}) {
    threads.emplace_back(work, name);
  }
  for (std::thread& thread : threads) {
    thread.join();
  }
  EXPECT_EQ(wrong, 0);
  EXPECT_EQ(StatelessProvider::made, 1) << "the first requests make the provider once between them";
}

}  // namespace
