// SPDX-License-Identifier: Apache-2.0
#include <gtest/gtest.h>

#include "cimom/model/Types.h"

namespace {

using namespace Cimom;

TEST(TypesTest, AreNamedAsTheDtdNamesThem) {
  for (const char* name : {"boolean", "char16", "real32", "real64", "uint8", "uint16", "uint32", "uint64", "sint8",
                           "sint16", "sint32", "sint64", "reference", "string", "datetime"}) {
    const CMPIType type = typeOfXmlName(name);
    ASSERT_NE(type, CMPI_null) << name;
    EXPECT_STREQ(xmlTypeName(type), name);
    EXPECT_STREQ(xmlTypeName(arrayOf(type)), name);
  }
  for (const char* name : {"", "int", "UINT8", "instance"}) {
    EXPECT_EQ(typeOfXmlName(name), CMPI_null) << name;
  }
  EXPECT_STREQ(xmlTypeName(CMPI_chars), "string");
  EXPECT_STREQ(xmlTypeName(CMPI_instance), "string");
  EXPECT_EQ(xmlTypeName(CMPI_args), nullptr);
}

TEST(TypesTest, AreFoundByTheirMofNameInAnyCase) {
  EXPECT_EQ(typeOfMofName("Uint16"), CMPI_uint16);
  EXPECT_EQ(typeOfMofName("STRING"), CMPI_string);
  EXPECT_EQ(typeOfMofName("datetime"), CMPI_dateTime);
  // A reference is declared with its class, and what an object manager embeds as a string.
  for (const char* name : {"reference", "instance", "pointer", ""}) {
    EXPECT_EQ(typeOfMofName(name), CMPI_null) << name;
  }
}

TEST(TypesTest, AreDescribedForMessages) {
  EXPECT_EQ(describeType(CMPI_dateTime), "datetime");
  EXPECT_EQ(describeType(CMPI_chars), "string");
  EXPECT_EQ(describeType(CMPI_instance), "instance");
  EXPECT_EQ(describeType(CMPI_uint16A), "uint16[]");
  EXPECT_EQ(describeType(CMPI_null), "value of no type");
}

}  // namespace
