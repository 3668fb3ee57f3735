// SPDX-License-Identifier: Apache-2.0
// The interface counts in 16 bits: of 65537 instances a walk visits one. Once for every loop of the library that walks
// over instances. What an object manager is like plays no part, so that these run under the standard personality alone.
#include <algorithm>

#include "tests/providers/AssociationTest.h"

namespace {

using namespace Testing;

namespace Classes = Classes;

constexpr int tooMany = 65537;

class SixteenBitCountsTest : public AssociationTest {
 private:
  UnrecordedLog unrecorded_;

 protected:
  // Composites of the class under one name, of which those of the given numbers, from 1, can be made. Their number
  // follows the paths that the class has been asked for before them.
  void addTooMany(const std::string& compositeClass, const std::string& name, const std::vector<int>& made,
                  int pathsBefore = 0) {
    add(compositeClass, name);
    std::vector<CMPIInstance*>& underlying = faults.upCallScripts[underlyingClassOf(compositeClass)].instances;
    underlying.resize(tooMany, underlying.front());
    faults.failNewObjectPath = [=](const std::string& className, int call) {
      return className == compositeClass && call > pathsBefore &&
             std::find(made.begin(), made.end(), call - pathsBefore) == made.end();
    };
  }

  CMPIInstanceMI* endpoints() { return unitOf(Classes::endpoint).createInstanceMI(broker(), context(), nullptr); }

  // Two endpoints with 32769 sequences, which make 65538 associations, two more than are counted. Of these only those
  // of the given numbers can be made; all sequences are one and the same.
  void addTooManyAssociations(const std::vector<int>& made) {
    attach(modelOf(Classes::elementSettingData));
    addEnds({"eth0", "eth1"}, {"BMC:eth0:static"});
    std::vector<CMPIInstance*>& sequences = faults.upCallScripts[underlyingClassOf(Classes::sequence)].instances;
    sequences.resize(32769, sequences.front());
    CMPIObjectPath* sequencePath = makePath(Classes::sequence);
    faults.failNewObjectPath = [=, this](const std::string& className, int) {
      faults.unmadePath = className == Classes::sequence ? sequencePath : associationPath;
      return className == Classes::sequence || className == model().className;
    };
    CMPIInstance* sequence = makeInstance(requestNameSpace, Classes::sequence, {});
    withPath(sequence, sequencePath);
    faults.failNewInstance = [=, this](const std::string& className, int call) {
      faults.unmadeInstance = className == Classes::sequence ? sequence : nullptr;
      return className == Classes::sequence ||
             (className == model().className && std::find(made.begin(), made.end(), call) == made.end());
    };
    faults.onNewInstance = [this](const std::string& className, int, CMPIInstance* instance) {
      if (className == model().className) {
        withPath(instance, associationPath);
      }
    };
  }

  CMPIObjectPath* associationPath =
      makePath(Classes::elementSettingData, {{"ManagedElement", "a"}, {"SettingData", "b"}});
  RecordingResult result;
};

TEST_F(SixteenBitCountsTest, OfEnumInstances) {
  addTooMany(Classes::endpoint, "eth0", {1});
  CMPIInstanceMI* mi = endpoints();
  mi->ft->enumerateInstances(mi, context(), result.result(), makePath(Classes::endpoint), nullptr);
  EXPECT_EQ(result.order, (Strings{"instance", "done"}));
}

TEST_F(SixteenBitCountsTest, OfEnumInstanceNames) {
  addTooMany(Classes::endpoint, "eth0", {1, tooMany});
  CMPIInstanceMI* mi = endpoints();
  mi->ft->enumerateInstanceNames(mi, context(), result.result(), makePath(Classes::endpoint));
  EXPECT_EQ(result.order, (Strings{"path", "done"}));
}

TEST_F(SixteenBitCountsTest, OfGetInstance) {
  addTooMany(Classes::endpoint, "eth0", {tooMany});
  const CMPIObjectPath* path = makePath(Classes::endpoint, {{"SystemCreationClassName", Classes::computerSystem},
                                                            {"SystemName", "bmc0"},
                                                            {"CreationClassName", Classes::endpoint},
                                                            {"Name", "eth0"}});
  CMPIInstanceMI* mi = endpoints();
  mi->ft->getInstance(mi, context(), result.result(), path, nullptr);
  EXPECT_EQ(result.order, (Strings{"done"}));
}

TEST_F(SixteenBitCountsTest, OfAnAssociationsEnumInstances) {
  addTooManyAssociations({});
  EXPECT_EQ(read(Reading::EnumInstances, associationPath).order, (Strings{"instance", "instance", "done"}));
}

TEST_F(SixteenBitCountsTest, OfAnAssociationsEnumInstanceNames) {
  addTooManyAssociations({1, 2, 3});
  EXPECT_EQ(read(Reading::EnumInstanceNames, associationPath).order, (Strings{"path", "path", "done"}));
}

TEST_F(SixteenBitCountsTest, OfAnAssociationsGetInstance) {
  addTooManyAssociations({3});
  EXPECT_EQ(read(Reading::GetInstance, associationPath).order, (Strings{"done"}));
}

TEST_F(SixteenBitCountsTest, OfTheFarEndOfAnAssociation) {
  attach(modelOf(Classes::hostedAccessPoint));
  // The first path of the class is that of the target.
  addTooMany(Classes::endpoint, "eth0", {1}, 1);
  const Answer answer = navigate(Navigation::Associators, clientPath(Classes::computerSystem, "bmc0"));
  EXPECT_EQ(answer.order, (Strings{"instance"}));
}

TEST_F(SixteenBitCountsTest, OfTheOuterEndOfABuilder) {
  attach(modelOf(Classes::elementSettingData));
  addTooMany(Classes::endpoint, "eth0", {1, tooMany});
  add(Classes::sequence, Strings{"BMC:eth0:static"});
  std::vector<CMPIInstance*> out;
  EXPECT_EQ(build(out), 0);
  EXPECT_EQ(out.size(), 1U);
}

TEST_F(SixteenBitCountsTest, OfTheInnerEndOfABuilder) {
  attach(modelOf(Classes::hostedAccessPoint));
  add(Classes::computerSystem, Strings{"bmc0"});
  addTooMany(Classes::endpoint, "eth0", {1});
  std::vector<CMPIInstance*> out;
  // A second inner instance, which could not be made, would end the builder with 1.
  EXPECT_EQ(build(out), 0);
  EXPECT_EQ(out.size(), 1U);
}

}  // namespace
