// SPDX-License-Identifier: Apache-2.0
// The library itself, loaded, used, left and loaded again in one process, as object managers do that unload idle
// providers.
#include <dlfcn.h>
#include <gtest/gtest.h>

#include <fstream>
#include <sstream>

#include "Paths.h"
#include "cimom/ObjectManager.h"
#include "cimom/broker/RequestScope.h"
#include "tests/support/broker/Faults.h"
#include "tests/support/broker/Personality.h"
#include "tests/support/composite/Units.h"
#include "tests/support/system/Build.h"
#include "tests/support/system/TemporaryDirectory.h"

namespace {

using namespace Testing;

const std::string library = built("lib/libcompositeipconfigprovider.so.1");

struct Registered {
  std::string className;
  std::string provider;
  bool association;
};

// As an object manager is told of the providers.
std::vector<Registered> registrations() {
  std::ifstream file(SOURCE_DIR "/schema/CompositeIPConfig.registration");
  std::vector<Registered> all;
  for (std::string line; std::getline(file, line);) {
    std::istringstream words(line);
    std::string nameSpace;
    Registered registered = {};
    if (!line.starts_with("#") && words >> registered.className >> nameSpace >> registered.provider) {
      registered.association = line.ends_with(" association");
      all.push_back(registered);
    }
  }
  return all;
}

class ReloadTest : public ::testing::Test {
 private:
  TemporaryDirectory directory_;
  Cimom::ObjectManager manager_;
  Cimom::RequestScope scope_;

 protected:
  ReloadTest() : scope_(manager_.broker()), faults(manager_.broker()) {
    ::setenv("QV_AGENT_INI",
             directory_.write("agent.ini", "[log]\ndestination = file\nfile = " + directory_ / "log" + "\n").c_str(),
             1);
    manager_.loadSchema(SOURCE_DIR "/schema");
    const CMPIObjectPath* path = CMNewObjectPath(faults.real(), "root/yrnse", "YRNQV_SPComputerSystem", nullptr);
    CMPIInstance* system = CMNewInstance(faults.real(), path, nullptr);
    CMSetProperty(system, "Name", "sp1", CMPI_chars);
    faults.upCallScripts["YRNQV_SPComputerSystem"].instances = {system};
  }
  ~ReloadTest() override { ::unsetenv("QV_AGENT_INI"); }

  const CMPIBroker* broker() const { return faults.broker(); }
  CMPIContext* context() { return scope_.context(); }

  template <typename Create>
  Create* factory(void* handle, const std::string& name) {
    void* symbol = ::dlsym(handle, name.c_str());
    EXPECT_NE(symbol, nullptr) << name;
    return reinterpret_cast<Create*>(symbol);
  }

  FaultyBroker faults;
};

TEST_F(ReloadTest, ServesAfterEveryLoadingAndLeavesTheProcessWhenItIsUnloaded) {
  for (int loading = 1; loading <= 3; ++loading) {
    SCOPED_TRACE(loading);
    void* handle = ::dlopen(library.c_str(), personality().loadFlags);
    ASSERT_NE(handle, nullptr) << ::dlerror();
    for (const Registered& registered : registrations()) {
      SCOPED_TRACE(registered.className);
      CMPIInstanceMI* instances =
          factory<CreateInstanceMI>(handle, registered.provider + "_Create_InstanceMI")(broker(), context(), nullptr);
      RecordingResult result;
      const CMPIObjectPath* path = CMNewObjectPath(faults.real(), "root/cimv2", registered.className.c_str(), nullptr);
      EXPECT_EQ(instances->ft->enumerateInstances(instances, context(), result.result(), path, nullptr).rc, CMPI_RC_OK);
      EXPECT_EQ(result.instances.size(), registered.className == Classes::computerSystem ? 1u : 0u);
      EXPECT_EQ(result.done, 1);
      constexpr CMPIBoolean terminating = 0;
      EXPECT_EQ(instances->ft->cleanup(instances, context(), terminating).rc, CMPI_RC_OK);
      if (registered.association) {
        CMPIAssociationMI* associations = factory<CreateAssociationMI>(
            handle, registered.provider + "_Create_AssociationMI")(broker(), context(), nullptr);
        EXPECT_EQ(associations->ft->cleanup(associations, context(), terminating).rc, CMPI_RC_OK);
      }
    }
    ASSERT_EQ(::dlclose(handle), 0);
    EXPECT_EQ(::dlopen(library.c_str(), RTLD_LAZY | RTLD_NOLOAD), nullptr) << "still loaded";
  }
}

TEST_F(ReloadTest, TheRegistrationNamesEveryProvider) { EXPECT_EQ(registrations().size(), 12u); }

}  // namespace
