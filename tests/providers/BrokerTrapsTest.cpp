// SPDX-License-Identifier: Apache-2.0
// What object managers do to providers, asked of every unit: the calls of their lives, texts without characters,
// classes that they do not know, keys that nobody set, values of other types.
#include <algorithm>

#include "tests/support/composite/Samples.h"

namespace {

using namespace Testing;
using Strings = std::vector<std::string>;

class UnitTest : public CompositeTest, public ::testing::WithParamInterface<Unit> {
 protected:
  UnitTest() {
    for (const Sample& sample : samples()) {
      CMPIInstance* underlying = addUnderlying(sample.underlying, acceptable(sample, 1));
      if (sample.className == Classes::sequence) {
        // Of both kinds, so that every association has one instance.
        CMSetProperty(underlying, "InstanceID", "BMC:eth1:static-dhcp", CMPI_chars);
      }
    }
    load();
  }

  const std::string& className() const { return GetParam().className; }

  // Calls the factories as an object manager does that loads the library.
  void load() {
    instances_ = GetParam().createInstanceMI(broker(), context(), nullptr);
    associations_ =
        GetParam().createAssociationMI ? GetParam().createAssociationMI(broker(), context(), nullptr) : nullptr;
  }
  // Ends the unit's interfaces as one does that unloads an idle library.
  void unload() {
    constexpr CMPIBoolean terminating = 0;
    EXPECT_EQ(instances_->ft->cleanup(instances_, context(), terminating).rc, CMPI_RC_OK);
    if (associations_) {
      EXPECT_EQ(associations_->ft->cleanup(associations_, context(), terminating).rc, CMPI_RC_OK);
    }
  }

  CMPIStatus enumInstances(const CMPIObjectPath* path) {
    return instances_->ft->enumerateInstances(instances_, context(), result.result(), path, nullptr);
  }
  CMPIStatus enumInstanceNames(const CMPIObjectPath* path) {
    return instances_->ft->enumerateInstanceNames(instances_, context(), result.result(), path);
  }
  CMPIStatus getInstance(const CMPIObjectPath* path) {
    return instances_->ft->getInstance(instances_, context(), result.result(), path, nullptr);
  }

  // How many instances the unit serves.
  std::size_t served() {
    RecordingResult own;
    EXPECT_EQ(
        instances_->ft->enumerateInstances(instances_, context(), own.result(), makePath(className()), nullptr).rc,
        CMPI_RC_OK);
    return own.instances.size();
  }

  // Every operation of the unit on the path.
  void callEverything(const CMPIObjectPath* path) {
    enumInstances(path);
    enumInstanceNames(path);
    getInstance(path);
    const CMPIInstance* instance = makeInstance(requestNameSpace, className(), {});
    instances_->ft->modifyInstance(instances_, context(), result.result(), path, instance, nullptr);
    if (associations_) {
      const CMPIAssociationMIFT& table = *associations_->ft;
      const char* association = className().c_str();
      table.associators(associations_, context(), result.result(), path, association, nullptr, nullptr, nullptr,
                        nullptr);
      table.associatorNames(associations_, context(), result.result(), path, association, nullptr, nullptr, nullptr);
      table.references(associations_, context(), result.result(), path, nullptr, nullptr, nullptr);
      table.referenceNames(associations_, context(), result.result(), path, nullptr, nullptr);
    }
  }

  RecordingResult result;

 private:
  CMPIInstanceMI* instances_ = nullptr;
  CMPIAssociationMI* associations_ = nullptr;
};

INSTANTIATE_TEST_SUITE_P(All, UnitTest, ::testing::ValuesIn(allUnits()), nameOf);

TEST_P(UnitTest, ServesWhileItsFactoriesAreCalledForOneClassAfterAnother) {
  for (int registeredClasses = 0; registeredClasses < 3; ++registeredClasses) {
    load();
    EXPECT_EQ(served(), 1u);
  }
}

TEST_P(UnitTest, ServesAfterItWasUnloadedWithoutTerminatingAndAfterItIsLoadedAgain) {
  for (int times = 0; times < 2; ++times) {
    unload();
    EXPECT_EQ(served(), 1u) << "the library itself may still be there";
    load();
    EXPECT_EQ(served(), 1u);
  }
}

TEST_P(UnitTest, ItsFactoriesTakeNoContext) {
  GetParam().createInstanceMI(broker(), nullptr, nullptr);
  if (GetParam().createAssociationMI) {
    GetParam().createAssociationMI(broker(), nullptr, nullptr);
  }
  EXPECT_EQ(served(), 1u);
}

TEST_P(UnitTest, NothingIsReadPastTheEndOfAnEnumeration) {
  for (const Sample& sample : samples()) {
    callEverything(makePath(sample.className, keysOf(sample, 1)));
  }
  callEverything(makePath(className(), {{"InstanceID", "BMC:eth1"}}));
  EXPECT_FALSE(faults.upCalls.empty());
  EXPECT_EQ(faults.readsPastTheEnd, 0);
}

TEST_P(UnitTest, ARequestWithoutAHostIsServed) {
  for (CMPIString* none : stringsWithoutCharacters()) {
    CMPIObjectPath* path = withText(makePath(className()), &CMPIObjectPathFT::getHostname, none);
    result.order.clear();
    EXPECT_EQ(enumInstances(path).rc, CMPI_RC_OK);
    EXPECT_EQ(enumInstanceNames(path).rc, CMPI_RC_OK);
    EXPECT_EQ(result.order, (Strings{"instance", "done", "path", "done"}));
    callEverything(path);
  }
}

TEST_P(UnitTest, ARequestWithoutANamespaceIsAnsweredInNone) {
  for (CMPIString* none : stringsWithoutCharacters()) {
    CMPIObjectPath* path = withText(makePath(className()), &CMPIObjectPathFT::getNameSpace, none);
    enumInstances(path);
    enumInstanceNames(path);
    ASSERT_FALSE(result.paths.empty());
    EXPECT_EQ(nameSpaceOf(result.paths.back()), personality().unsetTextsAreNull ? "(none)" : "");
    callEverything(path);
  }
}

TEST_P(UnitTest, ARequestWithoutAClassIsAnsweredWithoutHarm) {
  const bool isAssociation = GetParam().createAssociationMI;
  for (CMPIString* none : stringsWithoutCharacters()) {
    CMPIObjectPath* path =
        withText(makePath(className(), {{"InstanceID", "BMC:eth1"}}), &CMPIObjectPathFT::getClassName, none);
    result.order.clear();
    enumInstances(path);
    // The composite classes' units look for their class; those of the associations build theirs whatever is asked for.
    EXPECT_EQ(result.order, isAssociation ? (Strings{"instance", "done"}) : Strings{});
    callEverything(path);
  }
}

TEST_P(UnitTest, ARequestThatCannotBeRenderedIsAnswered) {
  for (CMPIString* none : stringsWithoutCharacters()) {
    callEverything(withText(makePath(className(), {{"InstanceID", "BMC:eth1"}}), &CMPIObjectPathFT::toString, none));
  }
  EXPECT_GE(result.done, 4);
}

TEST_P(UnitTest, AKeyWithoutCharactersMatchesNothing) {
  for (CMPIString* none : stringsWithoutCharacters()) {
    CMPIData nothing = {CMPI_string, CMPI_goodValue, {}};
    nothing.value.string = none;
    for (const char* name : {"Name", "InstanceID"}) {
      CMPIObjectPath* path = withKey(makePath(className(), {{name, "x"}}), name, nothing);
      result.order.clear();
      EXPECT_EQ(getInstance(path).rc, CMPI_RC_OK);
      EXPECT_EQ(result.order, (Strings{"done"}));
      callEverything(path);
    }
  }
}

TEST_P(UnitTest, AKeyOfAnotherTypeMatchesNothing) {
  const CMPISint64 number = 7;
  for (const CMPIType type : {CMPI_sint64, CMPI_uint64, CMPI_boolean}) {
    for (const char* name : {"Name", "InstanceID", "Antecedent", "GroupComponent"}) {
      CMPIObjectPath* path = makePath(className());
      CMAddKey(path, name, &number, type);
      result.order.clear();
      EXPECT_EQ(getInstance(path).rc, CMPI_RC_OK);
      EXPECT_EQ(result.order, (Strings{"done"}));
      callEverything(path);
    }
  }
}

TEST_P(UnitTest, APathWithoutKeysIsKeylessUnlessItCountsThoseOfItsClass) {
  const bool isAssociation = GetParam().createAssociationMI;
  const CMPIStatus answer = getInstance(makePath(className()));
  EXPECT_EQ(result.order, (Strings{"done"}));
  // The paths of OpenPegasus have all keys of their class, so that the operation looks for an instance and finds none.
  EXPECT_EQ(faults.upCalls.empty(), !personality().countsUnsetKeys);
  EXPECT_EQ(answer.rc, personality().countsUnsetKeys || isAssociation ? CMPI_RC_OK : CMPI_RC_ERR_FAILED);
}

TEST_P(UnitTest, AClassThatTheObjectManagerDoesNotKnowIsAnsweredAsFarAsItsInstancesCanBeMade) {
  CMPIObjectPath* path = makePath(className(), {{"InstanceID", "BMC:eth1"}});
  faults.forgetClass(className());
  EXPECT_EQ(enumInstances(path).rc, CMPI_RC_OK);
  const auto usable = std::count_if(result.instances.begin(), result.instances.end(),
                                    [](const CMPIInstance* instance) { return !CMIsNullObject(instance); });
  EXPECT_EQ(usable, personality().unknownClass == UnknownClass::HasNoInstance ? 0 : 1);
  const CMPIStatus answer = enumInstanceNames(path);
  // sfcb tells only when it is asked for the instance's path.
  EXPECT_EQ(answer.rc,
            personality().unknownClass == UnknownClass::HasNoInstancePath ? CMPI_RC_ERR_INVALID_CLASS : CMPI_RC_OK);
  ASSERT_EQ(result.paths.size(), personality().unknownClass == UnknownClass::HasKeylessPaths ? 1u : 0u);
  for (const CMPIObjectPath* name : result.paths) {
    EXPECT_EQ(keysWithValues(name), GetParam().provider == "IPConfigClientAccessProvider" ? 2u : 0u);
  }
  result.order.clear();
  getInstance(path);
  EXPECT_EQ(result.order, (Strings{"done"}));
}

class InstanceUnitTest : public UnitTest {};

INSTANTIATE_TEST_SUITE_P(Six, InstanceUnitTest, ::testing::ValuesIn(instanceUnits()), nameOf);

TEST_P(InstanceUnitTest, UnsetKeysDoNoHarm) {
  faults.upCallScripts.clear();
  const Sample& sample = sampleOf(className());
  Properties properties = acceptable(sample, 1);
  // What selects the instance stays; of the other keys, none is set.
  std::erase_if(properties,
                [](const auto& property) { return property.first == "Name" || property.first == "SystemName"; });
  addUnderlying(sample.underlying, properties);
  EXPECT_EQ(enumInstances(makePath(className())).rc, CMPI_RC_OK);
  EXPECT_EQ(enumInstanceNames(makePath(className())).rc, CMPI_RC_OK);
  ASSERT_EQ(result.order, (Strings{"instance", "done", "path", "done"}));
  EXPECT_EQ(key(result.paths.front(), "Name"), "(none)");
  getInstance(makePath(className(), keysOf(sample, 2)));
  EXPECT_EQ(result.instances.size(), 1u);
}

using UnderlyingTypesTest = CompositeTest;

TEST_F(UnderlyingTypesTest, AnIntegerOfAnotherTypeIsCopiedWhereTheObjectManagerLeavesItItsType) {
  const Sample& sample = sampleOf(Classes::endpoint);
  CMPIInstance* underlying = addUnderlying(sample.underlying, acceptable(sample, 1));
  const CMPIUint32 length = 64;
  const CMPISint8 origin = 4;
  CMSetProperty(underlying, "PrefixLength", &length, CMPI_uint32);
  CMSetProperty(underlying, "AddressOrigin", &origin, CMPI_sint8);
  CMPIInstanceMI* mi = unitOf(sample.className).createInstanceMI(broker(), context(), nullptr);
  RecordingResult result;
  mi->ft->enumerateInstances(mi, context(), result.result(), makePath(sample.className), nullptr);
  ASSERT_EQ(result.instances.size(), 1u);
  const bool copied = personality().takesIntegersOfAnyType;
  EXPECT_EQ(number(result.instances[0], "PrefixLength"), copied ? 64 : -1);
  EXPECT_EQ(number(result.instances[0], "AddressOrigin"), copied ? 4 : 0) << "0 is the class's default";
}

}  // namespace
