#pragma once

#include <cmpimacs.h>
#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include <string>

#include "cimom/ObjectManager.h"
#include "cimom/broker/RequestScope.h"
#include "tests/cimom/support/ManagedElements.h"
#include "tests/cimom/support/ProbeProvider.h"

namespace Testing {

// An object manager with the schema of ManagedElements.h, and a request on the test's thread.
class BrokerFixture : public testing::Test {
 protected:
  BrokerFixture() { manager.loadSchemaText(testSchema, testNamespace); }

  CMPIObjectPath* path(const char* className, const char* nameSpace = testNamespace) {
    return CMNewObjectPath(broker, nameSpace, className, nullptr);
  }

  // A path of TST_Processor or another CIM_System class with both keys.
  CMPIObjectPath* systemPath(const char* name, const char* className = "TST_Processor") {
    CMPIObjectPath* made = path(className);
    CMAddKey(made, "CreationClassName", className, CMPI_chars);
    CMAddKey(made, "Name", name, CMPI_chars);
    return made;
  }

  CMPIInstance* system(const char* name, const char* className = "TST_Processor") {
    return CMNewInstance(broker, systemPath(name, className), nullptr);
  }

  Cimom::ObjectManager manager;
  const CMPIBroker* broker = manager.broker();
  Cimom::RequestScope request{broker};
  CMPIStatus status = {CMPI_RC_ERROR, nullptr};
};

}  // namespace Testing
