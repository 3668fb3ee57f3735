// SPDX-License-Identifier: Apache-2.0
// That the broker of the tests is like the object manager whose name it bears: what a provider sees of it, row by row.
#include <stdexcept>

#include "tests/support/Classes.h"
#include "tests/support/broker/Personality.h"
#include "tests/support/composite/CompositeTest.h"

namespace {

using namespace Testing;

class PersonalityTest : public CompositeTest {
 protected:
  const CMPIBroker* real() const { return faults.real(); }
  CMPIObjectPath* newPath(const char* className) {
    return CMNewObjectPath(real(), requestNameSpace, className, &status);
  }
  CMPIInstance* newInstance(const CMPIObjectPath* path) { return CMNewInstance(real(), path, &status); }
  CMPIInstance* newEndpoint() { return newInstance(newPath(endpointClass)); }

  static bool hasCharacters(const CMPIString* string) { return string && CMGetCharsPtr(string, nullptr); }

  static constexpr const char* endpointClass = Classes::endpoint;
};

TEST_F(PersonalityTest, AnUnknownNameIsRefusedWithThoseThatThereAre) {
  try {
    personalityOf("tog-pegasus");
    FAIL() << "nothing was thrown";
  } catch (const std::invalid_argument& error) {
    EXPECT_STREQ(error.what(), "BROKER_PERSONALITY is \"tog-pegasus\": must be one of standard, sfcb, OpenPegasus");
  }
}

TEST_F(PersonalityTest, ItsTablesReportTheirVersionsAndHaveTheSlotsOfThese) {
  EXPECT_EQ(real()->bft->brokerVersion, personality().brokerVersion);
  EXPECT_EQ(real()->eft->ftVersion, personality().tableVersion);
  EXPECT_EQ(real()->mft != nullptr, personality().hasMemoryServices);
  EXPECT_EQ(real()->eft->newCMPIError != nullptr, personality().hasCmpi2Slots);
  const CMPIInstance* instance = newEndpoint();
  EXPECT_EQ(instance->ft->ftVersion, personality().tableVersion);
  EXPECT_EQ(instance->ft->setPropertyWithOrigin != nullptr, personality().hasCmpi2Slots);
  EXPECT_EQ(pathOf(instance)->ft->ftVersion, personality().tableVersion);
  EXPECT_EQ(CMGetClassName(pathOf(instance), nullptr)->ft->ftVersion, personality().tableVersion);
}

TEST_F(PersonalityTest, TheTraceSlotAnswersItsCode) {
  EXPECT_EQ(CMTraceMessage(real(), CMPI_LEV_INFO, "component", "text", nullptr).rc, personality().traceCode);
}

TEST_F(PersonalityTest, ReadingCharactersSetsTheStatusOrLeavesIt) {
  const CMPIString* string = CMNewString(real(), "text", nullptr);
  status.rc = CMPI_RC_ERR_ACCESS_DENIED;
  EXPECT_STREQ(CMGetCharsPtr(string, &status), "text");
  EXPECT_EQ(status.rc, personality().charactersSetStatus ? CMPI_RC_OK : CMPI_RC_ERR_ACCESS_DENIED);
}

TEST_F(PersonalityTest, AHostThatNobodySetHasNoCharactersOrIsEmpty) {
  EXPECT_EQ(hostOf(newPath(endpointClass)), personality().unsetTextsAreNull ? "(none)" : "");
}

TEST_F(PersonalityTest, ANullStringComesWithAnObjectOrWithout) {
  const CMPIData data = CMGetProperty(newEndpoint(), "SubnetMask", &status);
  EXPECT_EQ(status.rc, CMPI_RC_OK);
  EXPECT_TRUE(CMIsNullValue(data));
  EXPECT_EQ(data.value.string != nullptr, personality().nullStringsAreObjects);
  EXPECT_FALSE(hasCharacters(data.value.string));
}

TEST_F(PersonalityTest, WhatIsNotThereHasItsStateAndCode) {
  const CMPIData property = CMGetProperty(newEndpoint(), "NoSuchProperty", &status);
  EXPECT_EQ(property.state, personality().absentState);
  EXPECT_EQ(status.rc, CMPI_RC_ERR_NO_SUCH_PROPERTY);
  const CMPIData key = CMGetKey(makePath(endpointClass, {{"Name", "eth0"}}), "NoSuchKey", &status);
  EXPECT_EQ(key.state, personality().absentState);
  EXPECT_EQ(status.rc, personality().absentKeyCode);
}

TEST_F(PersonalityTest, APathCountsTheKeysOfItsClassOrThoseThatWereSet) {
  CMPIObjectPath* path = newPath(endpointClass);
  EXPECT_EQ(CMGetKeyCount(path, nullptr), personality().countsUnsetKeys ? 4U : 0U);
  CMAddKey(path, "Name", "eth0", CMPI_chars);
  EXPECT_EQ(CMGetKeyCount(path, nullptr), personality().countsUnsetKeys ? 4U : 1U);
  EXPECT_EQ(keysWithValues(path), 1U);
  const CMPIData name = CMGetKey(path, "name", &status);
  EXPECT_EQ(status.rc, CMPI_RC_OK);
  EXPECT_EQ(CMIsKeyValue(name), personality().marksKeysOfPaths);
  for (CMPICount i = 0; i < CMGetKeyCount(path, nullptr); ++i) {
    CMPIString* keyName = nullptr;
    const bool unset = isAbsent(CMGetKeyAt(path, i, &keyName, &status));
    EXPECT_EQ(status.rc, unset ? CMPI_RC_ERR_NO_SUCH_PROPERTY : CMPI_RC_OK);
    EXPECT_EQ(text(keyName) != "Name", unset);
  }
}

TEST_F(PersonalityTest, AHostIsKeptOrLostInAnInstanceAndInAReference) {
  CMPIObjectPath* path = newPath(Classes::hostedAccessPoint);
  CMPIObjectPath* end = newPath(Classes::computerSystem);
  CMSetHostname(path, "host");
  CMSetHostname(end, "host");
  EXPECT_EQ(hostOf(path), "host");
  CMPIInstance* instance = newInstance(path);
  CMSetProperty(instance, "Antecedent", &end, CMPI_ref);
  EXPECT_EQ(hostOf(pathOf(instance)), hostOfInstance("host"));
  EXPECT_EQ(hostOf(reference(instance, "Antecedent")), hostOfReference("host"));
  CMAddKey(path, "Antecedent", &end, CMPI_ref);
  EXPECT_EQ(hostOf(CMGetKey(path, "Antecedent", nullptr).value.ref), hostOfReference("host"));
  EXPECT_EQ(hostOf(end), "host");
}

TEST_F(PersonalityTest, AnInstancesPathTakesItsKeysFromTheProperties) {
  CMPIInstance* instance = newEndpoint();
  CMSetProperty(instance, "Name", "first", CMPI_chars);
  CMSetProperty(instance, "Name", "eth0", CMPI_chars);
  EXPECT_EQ(key(pathOf(instance), "Name"), "eth0");
  EXPECT_EQ(keysWithValues(pathOf(instance)), 1U);
  EXPECT_EQ(CMGetKeyCount(pathOf(instance), nullptr), personality().pathsShowUnsetKeys ? 4U : 1U);
  EXPECT_EQ(CMIsKeyValue(CMGetProperty(instance, "Name", nullptr)), personality().marksKeyProperties);
}

TEST_F(PersonalityTest, AKeyOfThePathWinsOrTheValueThatWasSetLast) {
  CMPIInstance* instance = newInstance(makePath(endpointClass, {{"Name", "of the path"}}));
  EXPECT_EQ(text(instance, "Name"), "of the path");
  CMSetProperty(instance, "Name", "of the property", CMPI_chars);
  EXPECT_EQ(text(instance, "Name"), "of the property");
  EXPECT_EQ(key(pathOf(instance), "Name"), personality().keysOfThePathWin ? "of the path" : "of the property");
}

TEST_F(PersonalityTest, AFilterDropsLaterSetsOfOthersOrNothing) {
  CMPIInstance* instance = newEndpoint();
  const char* listed[] = {"SubnetMask", nullptr};
  const char* keys[] = {"Name", nullptr};
  EXPECT_EQ(CMSetPropertyFilter(instance, listed, keys).rc, CMPI_RC_OK);
  for (const char* name : {"SubnetMask", "IPv4Address", "Name"}) {
    EXPECT_EQ(CMSetProperty(instance, name, "value", CMPI_chars).rc, CMPI_RC_OK) << name;
  }
  EXPECT_EQ(text(instance, "SubnetMask"), "value");
  EXPECT_EQ(key(pathOf(instance), "Name"), "value");
  EXPECT_EQ(hasProperty(instance, "IPv4Address"), !personality().filterDropsOthers);
}

TEST_F(PersonalityTest, AFilterWithoutAListDropsNothing) {
  CMPIInstance* instance = newEndpoint();
  const char* keys[] = {"Name", nullptr};
  CMSetPropertyFilter(instance, nullptr, keys);
  CMSetProperty(instance, "IPv4Address", "value", CMPI_chars);
  EXPECT_EQ(text(instance, "IPv4Address"), "value");
}

TEST_F(PersonalityTest, AnUndeclaredPropertyIsKeptOrDroppedWithoutError) {
  CMPIInstance* instance = newEndpoint();
  EXPECT_EQ(CMSetProperty(instance, "NoSuchProperty", "value", CMPI_chars).rc, CMPI_RC_OK);
  EXPECT_EQ(hasProperty(instance, "nosuchproperty"), personality().keepsUndeclared);
}

TEST_F(PersonalityTest, AWrongTypeIsRefusedOrTakenOn) {
  CMPIInstance* instance = newEndpoint();
  const CMPIUint32 number = 64;
  EXPECT_EQ(CMSetProperty(instance, "SubnetMask", &number, CMPI_uint32).rc, personality().wrongTypeCode);
  EXPECT_EQ(CMSetProperty(instance, "PrefixLength", &number, CMPI_uint32).rc,
            personality().takesIntegersOfAnyType ? CMPI_RC_OK : personality().wrongTypeCode);
  const CMPIData length = CMGetProperty(instance, "PrefixLength", nullptr);
  EXPECT_EQ(length.type, personality().takesIntegersOfAnyType ? CMPI_uint32 : CMPI_uint8);
  const CMPIUint8 declared = 32;
  EXPECT_EQ(CMSetProperty(instance, "PrefixLength", &declared, CMPI_uint8).rc, CMPI_RC_OK);
  EXPECT_EQ(number, 64U);
  EXPECT_EQ(Testing::number(instance, "PrefixLength"), 32);
}

TEST_F(PersonalityTest, AnUnknownClassHasNoInstanceOrOneWithoutPathOrWithoutKeys) {
  faults.forgetClass(endpointClass);
  CMPIObjectPath* path = newPath(endpointClass);
  EXPECT_EQ(CMGetKeyCount(path, &status), 0U);
  CMPIInstance* instance = newInstance(path);
  EXPECT_EQ(instance != nullptr, personality().unknownClass != UnknownClass::HasNoInstance);
  EXPECT_EQ(status.rc, instance ? CMPI_RC_OK : CMPI_RC_ERR_INVALID_CLASS);
  if (instance) {
    CMSetProperty(instance, "Name", "eth0", CMPI_chars);
    EXPECT_EQ(text(instance, "Name"), "eth0");
    const CMPIObjectPath* itsPath = CMGetObjectPath(instance, &status);
    EXPECT_EQ(itsPath != nullptr, personality().unknownClass == UnknownClass::HasKeylessPaths);
    EXPECT_EQ(status.rc, itsPath ? CMPI_RC_OK : CMPI_RC_ERR_INVALID_CLASS);
    EXPECT_EQ(itsPath ? CMGetKeyCount(itsPath, nullptr) : 0U, 0U);
  }
}

TEST_F(PersonalityTest, AnEnumerationMarksItsItemsAndEndsInItsOwnWay) {
  addUnderlying("YRNQV_SPComputerSystem", {{"Name", "sp1"}});
  const CMPIObjectPath* path = CMNewObjectPath(real(), "root/yrnse", "YRNQV_SPComputerSystem", nullptr);
  const CMPIEnumeration* items = CBEnumInstances(broker(), context(), path, nullptr, &status);
  ASSERT_TRUE(CMHasNext(items, &status));
  const CMPIData item = CMGetNext(items, &status);
  EXPECT_EQ(item.state, personality().itemState);
  EXPECT_EQ(text(item.value.inst, "Name"), "sp1");
  EXPECT_FALSE(CMHasNext(items, &status));
  EXPECT_EQ(CMGetNext(items, &status).value.inst, nullptr);
  EXPECT_EQ(status.rc, personality().pastTheEndCode);
}

TEST_F(PersonalityTest, AFailedUpCallIsNullOrAnEnumerationBesideItsError) {
  addUnderlying("YRNQV_SPComputerSystem", {{"Name", "sp1"}});
  faults.upCallScripts["YRNQV_SPComputerSystem"].status = {CMPI_RC_ERR_ACCESS_DENIED, nullptr};
  const CMPIObjectPath* path = CMNewObjectPath(real(), "root/yrnse", "YRNQV_SPComputerSystem", nullptr);
  const CMPIEnumeration* items = CBEnumInstances(broker(), context(), path, nullptr, &status);
  EXPECT_EQ(status.rc, CMPI_RC_ERR_ACCESS_DENIED);
  EXPECT_EQ(items == nullptr, personality().failedUpCallIsNull);
  EXPECT_FALSE(items && CMHasNext(items, nullptr));
}

}  // namespace
