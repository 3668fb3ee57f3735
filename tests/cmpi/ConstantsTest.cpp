// SPDX-License-Identifier: Apache-2.0
// The numbers that travel between separately built object managers and providers.
#include <cmpimacs.h>
#include <gtest/gtest.h>

namespace {

TEST(CmpiConstantsTest, VersionsAndCapabilities) {
  EXPECT_EQ(CMPICurrentVersion, 200);
  EXPECT_EQ(CMPIVersion100, 100);
  EXPECT_EQ(CMPI_MB_InstanceManipulation, 7);
  EXPECT_EQ(CMPI_MB_AssociationTraversal, 9);
  EXPECT_EQ(CMPI_MB_QueryNormalization, 0x31);
  EXPECT_EQ(CMPI_MB_BasicQualifierSupport, 0x47);
  EXPECT_EQ(CMPI_MB_Supports_Extended_Error, 0x8000);
}

TEST(CmpiConstantsTest, Types) {
  EXPECT_EQ(CMPI_boolean, 0x0002);
  EXPECT_EQ(CMPI_real64, 0x000C);
  EXPECT_EQ(CMPI_uint16, 0x0090);
  EXPECT_EQ(CMPI_sint64, 0x00F0);
  EXPECT_EQ(CMPI_INTEGER, 0x00C0);
  EXPECT_EQ(CMPI_instance, 0x1000);
  EXPECT_EQ(CMPI_ref, 0x1100);
  EXPECT_EQ(CMPI_string, 0x1600);
  EXPECT_EQ(CMPI_chars, 0x1700);
  EXPECT_EQ(CMPI_dateTime, 0x1800);
  EXPECT_EQ(CMPI_charsptr, 0x1A00);
  EXPECT_EQ(CMPI_uint16A, 0x2090);
  EXPECT_EQ(CMPI_stringA, 0x3600);
  EXPECT_EQ(CMPI_keyInteger, CMPI_sint64);
}

TEST(CmpiConstantsTest, StatesAndReturnCodes) {
  EXPECT_EQ(CMPI_nullValue, 0x0100);
  EXPECT_EQ(CMPI_keyValue, 0x0200);
  EXPECT_EQ(CMPI_notFound, 0x0400);
  EXPECT_EQ(CMPI_badValue, 0x8000);
  EXPECT_EQ(CMPI_RC_ERR_NOT_SUPPORTED, 7);
  EXPECT_EQ(CMPI_RC_ERR_NO_SUCH_PROPERTY, 12);
  EXPECT_EQ(CMPI_RC_NEVER_UNLOAD, 51);
  EXPECT_EQ(CMPI_RC_ERR_INVALID_DATA_TYPE, 61);
  EXPECT_EQ(CMPI_RC_ERROR, 200);
}

TEST(CmpiMacrosTest, NullTestsLookAtThePointerThenAtTheHandle) {
  CMPIInstance* none = nullptr;
  CMPIInstance withoutHandle = {nullptr, nullptr};
  int handle = 0;
  CMPIInstance whole = {&handle, nullptr};
  EXPECT_TRUE(CMIsNullObject(none));
  EXPECT_TRUE(CMIsNullObject(&withoutHandle));
  EXPECT_FALSE(CMIsNullObject(&whole));

  CMPIData data = {CMPI_uint16A, CMPI_nullValue, {}};
  EXPECT_TRUE(CMIsNullValue(data));
  EXPECT_TRUE(CMIsArray(data));
  EXPECT_FALSE(CMIsKeyValue(data));
}

}  // namespace
