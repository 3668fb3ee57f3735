// The interface counts in 16 bits: of 65537 instances a walk visits one. Once for every loop of the library that walks
// over instances. What an object manager is like plays no part, so that these run under the standard personality alone.
#include <AssociationOperations.h>

#include <algorithm>

#include "AssociationTest.h"

namespace {

using QV::IPConfigComposite::AssociationCall;
using QV::IPConfigComposite::AssociationUnit;
using Testing::Answer;
using Testing::Navigation;
using Testing::Strings;
namespace Classes = Testing::Classes;

constexpr int tooMany = 65537;

// What a stand-in for a builder makes.
std::vector<CMPIInstance*>& built() {
  static std::vector<CMPIInstance*> instances;
  return instances;
}

int buildBuilt(const CMPIObjectPath*, const char**, const CMPIContext*, std::vector<CMPIInstance*>& out) {
  out = built();
  return 0;
}

const std::string component = "Tarnwick.Test";

const AssociationUnit unitOfBuilt = {
    .component = component,
    .file = "Unit",
    .associationClass = Classes::hostedAccessPoint,
    .endA = {},
    .endB = {},
    .referenceToA = "Antecedent",
    .referenceToB = "Dependent",
    .kindWords = nullptr,
};

class SixteenBitCountsTest : public Testing::AssociationTest {
 protected:
  // Composites of the class under one name, of which those of the given numbers, from 1, can be made. Their number
  // follows the paths that the class has been asked for before them.
  void addTooMany(const std::string& compositeClass, const std::string& name, const std::vector<int>& made,
                  int pathsBefore = 0) {
    add(compositeClass, name);
    std::vector<CMPIInstance*>& underlying = faults.upCallScripts[Testing::underlyingClassOf(compositeClass)].instances;
    underlying.resize(tooMany, underlying.front());
    faults.failNewObjectPath = [=](const std::string& className, int call) {
      Testing::logLines().clear();
      return className == compositeClass && call > pathsBefore &&
             std::find(made.begin(), made.end(), call - pathsBefore) == made.end();
    };
  }

  CMPIInstanceMI* endpoints() {
    return Testing::unitOf(Classes::endpoint).createInstanceMI(broker(), context(), nullptr);
  }

  AssociationCall callOf(const char* function) { return {unitOfBuilt, broker(), function}; }

  Testing::RecordingResult result;
};

TEST_F(SixteenBitCountsTest, OfEnumInstances) {
  addTooMany(Classes::endpoint, "eth0", {1});
  CMPIInstanceMI* const mi = endpoints();
  mi->ft->enumerateInstances(mi, context(), result.result(), makePath(Classes::endpoint), nullptr);
  EXPECT_EQ(result.order, (Strings{"instance", "done"}));
}

TEST_F(SixteenBitCountsTest, OfEnumInstanceNames) {
  addTooMany(Classes::endpoint, "eth0", {1, tooMany});
  CMPIInstanceMI* const mi = endpoints();
  mi->ft->enumerateInstanceNames(mi, context(), result.result(), makePath(Classes::endpoint));
  EXPECT_EQ(result.order, (Strings{"path", "done"}));
}

TEST_F(SixteenBitCountsTest, OfGetInstance) {
  addTooMany(Classes::endpoint, "eth0", {tooMany});
  const CMPIObjectPath* const path = makePath(Classes::endpoint, {{"SystemCreationClassName", Classes::computerSystem},
                                                                  {"SystemName", "bmc0"},
                                                                  {"CreationClassName", Classes::endpoint},
                                                                  {"Name", "eth0"}});
  CMPIInstanceMI* const mi = endpoints();
  mi->ft->getInstance(mi, context(), result.result(), path, nullptr);
  EXPECT_EQ(result.order, (Strings{"done"}));
}

TEST_F(SixteenBitCountsTest, OfAnAssociationsEnumInstances) {
  built().assign(tooMany, makeInstance(Testing::requestNameSpace, Classes::hostedAccessPoint, {}));
  enumAssociations(callOf("EnumInstances"), buildBuilt, context(), result.result(),
                   makePath(Classes::hostedAccessPoint), nullptr);
  EXPECT_EQ(result.order, (Strings{"instance", "done"}));
}

TEST_F(SixteenBitCountsTest, OfAnAssociationsEnumInstanceNames) {
  built().assign(tooMany, makeInstance(Testing::requestNameSpace, Classes::hostedAccessPoint, {}));
  enumAssociationNames(callOf("EnumInstanceNames"), buildBuilt, context(), result.result(),
                       makePath(Classes::hostedAccessPoint));
  EXPECT_EQ(result.order, (Strings{"path", "done"}));
}

TEST_F(SixteenBitCountsTest, OfAnAssociationsGetInstance) {
  CMPIObjectPath* const path = makePath(Classes::hostedAccessPoint, {{"Antecedent", "a"}, {"Dependent", "b"}});
  CMPIInstance* const instance = makeInstance(Testing::requestNameSpace, Classes::hostedAccessPoint, {});
  built().assign(tooMany, Testing::withPath(instance, path));
  getAssociation(callOf("GetInstance"), buildBuilt, context(), result.result(), path, nullptr);
  EXPECT_EQ(result.order, (Strings{"instance", "done"}));
  built().front() = nullptr;
  getAssociation(callOf("GetInstance"), buildBuilt, context(), result.result(), path, nullptr);
  EXPECT_EQ(result.order, (Strings{"instance", "done", "done"}));
}

TEST_F(SixteenBitCountsTest, OfTheFarEndOfAnAssociation) {
  attach(Testing::modelOf(Classes::hostedAccessPoint));
  // The first path of the class is that of the target.
  addTooMany(Classes::endpoint, "eth0", {1}, 1);
  const Answer answer = navigate(Navigation::Associators, clientPath(Classes::computerSystem, "bmc0"));
  EXPECT_EQ(answer.order, (Strings{"instance"}));
}

TEST_F(SixteenBitCountsTest, OfTheOuterEndOfABuilder) {
  attach(Testing::modelOf(Classes::elementSettingData));
  addTooMany(Classes::endpoint, "eth0", {1, tooMany});
  add(Classes::sequence, Strings{"BMC:eth0:static"});
  std::vector<CMPIInstance*> out;
  EXPECT_EQ(build(out), 0);
  EXPECT_EQ(out.size(), 1U);
}

TEST_F(SixteenBitCountsTest, OfTheInnerEndOfABuilder) {
  attach(Testing::modelOf(Classes::hostedAccessPoint));
  add(Classes::computerSystem, Strings{"bmc0"});
  addTooMany(Classes::endpoint, "eth0", {1});
  std::vector<CMPIInstance*> out;
  // A second inner instance, which could not be made, would end the builder with 1.
  EXPECT_EQ(build(out), 0);
  EXPECT_EQ(out.size(), 1U);
}

}  // namespace
