// SPDX-License-Identifier: Apache-2.0
#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include <limits>

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

TEST(ValueTest, IsThatOfAnUntypedUri) {
  EXPECT_EQ(Value().toString(), "NULL");
  EXPECT_EQ(Value::sint64(std::numeric_limits<CMPISint64>::min()).toString(), "-9223372036854775808");
  EXPECT_EQ(Value::uint64(std::numeric_limits<CMPIUint64>::max()).toString(), "18446744073709551615");
  EXPECT_EQ(Value::real64(1.5).toString(), "1.5");
  EXPECT_EQ(Value::char16(65).toString(), "65");
  EXPECT_EQ(Value::array(Array{CMPI_string, {Value::string("a"), Value::null(CMPI_string)}}).toString(),
            "{\"a\",NULL}");
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

TEST(ValueTest, OfAReferenceIsItsTextInQuotes) {
  ObjectPath path{"", "root/test", "C", {}};
  path.keys.set("K", Value::string("a\"b"));
  EXPECT_EQ(Value::reference(path).toString(), R"("root/test:C.K=\"a\\\"b\"")");
}

}  // namespace
