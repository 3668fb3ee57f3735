// SPDX-License-Identifier: Apache-2.0
// The ground that the library's tests stand on: its own objects in front of the embedded object manager's real broker,
// with the product's schema and the running personality, scripted underlying instances, and every line, call and result
// recorded.
#pragma once

#include <gtest/gtest.h>

#include <string>
#include <utility>
#include <variant>
#include <vector>

#include "cimom/ObjectManager.h"
#include "cimom/broker/RequestScope.h"
#include "tests/support/agent/RecordingLog.h"
#include "tests/support/broker/Faults.h"
#include "tests/support/broker/Personality.h"
#include "tests/support/composite/ScriptedInstrumentation.h"

namespace Testing {

inline constexpr const char* requestNameSpace = "root/cimv2";

using PropertyValue = std::variant<std::string, CMPIUint16, CMPIUint8, std::vector<CMPIUint16>>;
using Properties = std::vector<std::pair<std::string, PropertyValue>>;

class CompositeTest : public ::testing::Test {
 private:
  Cimom::RequestScope scope_;

 protected:
  CompositeTest();

  const CMPIBroker* broker() const { return faults.broker(); }
  CMPIContext* context() { return scope_.context(); }

  // Adds an instance to what the enumeration of an underlying class answers, and returns it.
  CMPIInstance* addUnderlying(const std::string& className, const Properties& properties);
  // An instance of any class in any namespace, made by the object manager.
  CMPIInstance* makeInstance(const std::string& nameSpace, const std::string& className, const Properties& properties);
  // A request's object path with string keys and the host that requests have.
  CMPIObjectPath* makePath(const std::string& className,
                           const std::vector<std::pair<std::string, std::string>>& keys = {});

  // How often a class was enumerated by an up-call.
  int upCallsFor(const std::string& className) const;

  FaultyBroker faults;
  CMPIStatus status = {CMPI_RC_OK, nullptr};
};

// What a test asks of an object that came back; absent and null values read as "(none)".
std::string text(const CMPIString* string);
std::string text(const CMPIInstance* instance, const std::string& property);
std::string key(const CMPIObjectPath* path, const std::string& name);
const CMPIObjectPath* reference(const CMPIInstance* instance, const std::string& property);
int number(const CMPIInstance* instance, const std::string& property);  // -1 if there is none
bool hasProperty(const CMPIInstance* instance, const std::string& property);
const CMPIObjectPath* pathOf(const CMPIInstance* instance);
CMPICount keysWithValues(const CMPIObjectPath* path);  // how many
std::string classOf(const CMPIObjectPath* path);
std::string nameSpaceOf(const CMPIObjectPath* path);
std::string hostOf(const CMPIObjectPath* path);

bool isAbsent(const CMPIData& data);  // null, or not there at all

// Hosts as the object manager leaves them: of a request's path, of the path of an instance that was made on a path with
// that host, and of a path with that host once it is set as a reference.
std::string requestHost();
std::string hostOfInstance(const std::string& host);
std::string hostOfReference(const std::string& host);

// The name that the agent gives the managed system while the tests run.
std::string systemName();

}  // namespace Testing
