// SPDX-License-Identifier: Apache-2.0
#include <QV/ProviderHelper.h>
#include <gtest/gtest.h>

#include <cstdint>
#include <ostream>
#include <string>
#include <vector>

#include "tests/agent/helper/SampleFixture.h"

namespace {

using namespace QV;
using namespace Testing;

class MapPropertyTest : public SampleFixture {
 protected:
  // The target's property after mapping the source's: its status is kept in status_.
  CMPIData map(const char* name, DataType type) {
    mapProperty(instanceData(source_), target_, name, type, &status_);
    return read(name);
  }

  CMPIData read(const char* name) const { return CMGetProperty(target_, name, nullptr); }

  void set(const char* name, const CMPIValue& value, CMPIType type) {
    ASSERT_EQ(CMSetProperty(source_, name, &value, type).rc, CMPI_RC_OK) << name;
  }

  void expectMismatch(const char* name, DataType type) {
    const bool unset = CMIsNullValue(map(name, type));
    EXPECT_TRUE(unset) << name << " as " << type;
    EXPECT_EQ(status_.rc, CMPI_RC_ERR_TYPE_MISMATCH) << name << " as " << type;
  }

  CMPIInstance* source_ = sample();
  CMPIInstance* target_ = sample();
  CMPIStatus status_{CMPI_RC_ERROR, nullptr};
};

TEST_F(MapPropertyTest, CopiesAString) {
  CMSetProperty(source_, "Text", "größe", CMPI_chars);
  const CMPIData data = map("Text", String);
  ASSERT_EQ(data.type, CMPI_string);
  EXPECT_EQ(characters(data.value.string), "größe");
  EXPECT_EQ(status_.rc, CMPI_RC_OK);
}

TEST_F(MapPropertyTest, CopiesAnEmptyString) {
  CMSetProperty(source_, "Text", "", CMPI_chars);
  const CMPIData data = map("Text", String);
  ASSERT_FALSE(CMIsNullValue(data));
  EXPECT_EQ(characters(data.value.string), "");
}

TEST_F(MapPropertyTest, CopiesAUint16AndAUint8) {
  CMPIValue value{};
  value.uint16 = 65535;
  set("U16", value, CMPI_uint16);
  const CMPIData wide = map("U16", Uint16);
  EXPECT_EQ(wide.type, CMPI_uint16);
  EXPECT_EQ(wide.value.uint16, 65535);
  EXPECT_EQ(status_.rc, CMPI_RC_OK);

  value = {};
  value.uint8 = 255;
  set("U8", value, CMPI_uint8);
  const CMPIData narrow = map("U8", Uint8);
  EXPECT_EQ(narrow.type, CMPI_uint8);
  EXPECT_EQ(narrow.value.uint8, 255);
}

TEST_F(MapPropertyTest, RefusesWhatTheTypeCannotRepresent) {
  CMPIValue value{};
  value.boolean = 1;
  set("Truth", value, CMPI_boolean);
  value = {};
  value.char16 = 'x';
  set("Letter", value, CMPI_char16);
  value = {};
  value.real64 = 7;
  set("Double", value, CMPI_real64);
  value = {};
  value.uint16 = 256;
  set("U16", value, CMPI_uint16);
  CMSetProperty(source_, "Text", "7", CMPI_chars);
  for (const char* name : {"Truth", "Letter", "Double"}) {
    expectMismatch(name, Uint16);
    expectMismatch(name, Uint8);
    expectMismatch(name, String);
  }
  expectMismatch("U16", Uint8);
  expectMismatch("U16", String);
  expectMismatch("Text", Uint16);
  expectMismatch("Text", Uint8);
}

TEST_F(MapPropertyTest, RefusesAnArray) {
  CMPIValue value{};
  value.array = CMNewArray(broker, 1, CMPI_uint16, nullptr);
  set("Numbers", value, CMPI_uint16A);
  expectMismatch("Numbers", Uint16);
}

TEST_F(MapPropertyTest, LeavesANullPropertyUnset) {
  EXPECT_TRUE(CMIsNullValue(map("Text", String)));
  EXPECT_EQ(status_.rc, CMPI_RC_OK);
}

TEST_F(MapPropertyTest, TellsThatTheSourceHasNoSuchProperty) {
  mapProperty(instanceData(source_), target_, "Missing", String, &status_);
  EXPECT_EQ(status_.rc, CMPI_RC_ERR_NO_SUCH_PROPERTY);
}

TEST_F(MapPropertyTest, WorksWithoutAStatus) {
  CMSetProperty(source_, "Text", "x", CMPI_chars);
  mapProperty(instanceData(source_), target_, "Text", String, nullptr);
  EXPECT_FALSE(CMIsNullValue(read("Text")));
  mapProperty(instanceData(source_), target_, "Missing", String, nullptr);
  mapProperty(instanceData(source_), target_, "Text", Uint8, nullptr);
}

TEST_F(MapPropertyTest, ReadsAnInstanceWhateverItsStateSays) {
  CMSetProperty(source_, "Text", "x", CMPI_chars);
  for (const int state : {CMPI_nullValue, CMPI_keyValue, CMPI_notFound, CMPI_badValue, 0xffff}) {
    CMPIData item = instanceData(source_);
    item.state = static_cast<CMPIValueState>(state);
    CMPIInstance* target = sample();
    mapProperty(item, target, "Text", String, &status_);
    EXPECT_EQ(status_.rc, CMPI_RC_OK) << state;
    const CMPIData mapped = CMGetProperty(target, "Text", nullptr);
    ASSERT_FALSE(CMIsNullValue(mapped)) << state;
    EXPECT_EQ(characters(mapped.value.string), "x");
  }
}

TEST_F(MapPropertyTest, NeverFollowsAnItemThatIsNoInstance) {
  CMPIString* string = CMNewString(broker, "x", nullptr);
  CMPIArray* instances = CMNewArray(broker, 1, CMPI_instance, nullptr);
  CMPIValue element{};
  element.inst = source_;
  CMSetArrayElementAt(instances, 0, &element, CMPI_instance);
  std::vector<CMPIData> items;
  const auto add = [&](int type, const auto& set) {
    CMPIData item{};
    item.type = static_cast<CMPIType>(type);
    set(item.value);
    items.push_back(item);
  };
  const auto number = [](CMPIValue& value) { value.uint64 = 0x0101010101010101; };
  for (const int type : {CMPI_null, CMPI_boolean, CMPI_char16, CMPI_real32, CMPI_real64, CMPI_uint8, CMPI_uint16,
                         CMPI_uint32, CMPI_uint64, CMPI_sint8, CMPI_sint16, CMPI_sint32, CMPI_sint64, 0xffff}) {
    add(type, number);
    add(type | CMPI_ARRAY, number);
  }
  add(CMPI_string, [&](CMPIValue& value) { value.string = string; });
  add(CMPI_chars, [&](CMPIValue& value) { value.chars = const_cast<char*>("x"); });
  add(CMPI_ref, [&](CMPIValue& value) { value.ref = path("Sample"); });
  add(CMPI_dateTime, [&](CMPIValue& value) { value.dateTime = CMNewDateTime(broker, nullptr); });
  add(CMPI_instanceA, [&](CMPIValue& value) { value.array = instances; });

  for (const CMPIData& item : items) {
    mapProperty(item, target_, "Id", String, &status_);
    EXPECT_EQ(status_.rc, CMPI_RC_ERROR) << "untouched, type " << item.type;
  }
  EXPECT_TRUE(CMIsNullValue(read("Id")));
}

TEST_F(MapPropertyTest, SetsNothingThatIsReadBesideAnError) {
  CMSetProperty(source_, "Text", "x", CMPI_chars);
  Altered altered(source_);
  static CMPIInstanceFT real;
  real = *target_->ft;
  altered.table.getProperty = [](const CMPIInstance* instance, const char* name, CMPIStatus* code) {
    const CMPIData data = real.getProperty(instance, name, nullptr);
    *code = {CMPI_RC_ERR_ACCESS_DENIED, nullptr};
    return data;
  };

  EXPECT_TRUE(CMIsNullValue(map("Text", String)));
  EXPECT_EQ(status_.rc, CMPI_RC_ERR_ACCESS_DENIED);
}

// What getProperty answers with rc OK, and what becomes of it as a string and as a number.
TEST_F(MapPropertyTest, SetsNothingWhereThePropertyHasNoValueOrNoObject) {
  static CMPIData answer;
  Altered altered(source_);
  altered.table.getProperty = [](const CMPIInstance*, const char*, CMPIStatus*) { return answer; };
  CMPIString withoutHandle{nullptr, CMNewString(broker, "x", nullptr)->ft};
  Altered withoutCharacters(CMNewString(broker, "x", nullptr));
  withoutCharacters.table.getCharPtr = [](const CMPIString*, CMPIStatus*) -> const char* { return nullptr; };
  const auto expectUnset = [&](const char* what) {
    EXPECT_TRUE(CMIsNullValue(map("Text", String))) << what;
    EXPECT_TRUE(CMIsNullValue(map("U16", Uint16))) << what;
    EXPECT_TRUE(CMIsNullValue(map("U8", Uint8))) << what;
  };

  for (const int state : {CMPI_nullValue, CMPI_notFound, CMPI_badValue}) {
    answer = {CMPI_uint16, static_cast<CMPIValueState>(state), {}};
    expectUnset("a number without a value");
    answer = {CMPI_string, static_cast<CMPIValueState>(state), {}};
    answer.value.string = CMNewString(broker, "x", nullptr);
    expectUnset("a string without a value");
  }
  answer = {CMPI_string, CMPI_goodValue, {}};
  expectUnset("a null string");
  answer.value.string = &withoutHandle;
  expectUnset("a string without a handle");
  answer.value.string = withoutCharacters;
  expectUnset("a string without characters");
  answer = {CMPI_chars, CMPI_goodValue, {}};
  expectUnset("null characters");
  answer = {CMPI_null, CMPI_goodValue, {}};
  expectUnset("no type");
}

TEST_F(MapPropertyTest, CopiesCharacters) {
  static CMPIData answer;
  answer = {CMPI_chars, CMPI_goodValue, {}};
  answer.value.chars = const_cast<char*>("x");
  Altered altered(source_);
  altered.table.getProperty = [](const CMPIInstance*, const char*, CMPIStatus*) { return answer; };
  const CMPIData data = map("Text", String);
  ASSERT_FALSE(CMIsNullValue(data));
  EXPECT_EQ(characters(data.value.string), "x");
}

TEST_F(MapPropertyTest, LeavesNullsAlone) {
  CMSetProperty(source_, "Text", "x", CMPI_chars);
  CMPIInstance emptyHandle{nullptr, source_->ft};
  mapProperty(instanceData(nullptr), target_, "Text", String, &status_);
  mapProperty(instanceData(&emptyHandle), target_, "Text", String, &status_);
  mapProperty(instanceData(source_), nullptr, "Text", String, &status_);
  mapProperty(instanceData(source_), &emptyHandle, "Text", String, &status_);
  mapProperty(instanceData(source_), target_, nullptr, String, &status_);
  EXPECT_EQ(status_.rc, CMPI_RC_ERROR) << "untouched";
  EXPECT_TRUE(CMIsNullValue(read("Text")));
}

// A number of any of the integer types, and which of the two target types can hold it.
struct Number {
  CMPIType type;
  const char* typeName;
  std::int64_t value;
  bool fitsUint16;
  bool fitsUint8;
};

void PrintTo(const Number& number, std::ostream* stream) { *stream << number.typeName << ' ' << number.value; }

class MapNumberTest : public SampleFixture, public testing::WithParamInterface<Number> {
 protected:
  // An instance whose properties of the target's names have the number's type.
  CMPIInstance* source() {
    const std::string type = GetParam().typeName;
    manager.loadSchemaText("class Source { [key] string Id; " + type + " U16; " + type + " U8; };", "root/test");
    CMPIInstance* made = CMNewInstance(broker, path("Source"), nullptr);
    const CMPIValue value = valueOf(GetParam());
    for (const char* name : {"U16", "U8"}) {
      EXPECT_EQ(CMSetProperty(made, name, &value, GetParam().type).rc, CMPI_RC_OK) << name;
    }
    return made;
  }

  static CMPIValue valueOf(const Number& number) {
    CMPIValue value{};
    switch (number.type) {
      case CMPI_uint8:
        value.uint8 = static_cast<CMPIUint8>(number.value);
        break;
      case CMPI_sint8:
        value.sint8 = static_cast<CMPISint8>(number.value);
        break;
      case CMPI_uint16:
        value.uint16 = static_cast<CMPIUint16>(number.value);
        break;
      case CMPI_sint16:
        value.sint16 = static_cast<CMPISint16>(number.value);
        break;
      case CMPI_uint32:
        value.uint32 = static_cast<CMPIUint32>(number.value);
        break;
      case CMPI_sint32:
        value.sint32 = static_cast<CMPISint32>(number.value);
        break;
      case CMPI_uint64:
        value.uint64 = static_cast<CMPIUint64>(number.value);
        break;
      default:
        value.sint64 = number.value;
    }
    return value;
  }
};

TEST_P(MapNumberTest, ReachesTheTargetWhereItFits) {
  // When a number is mapped into both widths
  CMPIInstance* from = source();
  CMPIInstance* target = sample();
  CMPIStatus wide{CMPI_RC_ERROR, nullptr};
  CMPIStatus narrow{CMPI_RC_ERROR, nullptr};
  mapProperty(instanceData(from), target, "U16", Uint16, &wide);
  mapProperty(instanceData(from), target, "U8", Uint8, &narrow);

  // Then it is there or refused
  const CMPIData wideData = CMGetProperty(target, "U16", nullptr);
  const CMPIData narrowData = CMGetProperty(target, "U8", nullptr);
  EXPECT_EQ(wide.rc, GetParam().fitsUint16 ? CMPI_RC_OK : CMPI_RC_ERR_TYPE_MISMATCH);
  EXPECT_EQ(narrow.rc, GetParam().fitsUint8 ? CMPI_RC_OK : CMPI_RC_ERR_TYPE_MISMATCH);
  ASSERT_EQ(!CMIsNullValue(wideData), GetParam().fitsUint16);
  ASSERT_EQ(!CMIsNullValue(narrowData), GetParam().fitsUint8);
  if (GetParam().fitsUint16) {
    EXPECT_EQ(wideData.value.uint16, GetParam().value);
  }
  if (GetParam().fitsUint8) {
    EXPECT_EQ(narrowData.value.uint8, GetParam().value);
  }
}

INSTANTIATE_TEST_SUITE_P(
    Each, MapNumberTest,
    testing::Values(Number{CMPI_uint8, "uint8", 255, true, true}, Number{CMPI_sint8, "sint8", 127, true, true},
                    Number{CMPI_sint8, "sint8", -1, false, false}, Number{CMPI_uint16, "uint16", 255, true, true},
                    Number{CMPI_uint16, "uint16", 256, true, false}, Number{CMPI_sint16, "sint16", 32767, true, false},
                    Number{CMPI_sint16, "sint16", -1, false, false}, Number{CMPI_uint32, "uint32", 65535, true, false},
                    Number{CMPI_uint32, "uint32", 65536, false, false}, Number{CMPI_sint32, "sint32", 0, true, true},
                    Number{CMPI_sint32, "sint32", -1, false, false}, Number{CMPI_uint64, "uint64", 255, true, true},
                    Number{CMPI_uint64, "uint64", -1, false, false}, Number{CMPI_sint64, "sint64", 65536, false, false},
                    Number{CMPI_sint64, "sint64", -65535, false, false}));

}  // namespace
