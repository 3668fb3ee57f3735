// SPDX-License-Identifier: Apache-2.0
// Values of every CMPI type, alone, in arrays, and in what an instance embeds.
#include "cimom/broker/Handle.h"
#include "tests/support/broker/ManagedElements.h"
#include "tests/support/broker/RecordingProvider.h"

namespace {

using namespace Cimom;
using namespace Testing;

constexpr const char* boxSchema = R"MOF(
Qualifier EmbeddedInstance : string = null, Scope(property, parameter, method);
Qualifier EmbeddedObject : boolean = false, Scope(property, parameter, method);
class TST_Box {
  [Key] string Name;
  [EmbeddedInstance("CIM_Point")] string Inner;
  [EmbeddedInstance("CIM_Point")] string Inners[];
  [EmbeddedObject] string Anything;
  string Plain;
};
class TST_SpecialBox : TST_Box {
  string Inner;
};
)MOF";

class TypesTest : public ManagedElementsFixture {
 protected:
  TypesTest() { manager.loadSchemaText(boxSchema, testNamespace); }

  CMPIInstance* box(const char* className = "TST_Box") { return CMNewInstance(broker, path(className), nullptr); }

  // An instance of TST_Point with that number.
  CMPIInstance* point(CMPIUint16 number) {
    CMPIInstance* made = CMNewInstance(broker, path("TST_Point"), nullptr);
    CMSetProperty(made, "Number", &number, CMPI_uint16);
    return made;
  }

  static CMPIUint16 numberOf(const CMPIInstance* instance) {
    return CMGetProperty(instance, "Number", nullptr).value.uint16;
  }
};

// A value of each type, and the type that it is read back with.
struct Sample {
  const char* name;
  CMPIType type;
  CMPIType stored;
  CMPIValue value;
};

TEST_F(TypesTest, AnArrayHoldsElementsOfEveryType) {
  CMPIValue text{};
  text.string = CMNewString(broker, "text", nullptr);
  CMPIValue reference{};
  reference.ref = systemPath("one");
  CMPIValue instance{};
  instance.inst = point(7);
  CMPIValue moment{};
  moment.dateTime = CMNewDateTimeFromBinary(broker, 5, false, nullptr);
  CMPIValue characters{};
  std::string letters = "text";
  characters.dataPtr = {letters.data(), 4};
  CMPIValue number{};
  number.uint64 = 0x41;
  const Sample samples[] = {{"boolean", CMPI_boolean, CMPI_boolean, number},
                            {"char16", CMPI_char16, CMPI_char16, number},
                            {"real32", CMPI_real32, CMPI_real32, number},
                            {"real64", CMPI_real64, CMPI_real64, number},
                            {"uint8", CMPI_uint8, CMPI_uint8, number},
                            {"uint16", CMPI_uint16, CMPI_uint16, number},
                            {"uint32", CMPI_uint32, CMPI_uint32, number},
                            {"uint64", CMPI_uint64, CMPI_uint64, number},
                            {"sint8", CMPI_sint8, CMPI_sint8, number},
                            {"sint16", CMPI_sint16, CMPI_sint16, number},
                            {"sint32", CMPI_sint32, CMPI_sint32, number},
                            {"sint64", CMPI_sint64, CMPI_sint64, number},
                            {"string", CMPI_string, CMPI_string, text},
                            {"charsptr", CMPI_charsptr, CMPI_string, characters},
                            {"ref", CMPI_ref, CMPI_ref, reference},
                            {"instance", CMPI_instance, CMPI_instance, instance},
                            {"dateTime", CMPI_dateTime, CMPI_dateTime, moment}};
  for (const Sample& sample : samples) {
    CMPIArray* array = CMNewArray(broker, 2, sample.type, &status);
    ASSERT_NE(array, nullptr) << sample.name;
    EXPECT_EQ(CMGetArrayType(array, nullptr), sample.stored) << sample.name;
    EXPECT_EQ(CMSetArrayElementAt(array, 1, &sample.value, sample.type).rc, CMPI_RC_OK) << sample.name;
    EXPECT_TRUE(CMIsNullValue(CMGetArrayElementAt(array, 0, nullptr))) << sample.name;
    // And as an argument, it comes back as an array that equals it.
    CMPIArgs* args = CMNewArgs(broker, nullptr);
    EXPECT_EQ(CMAddArg(args, "A", &array, CMPI_ARRAY | sample.type).rc, CMPI_RC_OK) << sample.name;
    const CMPIData back = CMGetArg(args, "A", &status);
    EXPECT_EQ(back.type, CMPI_ARRAY | sample.stored) << sample.name;
    const CMPIData element = CMGetArrayElementAt(back.value.array, 1, &status);
    EXPECT_EQ(element.type, sample.stored) << sample.name;
    EXPECT_FALSE(CMIsNullValue(element)) << sample.name;
    switch (sample.stored) {
      case CMPI_string:
        EXPECT_EQ(shownText(element.value.string), "text") << sample.name;
        break;
      case CMPI_ref:
        EXPECT_EQ(shownText(CMGetKey(element.value.ref, "Name", nullptr).value.string), "one");
        break;
      case CMPI_instance:
        EXPECT_EQ(numberOf(element.value.inst), 7);
        break;
      case CMPI_dateTime:
        EXPECT_EQ(CMGetBinaryFormat(element.value.dateTime, nullptr), 5u);
        break;
      default:
        EXPECT_EQ(element.value.uint8, 0x41) << sample.name;
    }
    EXPECT_EQ(CMSetArrayElementAt(array, 0, &array, CMPI_filter).rc, CMPI_RC_ERR_INVALID_DATA_TYPE) << sample.name;
  }
}

TEST_F(TypesTest, AnArrayHoldsArgumentsAndEnumerationsOnTheirWay) {
  CMPIArgs* args = CMNewArgs(broker, nullptr);
  CMAddArg(args, "A", "text", CMPI_chars);
  CMPIArray* array = CMNewArray(broker, 1, CMPI_args, &status);
  EXPECT_EQ(CMSetArrayElementAt(array, 0, &args, CMPI_args).rc, CMPI_RC_OK);
  CMPIArray* copy = CMClone(array, nullptr);
  CMPIArgs* held = CMGetArrayElementAt(copy, 0, nullptr).value.args;
  EXPECT_EQ(shownText(CMGetArg(held, "A", nullptr).value.string), "text");
  EXPECT_EQ(shownText(CDToString(broker, array, nullptr)), "{(arguments)}");
  CMRelease(copy);

  CMPIEnumeration* enumeration = make(Enumeration{{Value::uint32(1), Value::uint32(2)}, 1});
  array = CMNewArray(broker, 1, CMPI_enumeration, &status);
  EXPECT_EQ(CMSetArrayElementAt(array, 0, &enumeration, CMPI_enumeration).rc, CMPI_RC_OK);
  CMPIEnumeration* walk = CMGetArrayElementAt(array, 0, nullptr).value.Enum;
  EXPECT_EQ(CMGetArrayCount(CMToArray(walk, nullptr), nullptr), 2u);
}

TEST_F(TypesTest, AnArrayOfAnotherTypeThanIsSaidIsRefused) {
  CMPIArray* array = CMNewArray(broker, 1, CMPI_uint16, nullptr);
  CMPIArgs* args = CMNewArgs(broker, nullptr);
  EXPECT_EQ(CMAddArg(args, "A", &array, CMPI_uint32A).rc, CMPI_RC_ERR_TYPE_MISMATCH);
  EXPECT_EQ(CMGetArgCount(args, nullptr), 0u);
}

TEST_F(TypesTest, AnArrayOfNoTypeHoldsNullsOnly) {
  CMPIArray* array = CMNewArray(broker, 1, CMPI_null, &status);
  ASSERT_NE(array, nullptr);
  EXPECT_EQ(CMSetArrayElementAt(array, 0, nullptr, CMPI_null).rc, CMPI_RC_OK);
  const CMPIUint16 number = 1;
  EXPECT_EQ(CMSetArrayElementAt(array, 0, &number, CMPI_uint16).rc, CMPI_RC_ERR_TYPE_MISMATCH);
}

TEST_F(TypesTest, AnEmbeddedInstanceIsReadAsItWasSet) {
  CMPIInstance* outer = box();
  CMPIInstance* inner = point(3);
  CMPIArray* inners = CMNewArray(broker, 1, CMPI_instance, nullptr);
  CMSetArrayElementAt(inners, 0, &inner, CMPI_instance);
  EXPECT_EQ(CMSetProperty(outer, "Inner", &inner, CMPI_instance).rc, CMPI_RC_OK);
  EXPECT_EQ(CMSetProperty(outer, "Anything", &inner, CMPI_instance).rc, CMPI_RC_OK);
  EXPECT_EQ(CMSetProperty(outer, "Inners", &inners, CMPI_instanceA).rc, CMPI_RC_OK);
  const CMPIUint16 later = 4;
  CMSetProperty(inner, "Number", &later, CMPI_uint16);

  const CMPIData data = CMGetProperty(outer, "Inner", &status);
  EXPECT_EQ(data.type, CMPI_instance);
  EXPECT_EQ(numberOf(data.value.inst), 3) << "what is held is a copy";
  EXPECT_EQ(numberOf(CMGetProperty(outer, "Anything", nullptr).value.inst), 3);
  const CMPIData array = CMGetProperty(outer, "Inners", nullptr);
  EXPECT_EQ(array.type, CMPI_instanceA);
  EXPECT_EQ(numberOf(CMGetArrayElementAt(array.value.array, 0, nullptr).value.inst), 3);
  CMPIInstance* copy = CMClone(outer, nullptr);
  EXPECT_EQ(numberOf(CMGetProperty(copy, "Inner", nullptr).value.inst), 3);
  CMRelease(copy);
}

TEST_F(TypesTest, OnlyWhatIsDeclaredToEmbedTakesAnInstance) {
  CMPIInstance* outer = box();
  CMPIInstance* inner = point(3);
  EXPECT_EQ(CMSetProperty(outer, "Plain", &inner, CMPI_instance).rc, CMPI_RC_ERR_TYPE_MISMATCH);
  const CMPIUint32 number = 1;
  EXPECT_EQ(CMSetProperty(outer, "Inner", &number, CMPI_uint32).rc, CMPI_RC_ERR_TYPE_MISMATCH);
  EXPECT_EQ(CMSetProperty(outer, "Inner", "<INSTANCE/>", CMPI_chars).rc, CMPI_RC_OK) << "the text is the provider's";
  EXPECT_EQ(CMSetProperty(box("TST_SpecialBox"), "Inner", &inner, CMPI_instance).rc, CMPI_RC_OK)
      << "the qualifier is inherited";
}

TEST_F(TypesTest, ANullThatEmbedsNothingIsOneOfAnInstance) {
  CMPIInstance* outer = box();
  CMPIData data = CMGetProperty(outer, "Inner", &status);
  EXPECT_EQ(data.type, CMPI_instance) << "never set";
  EXPECT_TRUE(CMIsNullValue(data));
  CMSetProperty(outer, "Inners", nullptr, CMPI_instanceA);
  data = CMGetProperty(outer, "Inners", &status);
  EXPECT_EQ(data.type, CMPI_instanceA);
  EXPECT_TRUE(CMIsNullValue(data));
}

}  // namespace
