// SPDX-License-Identifier: Apache-2.0
#include "tests/support/broker/ManagedElements.h"
#include "tests/support/broker/RecordingProvider.h"

namespace {

using namespace Cimom;
using namespace Testing;

class InstanceTest : public ManagedElementsFixture {
 protected:
  std::string caption(const CMPIInstance* instance) {
    return shownText(CMGetProperty(instance, "Caption", nullptr).value.string);
  }
};

TEST_F(InstanceTest, CannotBeMadeOfAnUnknownClass) {
  EXPECT_EQ(CMNewInstance(broker, path("TST_Nothing"), &status), nullptr);
  EXPECT_EQ(status.rc, CMPI_RC_ERR_INVALID_CLASS);
}

TEST_F(InstanceTest, ShowsTheClassesDefaultsAndInheritedProperties) {
  const CMPIInstance* instance = CMNewInstance(broker, path("TST_Processor"), &status);

  EXPECT_EQ(CMGetPropertyCount(instance, nullptr), 13u);
  EXPECT_EQ(caption(instance), "none");
  const CMPIData state = CMGetProperty(instance, "EnabledState", &status);
  EXPECT_EQ(state.type, CMPI_uint16);
  EXPECT_EQ(state.value.uint16, 5);
}

TEST_F(InstanceTest, ListsItsPropertiesWithTheSchemasSpelling) {
  const CMPIInstance* instance = CMNewInstance(broker, path("tst_processor"), nullptr);
  CMPIString* name = nullptr;

  const CMPIData last = CMGetPropertyAt(instance, 12, &name, &status);

  EXPECT_EQ(status.rc, CMPI_RC_OK);
  EXPECT_EQ(shownText(name), "Vendor");
  EXPECT_EQ(shownText(last.value.string), "nobody");
  CMGetPropertyAt(instance, 13, &name, &status);
  EXPECT_EQ(status.rc, CMPI_RC_ERR_NO_SUCH_PROPERTY);
}

TEST_F(InstanceTest, ReadsCharsBackAsAString) {
  CMPIInstance* instance = system("one");
  EXPECT_EQ(CMSetProperty(instance, "caption", "text", CMPI_chars).rc, CMPI_RC_OK);
  const CMPIData data = CMGetProperty(instance, "CAPTION", &status);
  EXPECT_EQ(data.type, CMPI_string);
  EXPECT_EQ(shownText(data.value.string), "text");
}

TEST_F(InstanceTest, HoldsAValueOfEveryType) {
  CMPIInstance* instance = system("one");
  const CMPIUint8 small = 255;
  const CMPIUint64 large = 0xFFFFFFFFFFFFFFFF;
  const CMPISint32 offset = -7;
  const CMPIBoolean ready = true;
  const CMPIReal64 load = 0.5;
  CMPIDateTime* installed = CMNewDateTimeFromChars(broker, "20240229120000.000000+060", nullptr);
  CMPIArray* notes = CMNewArray(broker, 1, CMPI_string, nullptr);
  CMSetArrayElementAt(notes, 0, "note", CMPI_chars);

  EXPECT_EQ(CMSetProperty(instance, "Small", &small, CMPI_uint8).rc, CMPI_RC_OK);
  EXPECT_EQ(CMSetProperty(instance, "Large", &large, CMPI_uint64).rc, CMPI_RC_OK);
  EXPECT_EQ(CMSetProperty(instance, "Offset", &offset, CMPI_sint32).rc, CMPI_RC_OK);
  EXPECT_EQ(CMSetProperty(instance, "Ready", &ready, CMPI_boolean).rc, CMPI_RC_OK);
  EXPECT_EQ(CMSetProperty(instance, "Load", &load, CMPI_real64).rc, CMPI_RC_OK);
  EXPECT_EQ(CMSetProperty(instance, "Installed", &installed, CMPI_dateTime).rc, CMPI_RC_OK);
  EXPECT_EQ(CMSetProperty(instance, "Notes", &notes, CMPI_stringA).rc, CMPI_RC_OK);

  EXPECT_EQ(CMGetProperty(instance, "Small", nullptr).value.uint8, small);
  EXPECT_EQ(CMGetProperty(instance, "Large", nullptr).value.uint64, large);
  EXPECT_EQ(CMGetProperty(instance, "Offset", nullptr).value.sint32, offset);
  EXPECT_EQ(CMGetProperty(instance, "Ready", nullptr).value.boolean, ready);
  EXPECT_EQ(CMGetProperty(instance, "Load", nullptr).value.real64, load);
  const CMPIData time = CMGetProperty(instance, "Installed", nullptr);
  EXPECT_EQ(shownText(CMGetStringFormat(time.value.dateTime, nullptr)), "20240229120000.000000+060");
  const CMPIData array = CMGetProperty(instance, "Notes", nullptr);
  EXPECT_EQ(array.type, CMPI_stringA);
  EXPECT_EQ(shownText(CMGetArrayElementAt(array.value.array, 0, nullptr).value.string), "note");
}

TEST_F(InstanceTest, DropsAnUndeclaredPropertyAndRefusesToReadIt) {
  CMPIInstance* instance = system("one");
  EXPECT_EQ(CMSetProperty(instance, "Undeclared", "x", CMPI_chars).rc, CMPI_RC_OK);
  const CMPIData data = CMGetProperty(instance, "Undeclared", &status);
  EXPECT_EQ(status.rc, CMPI_RC_ERR_NO_SUCH_PROPERTY);
  EXPECT_TRUE(CMIsNullValue(data));
}

TEST_F(InstanceTest, RefusesAValueOfTheWrongTypeAndKeepsTheOldOne) {
  CMPIInstance* instance = system("one");
  const CMPIUint32 wide = 3;
  EXPECT_EQ(CMSetProperty(instance, "EnabledState", &wide, CMPI_uint32).rc, CMPI_RC_ERR_TYPE_MISMATCH);
  EXPECT_EQ(CMSetProperty(instance, "Caption", &wide, CMPI_uint32).rc, CMPI_RC_ERR_TYPE_MISMATCH);
  EXPECT_EQ(CMSetProperty(instance, "Caption", &wide, 0x7777).rc, CMPI_RC_ERR_INVALID_DATA_TYPE);
  EXPECT_EQ(caption(instance), "none");
}

TEST_F(InstanceTest, TakesANullForAnyProperty) {
  CMPIInstance* instance = system("one");
  CMPIString* nothing = nullptr;
  EXPECT_EQ(CMSetProperty(instance, "Caption", nullptr, CMPI_chars).rc, CMPI_RC_OK);
  EXPECT_EQ(CMSetProperty(instance, "Vendor", &nothing, CMPI_string).rc, CMPI_RC_OK);
  const CMPIData data = CMGetProperty(instance, "Caption", &status);
  EXPECT_EQ(status.rc, CMPI_RC_OK);
  EXPECT_TRUE(CMIsNullValue(data)) << "the class's default does not come back";
  EXPECT_EQ(data.type, CMPI_string);
  EXPECT_TRUE(CMIsNullValue(CMGetProperty(instance, "Vendor", nullptr)));
  EXPECT_TRUE(CMIsNullValue(CMGetProperty(instance, "Small", nullptr))) << "declared, but never set";
}

TEST_F(InstanceTest, DerivesItsKeysFromTheCurrentValues) {
  CMPIInstance* instance = CMNewInstance(broker, path("TST_Processor"), nullptr);
  const auto shown = [&] {
    const CMPIObjectPath* current = CMGetObjectPath(instance, nullptr);
    return shownText(CMObjectPathToString(current, nullptr));
  };
  EXPECT_EQ(shown(), "root/test:TST_Processor") << "null keys are left out";
  CMSetProperty(instance, "Name", "one", CMPI_chars);
  EXPECT_EQ(shown(), "root/test:TST_Processor.Name=\"one\"");
  CMSetProperty(instance, "Name", "two", CMPI_chars);
  CMSetProperty(instance, "CreationClassName", "C", CMPI_chars);
  EXPECT_EQ(shown(), "root/test:TST_Processor.CreationClassName=\"C\",Name=\"two\"");
}

TEST_F(InstanceTest, KeepsTheKeysThatItsPathCameWith) {
  CMPIInstance* instance = system("one");
  EXPECT_EQ(shownText(CMGetProperty(instance, "Name", nullptr).value.string), "one");
  CMSetProperty(instance, "Name", "two", CMPI_chars);
  const CMPIObjectPath* kept = CMGetObjectPath(instance, nullptr);
  EXPECT_EQ(shownText(CMGetKey(kept, "Name", nullptr).value.string), "one");
}

TEST_F(InstanceTest, FillsAKeyThatItsPathHasAsNull) {
  CMPIObjectPath* open = path("TST_Processor");
  CMAddKey(open, "Name", nullptr, CMPI_string);
  CMPIInstance* instance = CMNewInstance(broker, open, nullptr);
  CMSetProperty(instance, "Name", "one", CMPI_chars);
  const CMPIObjectPath* filled = CMGetObjectPath(instance, nullptr);
  EXPECT_EQ(shownText(CMObjectPathToString(filled, nullptr)), "root/test:TST_Processor.Name=\"one\"");
}

TEST_F(InstanceTest, TakesANumericKeyOfAnotherWidth) {
  CMPIObjectPath* point = path("TST_Point");
  const CMPISint64 number = 4;
  CMAddKey(point, "Number", &number, CMPI_keyInteger);
  const CMPIInstance* instance = CMNewInstance(broker, point, nullptr);
  const CMPIData data = CMGetProperty(instance, "Number", &status);
  EXPECT_EQ(data.type, CMPI_uint16);
  EXPECT_EQ(data.value.uint16, 4);
  EXPECT_TRUE(CMIsKeyValue(data));
}

TEST_F(InstanceTest, KeepsOutWhatItsFilterDoesNotName) {
  CMPIInstance* instance = CMNewInstance(broker, path("TST_Processor"), nullptr);
  const char* properties[] = {"vendor", nullptr};
  const char* keys[] = {"Name", nullptr};
  EXPECT_EQ(CMSetPropertyFilter(instance, properties, keys).rc, CMPI_RC_OK);

  EXPECT_EQ(CMSetProperty(instance, "Caption", "dropped", CMPI_chars).rc, CMPI_RC_OK);
  CMSetProperty(instance, "Vendor", "kept", CMPI_chars);
  CMSetProperty(instance, "Name", "one", CMPI_chars);

  EXPECT_EQ(caption(instance), "none");
  EXPECT_EQ(shownText(CMGetProperty(instance, "Vendor", nullptr).value.string), "kept");
  EXPECT_EQ(shownText(CMGetProperty(instance, "Name", nullptr).value.string), "one");
}

TEST_F(InstanceTest, ANullFilterHasNoEffect) {
  CMPIInstance* instance = system("one");
  EXPECT_EQ(CMSetPropertyFilter(instance, nullptr, nullptr).rc, CMPI_RC_OK);
  CMSetProperty(instance, "Caption", "set", CMPI_chars);
  EXPECT_EQ(caption(instance), "set");
}

TEST_F(InstanceTest, TakesAnotherPathOfItsClassOnly) {
  CMPIInstance* instance = system("one");
  EXPECT_EQ(CMSetObjectPath(instance, systemPath("two")).rc, CMPI_RC_OK);
  EXPECT_EQ(shownText(CMGetProperty(instance, "Name", nullptr).value.string), "two");
  EXPECT_EQ(CMSetObjectPath(instance, systemPath("two", "TST_Other")).rc, CMPI_RC_ERR_INVALID_PARAMETER);
}

TEST_F(InstanceTest, AClonedInstanceIsAnother) {
  CMPIInstance* instance = system("one");
  CMPIInstance* copy = CMClone(instance, &status);
  CMSetProperty(instance, "Caption", "changed", CMPI_chars);
  EXPECT_EQ(caption(copy), "none");
  EXPECT_EQ(CMSetPropertyWithOrigin(copy, "Caption", "copy", CMPI_chars, "CIM_Element").rc, CMPI_RC_OK);
  EXPECT_EQ(caption(instance), "changed");
  EXPECT_EQ(CMRelease(copy).rc, CMPI_RC_OK);
}

TEST_F(InstanceTest, HoldsACopyOfAReferenceAndOfAnArray) {
  CMPIObjectPath* antecedent = systemPath("one");
  CMPIInstance* association = CMNewInstance(broker, path("TST_Hosted"), nullptr);
  CMSetProperty(association, "Antecedent", &antecedent, CMPI_ref);
  CMSetNameSpace(antecedent, "root/elsewhere");
  const CMPIObjectPath* held = CMGetProperty(association, "Antecedent", nullptr).value.ref;
  EXPECT_EQ(shownText(CMGetNameSpace(held, nullptr)), testNamespace);
}

TEST_F(InstanceTest, KeepsItsArrayWhateverHappensToTheOneThatWasSet) {
  CMPIInstance* instance = CMNewInstance(broker, path("TST_Processor"), nullptr);
  CMPIArray* notes = CMNewArray(broker, 1, CMPI_string, nullptr);
  CMSetArrayElementAt(notes, 0, "first", CMPI_chars);
  CMSetProperty(instance, "Notes", &notes, CMPI_stringA);
  CMSetArrayElementAt(notes, 0, "second", CMPI_chars);
  CMPIArray* held = CMGetProperty(instance, "Notes", nullptr).value.array;
  EXPECT_EQ(shownText(CMGetArrayElementAt(held, 0, nullptr).value.string), "first");
  CMSetArrayElementAt(held, 0, "third", CMPI_chars);
  EXPECT_EQ(shownText(CMGetArrayElementAt(notes, 0, nullptr).value.string), "second");
  held = CMGetProperty(instance, "Notes", nullptr).value.array;
  EXPECT_EQ(shownText(CMGetArrayElementAt(held, 0, nullptr).value.string), "first");
}

TEST_F(InstanceTest, KeepsItsPathWhateverHappensToTheOneThatItWasMadeOf) {
  CMPIObjectPath* given = systemPath("one");
  const CMPIInstance* instance = CMNewInstance(broker, given, nullptr);
  CMSetNameSpace(given, "root/elsewhere");
  CMPIObjectPath* shown = CMGetObjectPath(instance, nullptr);
  EXPECT_EQ(shownText(CMGetNameSpace(shown, nullptr)), testNamespace);
  CMSetNameSpace(shown, "root/elsewhere");
  EXPECT_EQ(shownText(CMGetNameSpace(CMGetObjectPath(instance, nullptr), nullptr)), testNamespace);
}

}  // namespace
