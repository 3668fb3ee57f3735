// SPDX-License-Identifier: Apache-2.0
#include <gtest/gtest.h>

#include <vector>

#include "cimom/cimxml/ScalarText.h"
#include "cimom/model/Types.h"

namespace {

using namespace Cimom::CimXml;

TEST(ScalarTextTest, SortsKeysIntoThreeKinds) {
  EXPECT_STREQ(keyValueType(CMPI_boolean), "boolean");
  EXPECT_STREQ(keyValueType(CMPI_uint8), "numeric");
  EXPECT_STREQ(keyValueType(CMPI_real64), "numeric");
  EXPECT_STREQ(keyValueType(CMPI_string), "string");
  EXPECT_STREQ(keyValueType(CMPI_dateTime), "string");
}

struct Text {
  CMPIType type;
  const char* text;
  const char* canonical;  // null: refused
};

TEST(ScalarTextTest, ReadsAndWritesScalars) {
  const std::vector<Text> texts = {{CMPI_uint8, "0", "0"},
                                   {CMPI_uint8, "255", "255"},
                                   {CMPI_uint8, "256", nullptr},
                                   {CMPI_uint8, "-1", nullptr},
                                   {CMPI_uint8, "", nullptr},
                                   {CMPI_uint8, "1x", nullptr},
                                   {CMPI_uint8, " 1", nullptr},
                                   {CMPI_uint8, "+7", "7"},
                                   {CMPI_uint8, "+-7", nullptr},
                                   {CMPI_uint8, "0x1F", "31"},
                                   {CMPI_uint8, "0X1f", "31"},
                                   {CMPI_uint8, "0x", nullptr},
                                   {CMPI_sint8, "0x-1", nullptr},
                                   {CMPI_uint8, "0x100", nullptr},
                                   {CMPI_uint16, "65535", "65535"},
                                   {CMPI_uint32, "4294967295", "4294967295"},
                                   {CMPI_uint64, "18446744073709551615", "18446744073709551615"},
                                   {CMPI_uint64, "18446744073709551616", nullptr},
                                   {CMPI_sint8, "-128", "-128"},
                                   {CMPI_sint8, "128", nullptr},
                                   {CMPI_sint16, "-32768", "-32768"},
                                   {CMPI_sint32, "-2147483648", "-2147483648"},
                                   {CMPI_sint64, "-9223372036854775808", "-9223372036854775808"},
                                   {CMPI_real32, "1.5", "1.5"},
                                   {CMPI_real64, "-1e3", "-1000"},
                                   {CMPI_real64, "one", nullptr},
                                   {CMPI_boolean, "TRUE", "TRUE"},
                                   {CMPI_boolean, "False", "FALSE"},
                                   {CMPI_boolean, "1", nullptr},
                                   {CMPI_char16, "€", "€"},
                                   {CMPI_char16, "", nullptr},
                                   {CMPI_char16, "ab", nullptr},
                                   {CMPI_char16, "\xF0\x9F\x98\x80", nullptr},
                                   {CMPI_string, "text", nullptr}};
  for (const Text& text : texts) {
    SCOPED_TRACE(Cimom::describeType(text.type) + " \"" + text.text + "\"");
    const auto value = parseScalar(text.type, text.text);
    ASSERT_EQ(value.has_value(), text.canonical ? true : false);
    if (value) {
      EXPECT_EQ(formatScalar(Cimom::Value::scalar(text.type, *value)), text.canonical);
    }
  }
}

TEST(ScalarTextTest, WritesDateTimes) {
  constexpr const char* text = "20260102030405.000000+060";
  EXPECT_EQ(formatScalar(Cimom::Value::dateTime(Cimom::DateTime::parse(text))), text);
}

TEST(ScalarTextTest, WritesWhatIsNoScalarAsTheEmptyText) {
  for (const CMPIType type : {CMPI_string, CMPI_dateTime, CMPI_uint8, CMPI_null}) {
    EXPECT_EQ(formatScalar(Cimom::Value::null(type)), "");
  }
  EXPECT_EQ(formatScalar(Cimom::Value::arguments({})), "");
}

}  // namespace
