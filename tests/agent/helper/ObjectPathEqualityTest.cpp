// SPDX-License-Identifier: Apache-2.0
#include <QV/ProviderHelper.h>
#include <gtest/gtest.h>

#include <map>
#include <memory>
#include <vector>

#include "tests/agent/helper/SampleFixture.h"

namespace {

using namespace QV;
using namespace Testing;

class ObjectPathEqualityTest : public SampleFixture {
 protected:
  CMPIObjectPath* keyed(const char* a, const char* b) const {
    CMPIObjectPath* made = path("Keyed");
    CMAddKey(made, "A", a, CMPI_chars);
    CMAddKey(made, "B", b, CMPI_chars);
    return made;
  }

  // A path with one key of that value.
  CMPIObjectPath* of(CMPIType type, const CMPIValue& value) const {
    CMPIObjectPath* made = path("Unknown");
    EXPECT_EQ(CMAddKey(made, "Key", &value, type).rc, CMPI_RC_OK);
    return made;
  }

  CMPIObjectPath* ofText(const char* text) const {
    CMPIObjectPath* made = path("Unknown");
    CMAddKey(made, "Key", text, CMPI_chars);
    return made;
  }

  CMPIObjectPath* ofSigned(std::int64_t number) const {
    CMPIValue value{};
    value.sint64 = number;
    return of(CMPI_sint64, value);
  }

  CMPIObjectPath* ofUnsigned(std::uint16_t number) const {
    CMPIValue value{};
    value.uint16 = number;
    return of(CMPI_uint16, value);
  }

  CMPIObjectPath* ofBoolean(bool truth) const {
    CMPIValue value{};
    value.boolean = truth ? 1 : 0;
    return of(CMPI_boolean, value);
  }

  CMPIObjectPath* ofNull() const { return of(CMPI_string, CMPIValue{}); }

  CMPIObjectPath* ofReference(CMPIObjectPath* reference) const {
    CMPIValue value{};
    value.ref = reference;
    return of(CMPI_ref, value);
  }

  static bool equal(const CMPIObjectPath* a, const CMPIObjectPath* b, bool flag = false) {
    const bool result = isObjPathsEqual(a, b, flag);
    EXPECT_EQ(isObjPathsEqual(b, a, flag), result) << "equality does not depend on the order";
    return result;
  }
};

TEST_F(ObjectPathEqualityTest, AreEqualByClassAndKeys) {
  EXPECT_TRUE(equal(keyed("1", "2"), keyed("1", "2")));
  EXPECT_FALSE(equal(keyed("1", "2"), keyed("1", "3")));
  EXPECT_FALSE(equal(keyed("1", "2"), keyed("2", "1")));
  EXPECT_FALSE(equal(path("Keyed"), path("Sample")));
  EXPECT_TRUE(equal(path("Keyed"), path("Keyed"))) << "two paths without keys";
}

TEST_F(ObjectPathEqualityTest, AreEqualWhateverTheOrderOfTheirKeysAndTheCaseOfTheirNames) {
  CMPIObjectPath* other = path("kEYED");
  CMAddKey(other, "b", "2", CMPI_chars);
  CMAddKey(other, "a", "1", CMPI_chars);
  EXPECT_TRUE(equal(keyed("1", "2"), other));
}

TEST_F(ObjectPathEqualityTest, DifferWithTheNumberOfTheirKeys) {
  CMPIObjectPath* fewer = path("Keyed");
  CMAddKey(fewer, "A", "1", CMPI_chars);
  EXPECT_FALSE(equal(keyed("1", "2"), fewer));
  EXPECT_FALSE(equal(keyed("1", "2"), path("Keyed")));
}

TEST_F(ObjectPathEqualityTest, DifferWithTheNamesOfTheirKeys) {
  CMPIObjectPath* other = path("Keyed");
  CMAddKey(other, "A", "1", CMPI_chars);
  CMAddKey(other, "C", "2", CMPI_chars);
  EXPECT_FALSE(equal(keyed("1", "2"), other));
}

TEST_F(ObjectPathEqualityTest, CompareStringsExactly) {
  EXPECT_FALSE(equal(ofText("eth0"), ofText("ETH0")));
  EXPECT_FALSE(equal(ofText("eth0"), ofText("eth0 ")));
  EXPECT_TRUE(equal(ofText(""), ofText("")));
}

TEST_F(ObjectPathEqualityTest, CompareNumbersAcrossWidthsAndSigns) {
  EXPECT_TRUE(equal(ofUnsigned(7), ofSigned(7)));
  EXPECT_FALSE(equal(ofUnsigned(7), ofSigned(8)));
  EXPECT_FALSE(equal(ofUnsigned(65535), ofSigned(-1)));
  CMPIValue all{};
  all.uint64 = ~0ULL;
  EXPECT_FALSE(equal(of(CMPI_uint64, all), ofSigned(-1)));
}

TEST_F(ObjectPathEqualityTest, TellTheTypesOfValuesApart) {
  EXPECT_FALSE(equal(ofText("7"), ofSigned(7)));
  EXPECT_FALSE(equal(ofText("true"), ofBoolean(true)));
  EXPECT_FALSE(equal(ofBoolean(true), ofSigned(1)));
}

TEST_F(ObjectPathEqualityTest, CompareBooleans) {
  EXPECT_TRUE(equal(ofBoolean(true), ofBoolean(true)));
  EXPECT_FALSE(equal(ofBoolean(true), ofBoolean(false)));
}

TEST_F(ObjectPathEqualityTest, FindNullKeysEqualToEachOtherAndToNothingElse) {
  EXPECT_TRUE(equal(ofNull(), ofNull()));
  EXPECT_FALSE(equal(ofNull(), ofText("")));
  EXPECT_FALSE(equal(ofNull(), ofSigned(0)));
}

TEST_F(ObjectPathEqualityTest, TellNullFromFalse) {
  CMPIObjectPath* unknown = path("Unknown");
  EXPECT_EQ(CMAddKey(unknown, "Key", nullptr, CMPI_boolean).rc, CMPI_RC_OK);
  EXPECT_FALSE(equal(unknown, ofBoolean(false)));
}

TEST_F(ObjectPathEqualityTest, CompareReferencesByClassAndKeys) {
  EXPECT_TRUE(equal(ofReference(keyed("1", "2")), ofReference(keyed("1", "2"))));
  EXPECT_FALSE(equal(ofReference(keyed("1", "2")), ofReference(keyed("1", "3"))));
  EXPECT_FALSE(equal(ofReference(keyed("1", "2")), ofReference(path("Keyed"))));
  EXPECT_FALSE(equal(ofReference(ofText("x")), ofText("x")));
  EXPECT_TRUE(equal(ofReference(ofReference(ofText("x"))), ofReference(ofReference(ofText("x")))));
}

TEST_F(ObjectPathEqualityTest, DoNotCompareHosts) {
  CMPIObjectPath* here = keyed("1", "2");
  CMPIObjectPath* there = keyed("1", "2");
  CMSetHostname(here, "localhost");
  CMSetHostname(there, "managed.example");
  EXPECT_TRUE(equal(here, there, true));
  EXPECT_TRUE(equal(here, keyed("1", "2"), true));
}

TEST_F(ObjectPathEqualityTest, CompareNamespacesWhereTheyAreToldTo) {
  CMPIObjectPath* other = path("Keyed", "root/other");
  EXPECT_TRUE(equal(path("Keyed"), other, false));
  EXPECT_FALSE(equal(path("Keyed"), other, true));
  EXPECT_TRUE(equal(path("Keyed"), path("Keyed"), true));
  EXPECT_TRUE(equal(path("Keyed"), path("Keyed", "ROOT/Test"), true));
}

TEST_F(ObjectPathEqualityTest, DoNotCompareANamespaceThatOneOfThemLacks) {
  EXPECT_TRUE(equal(path("Keyed"), path("Keyed", ""), true));
}

// What object managers may hand out: each makes the path equal to nothing, itself included, without a crash.
TEST_F(ObjectPathEqualityTest, WhoseClassIsNotToldEqualNothing) {
  static CMPIString withoutCharacters;
  static CMPIStringFT withoutCharactersTable;
  withoutCharactersTable = *CMNewString(broker, "x", nullptr)->ft;
  withoutCharactersTable.getCharPtr = [](const CMPIString*, CMPIStatus*) -> const char* { return nullptr; };
  withoutCharacters = {&withoutCharacters, &withoutCharactersTable};
  using Get = CMPIString*(const CMPIObjectPath*, CMPIStatus*);
  Get* const gets[] = {
      [](const CMPIObjectPath*, CMPIStatus*) -> CMPIString* { return nullptr; },
      [](const CMPIObjectPath*, CMPIStatus*) -> CMPIString* { return &withoutCharacters; },
      [](const CMPIObjectPath* path, CMPIStatus* code) {
        CMPIString* name = CMGetNameSpace(path, nullptr);
        *code = {CMPI_RC_ERR_FAILED, nullptr};
        return name;
      },
  };
  for (Get* get : gets) {
    Altered one(keyed("1", "2"));
    Altered other(keyed("1", "2"));
    one.table.getClassName = get;
    other.table.getClassName = get;
    EXPECT_FALSE(equal(one, other));
    EXPECT_FALSE(equal(one, keyed("1", "2")));
  }
}

TEST_F(ObjectPathEqualityTest, WithoutANamespaceAreComparedWithoutIt) {
  Altered elsewhere(path("Keyed", "root/other"));
  elsewhere.table.getNameSpace = [](const CMPIObjectPath*, CMPIStatus*) -> CMPIString* { return nullptr; };
  EXPECT_TRUE(equal(elsewhere, path("Keyed"), true));
  Altered lacking(keyed("1", "2"));
  lacking.table.getNameSpace = [](const CMPIObjectPath*, CMPIStatus*) -> CMPIString* { return nullptr; };
  EXPECT_TRUE(equal(lacking, keyed("1", "2"), true));
  lacking.table.getNameSpace = [](const CMPIObjectPath* path, CMPIStatus* code) {
    *code = {CMPI_RC_ERR_FAILED, nullptr};
    return CMGetClassName(path, nullptr);
  };
  EXPECT_TRUE(equal(lacking, keyed("1", "2"), true)) << "what is read beside an error is none";
}

TEST_F(ObjectPathEqualityTest, WhoseKeysCannotBeReadEqualNothing) {
  static CMPIObjectPathFT real;
  real = *path("Keyed")->ft;
  const auto expectNoneEqual = [this](const auto& alter) {
    Altered one(keyed("1", "2"));
    Altered other(keyed("1", "2"));
    alter(one.table);
    alter(other.table);
    EXPECT_FALSE(equal(one, other));
    EXPECT_FALSE(equal(one, keyed("1", "2")));
    EXPECT_FALSE(equal(one, path("Keyed")));
  };
  expectNoneEqual([](CMPIObjectPathFT& table) {
    table.getKeyCount = [](const CMPIObjectPath*, CMPIStatus* code) {
      *code = {CMPI_RC_ERR_FAILED, nullptr};
      return CMPICount{0};
    };
  });
  expectNoneEqual([](CMPIObjectPathFT& table) {
    table.getKeyAt = [](const CMPIObjectPath* path, CMPICount index, CMPIString** name, CMPIStatus* code) {
      const CMPIData data = real.getKeyAt(path, index, name, nullptr);
      *code = {CMPI_RC_ERR_FAILED, nullptr};
      return data;
    };
  });
  expectNoneEqual([](CMPIObjectPathFT& table) {
    table.getKeyAt = [](const CMPIObjectPath* path, CMPICount index, CMPIString** name, CMPIStatus* code) {
      const CMPIData data = real.getKeyAt(path, index, nullptr, code);
      *name = nullptr;
      return data;
    };
  });
}

TEST_F(ObjectPathEqualityTest, AreReadFromAnObjectManagerThatLeavesAGoodStatusAsItIs) {
  static CMPIObjectPathFT real;
  real = *path("Keyed")->ft;
  const auto alter = [](CMPIObjectPathFT& table) {
    table.getKeyCount = [](const CMPIObjectPath* path, CMPIStatus*) { return real.getKeyCount(path, nullptr); };
    table.getKeyAt = [](const CMPIObjectPath* path, CMPICount index, CMPIString** name, CMPIStatus*) {
      return real.getKeyAt(path, index, name, nullptr);
    };
    table.getClassName = [](const CMPIObjectPath* path, CMPIStatus*) { return real.getClassName(path, nullptr); };
    table.getNameSpace = [](const CMPIObjectPath* path, CMPIStatus*) { return real.getNameSpace(path, nullptr); };
  };
  Altered one(keyed("1", "2"));
  Altered other(path("Keyed", "root/other"));
  alter(one.table);
  alter(other.table);
  EXPECT_TRUE(equal(one, keyed("1", "2"), true));
  EXPECT_FALSE(equal(other, path("Keyed"), true)) << "its namespace is known";
}

TEST_F(ObjectPathEqualityTest, DifferWhereOneHasAKeyTwiceAndTheOtherTwoKeys) {
  static CMPIObjectPathFT real;
  real = *path("Keyed")->ft;
  Altered twice(keyed("1", "2"));
  twice.table.getKeyAt = [](const CMPIObjectPath* path, CMPICount, CMPIString** name, CMPIStatus* code) {
    return real.getKeyAt(path, 0, name, code);
  };
  EXPECT_FALSE(equal(twice, keyed("1", "2")));
}

TEST_F(ObjectPathEqualityTest, AreEqualInBothDirectionsWhereAKeyComesTwice) {
  Altered twice(keyed("1", "2"));
  twice.table.getKeyAt = [](const CMPIObjectPath* path, CMPICount, CMPIString** name, CMPIStatus* code) {
    *code = {CMPI_RC_OK, nullptr};
    *name = CMGetNameSpace(path, nullptr);
    CMPIData data{};
    data.type = CMPI_uint16;
    return data;
  };
  EXPECT_TRUE(equal(twice, twice));
  EXPECT_FALSE(equal(twice, keyed("1", "2")));
}

// A key as an object manager may deliver it, in a path with that key alone.
class KeysAsDeliveredTest : public ObjectPathEqualityTest {
 protected:
  CMPIObjectPath* delivering(CMPIData data) {
    CMPIObjectPath* made = ofText("placeholder");
    const auto [entry, inserted] = delivered.emplace(made, data);
    EXPECT_TRUE(inserted);
    altered_.push_back(std::make_unique<Altered<CMPIObjectPath>>(made));
    altered_.back()->table.getKeyAt = [](const CMPIObjectPath* path, CMPICount, CMPIString** name, CMPIStatus* code) {
      *code = {CMPI_RC_OK, nullptr};
      *name = CMGetClassName(path, nullptr);
      return delivered.at(path);
    };
    return made;
  }

  void TearDown() override {
    altered_.clear();
    delivered.clear();
  }

  static inline std::map<const CMPIObjectPath*, CMPIData> delivered;

 private:
  std::vector<std::unique_ptr<Altered<CMPIObjectPath>>> altered_;
};

TEST_F(KeysAsDeliveredTest, AreTheSameAsCharactersAndAsAString) {
  CMPIData asCharacters{};
  asCharacters.type = CMPI_chars;
  asCharacters.value.chars = const_cast<char*>("eth0");
  CMPIData asString{};
  asString.type = CMPI_string;
  asString.value.string = CMNewString(broker, "eth0", nullptr);
  EXPECT_TRUE(equal(delivering(asCharacters), delivering(asString)));

  CMPIData asKey = asString;
  asKey.state = CMPI_keyValue;
  EXPECT_TRUE(equal(delivering(asCharacters), delivering(asKey)));
}

TEST_F(KeysAsDeliveredTest, WithoutAValueEqualEachOtherAndNothingElse) {
  CMPIString withoutHandle{nullptr, CMNewString(broker, "x", nullptr)->ft};
  std::vector<CMPIData> withoutValue;
  for (const int type : {CMPI_string, CMPI_chars, CMPI_ref, CMPI_dateTime}) {
    withoutValue.push_back({static_cast<CMPIType>(type), CMPI_goodValue, {}});
  }
  for (const int state : {CMPI_nullValue, CMPI_notFound, CMPI_badValue}) {
    withoutValue.push_back({CMPI_uint64, static_cast<CMPIValueState>(state | CMPI_keyValue), {}});
    withoutValue.back().value.uint64 = 7;
  }
  withoutValue.push_back({CMPI_string, CMPI_goodValue, {}});
  withoutValue.back().value.string = &withoutHandle;
  CMPIData seven{CMPI_uint64, CMPI_keyValue, {}};
  seven.value.uint64 = 7;
  CMPIData empty{CMPI_string, CMPI_keyValue, {}};
  empty.value.string = CMNewString(broker, "", nullptr);

  for (const CMPIData& data : withoutValue) {
    EXPECT_TRUE(equal(delivering(data), delivering(withoutValue.front()))) << data.type << ' ' << data.state;
    EXPECT_FALSE(equal(delivering(data), delivering(seven))) << data.type << ' ' << data.state;
    EXPECT_FALSE(equal(delivering(data), delivering(empty))) << data.type << ' ' << data.state;
  }
}

TEST_F(KeysAsDeliveredTest, AreComparedByTheirTypesValues) {
  const auto key = [](CMPIType type, const auto& set) {
    CMPIData data{type, CMPI_keyValue, {}};
    set(data.value);
    return data;
  };
  const CMPIData pairs[][2] = {
      {key(CMPI_char16, [](CMPIValue& value) { value.char16 = 'a'; }),
       key(CMPI_char16, [](CMPIValue& value) { value.char16 = 'b'; })},
      {key(CMPI_real32, [](CMPIValue& value) { value.real32 = 0.5; }),
       key(CMPI_real32, [](CMPIValue& value) { value.real32 = 0.25; })},
      {key(CMPI_real64, [](CMPIValue& value) { value.real64 = 0.5; }),
       key(CMPI_real64, [](CMPIValue& value) { value.real64 = 0.25; })},
      {key(CMPI_dateTime, [&](CMPIValue& value) { value.dateTime = CMNewDateTimeFromBinary(broker, 1, 0, nullptr); }),
       key(CMPI_dateTime, [&](CMPIValue& value) { value.dateTime = CMNewDateTimeFromBinary(broker, 2, 0, nullptr); })},
  };
  for (const auto& [one, other] : pairs) {
    EXPECT_TRUE(equal(delivering(one), delivering(one))) << one.type;
    EXPECT_TRUE(equal(delivering(other), delivering(other))) << one.type;
    EXPECT_FALSE(equal(delivering(one), delivering(other))) << one.type;
  }
}

TEST_F(KeysAsDeliveredTest, ThatReferToAPathWhoseClassIsNotToldEqualNothing) {
  Altered nameless(keyed("1", "2"));
  CMPIData reference{CMPI_ref, CMPI_keyValue, {}};
  reference.value.ref = nameless;
  EXPECT_TRUE(equal(delivering(reference), delivering(reference)));

  nameless.table.getClassName = [](const CMPIObjectPath*, CMPIStatus*) -> CMPIString* { return nullptr; };
  EXPECT_FALSE(equal(delivering(reference), delivering(reference)));
}

TEST_F(KeysAsDeliveredTest, AreNotFollowedWhereTheirTypeIsNoneOfAKey) {
  for (const int type : {CMPI_null, CMPI_instance, CMPI_stringA, CMPI_refA, CMPI_uint16A, 0xffff}) {
    CMPIData data{static_cast<CMPIType>(type), CMPI_keyValue, {}};
    data.value.uint64 = 0x0101010101010101;
    EXPECT_FALSE(equal(delivering(data), delivering(data))) << type;
  }
}

TEST_F(ObjectPathEqualityTest, ThatAreNullEqualNothing) {
  CMPIObjectPath emptyHandle{nullptr, path("Keyed")->ft};
  EXPECT_FALSE(equal(nullptr, path("Keyed")));
  EXPECT_FALSE(equal(&emptyHandle, path("Keyed")));
  EXPECT_FALSE(equal(nullptr, nullptr));
}

}  // namespace
