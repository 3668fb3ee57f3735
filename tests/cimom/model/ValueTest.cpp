// SPDX-License-Identifier: Apache-2.0
#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include <limits>
#include <string>

#include "cimom/model/ObjectPath.h"
#include "cimom/model/Value.h"

namespace {

using namespace Cimom;

TEST(ValueTest, KeepsTheNumberOrRefuses) {
  const auto fits = [](const Value& value, CMPIType type) { return value.asInteger(type).has_value(); };
  EXPECT_TRUE(fits(Value::uint64(255), CMPI_uint8));
  EXPECT_FALSE(fits(Value::uint64(256), CMPI_uint8));
  EXPECT_TRUE(fits(Value::sint64(-128), CMPI_sint8));
  EXPECT_FALSE(fits(Value::sint64(-129), CMPI_sint8));
  EXPECT_FALSE(fits(Value::sint64(-1), CMPI_uint64));
  EXPECT_TRUE(fits(Value::sint64(std::numeric_limits<CMPISint64>::min()), CMPI_sint64));
  EXPECT_FALSE(fits(Value::uint64(std::numeric_limits<CMPIUint64>::max()), CMPI_sint64));
  EXPECT_FALSE(fits(Value::boolean(true), CMPI_uint8));
  EXPECT_FALSE(fits(Value::string("1"), CMPI_uint8));
  EXPECT_EQ(Value::sint64(-2).asInteger(CMPI_sint16)->scalar()->sint16, -2);
  EXPECT_EQ(Value::uint64(65535).asInteger(CMPI_uint16)->scalar()->uint16, 65535);
}

// The integer types of CIM with the bounds of what they hold, in two types, since none of the language holds all.
struct IntegerType {
  CMPIType type;
  CMPISint64 least;
  CMPIUint64 most;
};

template <typename T>
constexpr IntegerType integer(CMPIType type) {
  return {type, std::numeric_limits<T>::min(), std::numeric_limits<T>::max()};
}

constexpr IntegerType integers[] = {integer<CMPIUint8>(CMPI_uint8),   integer<CMPIUint16>(CMPI_uint16),
                                    integer<CMPIUint32>(CMPI_uint32), integer<CMPIUint64>(CMPI_uint64),
                                    integer<CMPISint8>(CMPI_sint8),   integer<CMPISint16>(CMPI_sint16),
                                    integer<CMPISint32>(CMPI_sint32), integer<CMPISint64>(CMPI_sint64)};

TEST(ValueTest, IsTakenForAnotherIntegerTypeWhereThatHoldsTheNumber) {
  const auto expectTaken = [](const Value& bound, const IntegerType& from, const IntegerType& to, bool holds) {
    const auto given = bound.asInteger(from.type);
    ASSERT_TRUE(given) << bound.toString() << " as type " << from.type;
    const auto taken = given->as(to.type);
    ASSERT_EQ(taken.has_value(), holds) << bound.toString() << " of type " << from.type << " as type " << to.type;
    if (holds) {
      EXPECT_EQ(taken->type(), to.type);
      EXPECT_EQ(taken->toString(), bound.toString());
    }
  };
  for (const IntegerType& from : integers) {
    for (const IntegerType& to : integers) {
      expectTaken(Value::sint64(from.least), from, to, from.least >= to.least);
      expectTaken(Value::sint64(0), from, to, true);
      expectTaken(Value::uint64(from.most), from, to, from.most <= to.most);
    }
    EXPECT_FALSE(Value::sint64(1).asInteger(from.type)->as(CMPI_boolean));
    EXPECT_FALSE(Value::sint64(1).asInteger(from.type)->as(CMPI_real64));
    EXPECT_EQ(Value::null(from.type).as(CMPI_string)->type(), CMPI_string);
  }
}

TEST(ValueTest, IsThatOfAnUntypedUri) {
  EXPECT_EQ(Value().toString(), "NULL");
  EXPECT_EQ(Value::sint64(std::numeric_limits<CMPISint64>::min()).toString(), "-9223372036854775808");
  EXPECT_EQ(Value::uint64(std::numeric_limits<CMPIUint64>::max()).toString(), "18446744073709551615");
  EXPECT_EQ(Value::real64(1.5).toString(), "1.5");
  EXPECT_EQ(Value::char16(65).toString(), "65");
  EXPECT_EQ(Value::array(Array{CMPI_string, {Value::string("a"), Value::null(CMPI_string)}}).toString(),
            "{\"a\",NULL}");
  EXPECT_EQ(Value::boolean(true).toString(), "TRUE");
  EXPECT_EQ(Value::boolean(false).toString(), "FALSE");
  EXPECT_EQ(Value::arguments({}).toString(), "(arguments)");
}

TEST(NamedValuesTest, ShareTheirNamesUntilOneIsAdded) {
  const Shared<NamedValues::Names> names = NamedValues::Names{"Name", "System"};
  NamedValues shared(names, {Value::string("a"), Value::string("b")});
  const NamedValues before = shared;
  EXPECT_EQ(&before[0].name, &names->front());

  shared.set("name", Value::string("c"));
  EXPECT_EQ(&shared[0].name, &names->front());
  shared.set("Unit", Value::string("d"));

  const auto textsOf = [](const NamedValues& values) {
    std::string texts;
    for (const auto& [name, value] : values) {
      texts += name + '=' + *value.text() + ' ';
    }
    return texts;
  };
  EXPECT_EQ(textsOf(shared), "Name=c System=b Unit=d ");
  EXPECT_EQ(textsOf(before), "Name=a System=b ");
  EXPECT_EQ(names->size(), 2u);
  EXPECT_EQ(*shared.find("UNIT")->text(), "d");
  EXPECT_EQ(before.find("Unit"), nullptr);
}

TEST(ValueTest, OfReferencesWithinReferencesStaysShort) {
  ObjectPath path{"", "root/test", "C", {}};
  path.keys.set("K", Value::string(std::string(100, '"')));
  for (int level = 0; level < 80; ++level) {
    ObjectPath outer{"", "root/test", "C", {}};
    outer.keys.set("Inner", Value::reference(path));
    path = outer;
  }
  EXPECT_LT(path.toString().size(), 10'000U);
  EXPECT_NE(path.toString().find("…"), std::string::npos);
}

TEST(ValueTest, OfALongReferenceIsCutBetweenCharacters) {
  for (const std::size_t shift : {0, 1, 2}) {
    ObjectPath path{"", "root/test", "C" + std::string(shift, 'x'), {}};
    std::string text;
    for (int i = 0; i < 2000; ++i) {
      text += "€";
    }
    path.keys.set("K", Value::string(text));
    const std::string cut = Value::reference(path).toString();
    ASSERT_TRUE(cut.ends_with("…\""));
    EXPECT_TRUE(cut.ends_with("€…\""));
    EXPECT_LE(cut.size(), 4096U + std::string("…\"\"\\").size());
  }
}

TEST(ValueTest, OfAReferenceIsItsTextInQuotes) {
  ObjectPath path{"", "root/test", "C", {}};
  path.keys.set("K", Value::string("a\"b"));
  EXPECT_EQ(Value::reference(path).toString(), R"("root/test:C.K=\"a\\\"b\"")");
}

}  // namespace
