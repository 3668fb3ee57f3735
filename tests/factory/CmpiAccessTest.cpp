// SPDX-License-Identifier: Apache-2.0
// What is null or has no handle is read as nothing and left alone: an object manager that is out of memory hands out
// such objects, and its macros call through the tables of any.
#include "factory/CmpiAccess.h"
#include "tests/support/Classes.h"
#include "tests/support/composite/CompositeTest.h"

namespace {

using namespace Testing;
namespace Access = QV::IPConfigComposite;

class CmpiAccessTest : public CompositeTest {
 protected:
  static CMPIData of(CMPIType type) { return {type, CMPI_goodValue, {}}; }

  const std::vector<CMPIObjectPath*> unusablePaths_ = {nullptr, pathWithoutHandle()};
  const std::vector<CMPIInstance*> unusableInstances_ = {nullptr, withoutHandle()};
};

TEST_F(CmpiAccessTest, AnUnusablePathHasNoTextAndNoKey) {
  for (CMPIObjectPath* path : unusablePaths_) {
    EXPECT_STREQ(Access::nameSpaceOf(path, &status), "");
    EXPECT_STREQ(Access::classNameOf(path, &status), "");
    EXPECT_STREQ(Access::renderingOf(path), "");
    EXPECT_TRUE(isAbsent(Access::keyOf(path, "Name", &status)));
    Access::rehome(path, makePath(Classes::endpoint), &status);
  }
  EXPECT_EQ(status.rc, CMPI_RC_OK);
}

TEST_F(CmpiAccessTest, APathIsRehomedForARequestThatHasNone) {
  for (const CMPIObjectPath* request : unusablePaths_) {
    CMPIObjectPath* path = makePath(Classes::endpoint);
    Access::rehome(path, request, &status);
    EXPECT_EQ(hostOf(path), systemName());
  }
}

TEST_F(CmpiAccessTest, AnUnusableInstanceHasNoPropertyAndNoPathAndTakesNone) {
  for (CMPIInstance* instance : unusableInstances_) {
    EXPECT_TRUE(isAbsent(Access::propertyOf(instance, "Name", &status)));
    EXPECT_EQ(Access::pathOf(instance, &status), nullptr);
    Access::setText(instance, "Name", "text");
    Access::setReference(instance, "Antecedent", makePath(Classes::endpoint));
    CMPIData item = of(CMPI_instance);
    item.value.inst = instance;
    EXPECT_TRUE(isAbsent(Access::instanceItem(item)));
  }
  EXPECT_TRUE(isAbsent(Access::instanceItem(of(CMPI_uint16))));
}

TEST_F(CmpiAccessTest, AReferenceIsNotSetToAnUnusablePath) {
  CMPIInstance* association = makeInstance(requestNameSpace, "YRNx_MgmtHwClientAccess", {});
  for (const CMPIObjectPath* path : unusablePaths_) {
    Access::setReference(association, "Antecedent", path);
    EXPECT_FALSE(hasProperty(association, "Antecedent"));
  }
}

TEST_F(CmpiAccessTest, WhatHoldsNoCharactersIsTheEmptyText) {
  for (CMPIString* string : stringsWithoutCharacters()) {
    EXPECT_STREQ(Access::textOf(string, &status), "");
    CMPIData data = of(CMPI_string);
    data.value.string = string;
    EXPECT_STREQ(Access::textOf(data, &status), "");
  }
  EXPECT_STREQ(Access::textOf(of(CMPI_chars), &status), "");
  EXPECT_STREQ(Access::textOf(of(CMPI_uint16), &status), "");
  EXPECT_STREQ(Access::textOf(CMPIData{CMPI_string, CMPI_nullValue, {}}, &status), "");
}

TEST_F(CmpiAccessTest, TracingNeedsABroker) {
  Access::traceToBroker(nullptr, CMPI_LEV_INFO, "unheard");
  Access::traceToBroker(broker(), CMPI_LEV_INFO, "heard");
  EXPECT_EQ(faults.traces, (std::vector<BrokerTrace>{{CMPI_LEV_INFO, "CompositeIPConfigProvider", "heard"}}));
}

}  // namespace
