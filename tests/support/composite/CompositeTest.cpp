// SPDX-License-Identifier: Apache-2.0
#include "tests/support/composite/CompositeTest.h"

#include <QV/ProviderHelper.h>

#include <algorithm>

#include "tests/support/composite/ProductSchema.h"

namespace Testing {

namespace {

constexpr const char* none = "(none)";

// Read once: the schema does not change between tests.
Cimom::ObjectManager& manager() {
  static Cimom::ObjectManager* loaded = [] {
    auto* fresh = new Cimom::ObjectManager;
    loadProductSchema(*fresh, {requestNameSpace, "root/yrnse", "root/other"});
    return fresh;
  }();
  return *loaded;
}

struct SetProperty {
  const CMPIBroker* broker;
  CMPIInstance* instance;
  const char* name;

  void operator()(const std::string& value) { check(CMSetProperty(instance, name, value.c_str(), CMPI_chars)); }
  void operator()(CMPIUint16 value) { check(CMSetProperty(instance, name, &value, CMPI_uint16)); }
  void operator()(CMPIUint8 value) { check(CMSetProperty(instance, name, &value, CMPI_uint8)); }
  void operator()(const std::vector<CMPIUint16>& values) {
    CMPIArray* array = CMNewArray(broker, static_cast<CMPICount>(values.size()), CMPI_uint16, nullptr);
    for (std::size_t i = 0; i < values.size(); ++i) {
      CMSetArrayElementAt(array, static_cast<CMPICount>(i), &values[i], CMPI_uint16);
    }
    check(CMSetProperty(instance, name, &array, CMPI_uint16A));
  }

 private:
  void check(const CMPIStatus& status) { EXPECT_EQ(status.rc, CMPI_RC_OK) << "cannot set " << name; }
};

}  // namespace

CompositeTest::CompositeTest() : scope_(manager().broker()), faults(manager().broker()) {
  logLines().clear();
  instrumentation() = {};
}

CMPIInstance* CompositeTest::makeInstance(const std::string& nameSpace, const std::string& className,
                                          const Properties& properties) {
  const CMPIBroker* real = faults.real();
  CMPIObjectPath* path = CMNewObjectPath(real, nameSpace.c_str(), className.c_str(), nullptr);
  CMPIInstance* instance = CMNewInstance(real, path, nullptr);
  EXPECT_NE(instance, nullptr) << className;
  for (const auto& [name, value] : properties) {
    std::visit(SetProperty{real, instance, name.c_str()}, value);
  }
  return instance;
}

CMPIInstance* CompositeTest::addUnderlying(const std::string& className, const Properties& properties) {
  CMPIInstance* instance = makeInstance("root/yrnse", className, properties);
  faults.upCallScripts[className].instances.push_back(instance);
  return instance;
}

CMPIObjectPath* CompositeTest::makePath(const std::string& className,
                                        const std::vector<std::pair<std::string, std::string>>& keys) {
  CMPIObjectPath* path = CMNewObjectPath(faults.real(), requestNameSpace, className.c_str(), nullptr);
  if (personality().requestHost) {
    CMSetHostname(path, personality().requestHost);
  }
  for (const auto& [name, value] : keys) {
    CMAddKey(path, name.c_str(), value.c_str(), CMPI_chars);
  }
  return path;
}

int CompositeTest::upCallsFor(const std::string& className) const {
  return static_cast<int>(std::count_if(faults.upCalls.begin(), faults.upCalls.end(),
                                        [&](const UpCall& call) { return call.className == className; }));
}

std::string text(const CMPIString* string) {
  const char* characters = !string ? nullptr : CMGetCharsPtr(string, nullptr);
  return !characters ? none : characters;
}

namespace {

std::string text(const CMPIData& data) {
  if (isAbsent(data)) {
    return none;
  }
  EXPECT_EQ(data.type, CMPI_string);
  return Testing::text(data.value.string);
}

}  // namespace

std::string text(const CMPIInstance* instance, const std::string& property) {
  return text(CMGetProperty(instance, property.c_str(), nullptr));
}

std::string key(const CMPIObjectPath* path, const std::string& name) {
  return text(CMGetKey(path, name.c_str(), nullptr));
}

const CMPIObjectPath* reference(const CMPIInstance* instance, const std::string& property) {
  const CMPIData data = CMGetProperty(instance, property.c_str(), nullptr);
  if (isAbsent(data)) {
    return nullptr;
  }
  EXPECT_EQ(data.type, CMPI_ref);
  return data.value.ref;
}

bool isAbsent(const CMPIData& data) { return (data.state & (CMPI_nullValue | CMPI_notFound)) != 0; }

int number(const CMPIInstance* instance, const std::string& property) {
  const CMPIData data = CMGetProperty(instance, property.c_str(), nullptr);
  if (isAbsent(data)) {
    return -1;
  }
  EXPECT_TRUE(data.type == CMPI_uint16 || data.type == CMPI_uint8) << data.type;
  return data.type == CMPI_uint8 ? data.value.uint8 : data.value.uint16;
}

bool hasProperty(const CMPIInstance* instance, const std::string& property) {
  CMPIStatus status = {CMPI_RC_OK, nullptr};
  const CMPIData data = CMGetProperty(instance, property.c_str(), &status);
  return status.rc == CMPI_RC_OK && !isAbsent(data);
}

const CMPIObjectPath* pathOf(const CMPIInstance* instance) { return CMGetObjectPath(instance, nullptr); }

CMPICount keysWithValues(const CMPIObjectPath* path) {
  CMPICount count = 0;
  for (CMPICount i = 0; i < CMGetKeyCount(path, nullptr); ++i) {
    count += isAbsent(CMGetKeyAt(path, i, nullptr, nullptr)) ? 0 : 1;
  }
  return count;
}

std::string classOf(const CMPIObjectPath* path) { return text(CMGetClassName(path, nullptr)); }
std::string nameSpaceOf(const CMPIObjectPath* path) { return text(CMGetNameSpace(path, nullptr)); }
std::string hostOf(const CMPIObjectPath* path) { return text(CMGetHostname(path, nullptr)); }

std::string requestHost() { return personality().requestHost ? personality().requestHost : none; }
std::string hostOfInstance(const std::string& host) { return personality().instancesKeepTheirHost ? host : none; }
std::string hostOfReference(const std::string& host) { return personality().referencesKeepTheirHost ? host : none; }

std::string systemName() { return QV::getSystemName(); }

}  // namespace Testing
