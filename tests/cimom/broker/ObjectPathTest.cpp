// SPDX-License-Identifier: Apache-2.0
#include "tests/support/broker/ManagedElements.h"
#include "tests/support/broker/RecordingProvider.h"

namespace {

using namespace Cimom;
using namespace Testing;

class ObjectPathTest : public ManagedElementsFixture {};

TEST_F(ObjectPathTest, MayBeOfAClassThatNobodyKnows) {
  const CMPIObjectPath* unknown = CMNewObjectPath(broker, "root/far", "Far_Class", &status);
  EXPECT_EQ(status.rc, CMPI_RC_OK);
  EXPECT_EQ(shownText(CMGetClassName(unknown, nullptr)), "Far_Class");
  EXPECT_EQ(shownText(CMGetNameSpace(unknown, nullptr)), "root/far");
  EXPECT_EQ(shownText(CMGetHostname(unknown, &status)), "");
  EXPECT_EQ(status.rc, CMPI_RC_OK);
}

TEST_F(ObjectPathTest, ChangesItsParts) {
  CMPIObjectPath* one = path("TST_Processor");
  CMPIObjectPath* other = CMNewObjectPath(broker, "root/other", "TST_Other", nullptr);
  EXPECT_EQ(CMSetHostname(other, "host").rc, CMPI_RC_OK);
  EXPECT_EQ(CMSetClassName(one, "TST_New").rc, CMPI_RC_OK);
  EXPECT_EQ(CMSetNameSpaceFromObjectPath(one, other).rc, CMPI_RC_OK);
  EXPECT_EQ(shownText(CMObjectPathToString(one, nullptr)), "root/other:TST_New");
  EXPECT_EQ(CMSetHostAndNameSpaceFromObjectPath(one, other).rc, CMPI_RC_OK);
  EXPECT_EQ(shownText(CMObjectPathToString(one, nullptr)), "//host/root/other:TST_New");
}

TEST_F(ObjectPathTest, FindsKeysWithoutRegardToCaseAndReplacesThem) {
  CMPIObjectPath* one = path("TST_Processor");
  CMAddKey(one, "Name", "first", CMPI_chars);
  CMAddKey(one, "NAME", "second", CMPI_chars);
  EXPECT_EQ(CMGetKeyCount(one, nullptr), 1u);
  const CMPIData key = CMGetKey(one, "name", &status);
  EXPECT_EQ(key.type, CMPI_string);
  EXPECT_TRUE(CMIsKeyValue(key));
  EXPECT_EQ(shownText(key.value.string), "second");
  CMPIString* name = nullptr;
  CMGetKeyAt(one, 0, &name, &status);
  EXPECT_EQ(shownText(name), "Name");
}

TEST_F(ObjectPathTest, ReportsAKeyThatIsNotThere) {
  const CMPIObjectPath* one = path("TST_Processor");
  EXPECT_TRUE(CMIsNullValue(CMGetKey(one, "Name", &status)));
  EXPECT_EQ(status.rc, CMPI_RC_ERR_NO_SUCH_PROPERTY);
  CMGetKeyAt(one, 0, nullptr, &status);
  EXPECT_EQ(status.rc, CMPI_RC_ERR_NO_SUCH_PROPERTY);
}

TEST_F(ObjectPathTest, KeepsAKeyThatSomebodyAddsAsNull) {
  CMPIObjectPath* one = path("TST_Processor");
  CMPIString* nothing = nullptr;
  EXPECT_EQ(CMAddKey(one, "Name", &nothing, CMPI_string).rc, CMPI_RC_OK);
  EXPECT_TRUE(CMIsNullValue(CMGetKey(one, "Name", &status)));
  EXPECT_EQ(status.rc, CMPI_RC_OK);
}

TEST_F(ObjectPathTest, IsWrittenAsAnUntypedUri) {
  CMPIObjectPath* inner = path("TST_Point");
  const CMPIUint16 number = 4;
  CMAddKey(inner, "Number", &number, CMPI_uint16);
  CMPIObjectPath* one = path("TST_Processor");
  const CMPIBoolean yes = true;
  const CMPISint32 negative = -5;
  CMAddKey(one, "Text", "say \"a\\b\"", CMPI_chars);
  CMAddKey(one, "Flag", &yes, CMPI_boolean);
  CMAddKey(one, "Offset", &negative, CMPI_sint32);
  CMAddKey(one, "Point", &inner, CMPI_ref);
  EXPECT_EQ(shownText(CMObjectPathToString(one, nullptr)),
            R"(root/test:TST_Processor.Text="say \"a\\b\"",Flag=TRUE,Offset=-5,Point="root/test:TST_Point.Number=4")");
}

TEST_F(ObjectPathTest, ReadsTheQualifiersOfItsClass) {
  const CMPIObjectPath* one = path("TST_Processor");
  const auto textQualifier = [&](const CMPIData& data) { return shownText(data.value.string); };
  EXPECT_EQ(textQualifier(CMGetClassQualifier(one, "description", &status)), "A system");
  EXPECT_EQ(textQualifier(CMGetPropertyQualifier(one, "Caption", "Description", &status)), "What people call it");
  EXPECT_TRUE(CMGetPropertyQualifier(one, "Name", "Key", &status).value.boolean);
  EXPECT_EQ(textQualifier(CMGetMethodQualifier(one, "Reset", "Description", &status)), "Returns 0");
  EXPECT_EQ(textQualifier(CMGetParameterQualifier(one, "Reset", "Force", "Description", &status)), "How");
  EXPECT_EQ(status.rc, CMPI_RC_OK);
}

TEST_F(ObjectPathTest, ReportsWhatIsNotQualifiedOrDeclared) {
  const CMPIObjectPath* one = path("TST_Processor");
  CMGetClassQualifier(one, "Abstract", &status);
  EXPECT_EQ(status.rc, CMPI_RC_ERR_NOT_FOUND) << "Abstract is not inherited";
  CMGetPropertyQualifier(one, "Undeclared", "Key", &status);
  EXPECT_EQ(status.rc, CMPI_RC_ERR_NO_SUCH_PROPERTY);
  CMGetMethodQualifier(one, "Undeclared", "Key", &status);
  EXPECT_EQ(status.rc, CMPI_RC_ERR_METHOD_NOT_FOUND);
  CMGetParameterQualifier(one, "Reset", "Undeclared", "Key", &status);
  EXPECT_EQ(status.rc, CMPI_RC_ERR_NOT_FOUND);
  CMGetClassQualifier(path("TST_Nothing"), "Key", &status);
  EXPECT_EQ(status.rc, CMPI_RC_ERR_INVALID_CLASS);
}

TEST_F(ObjectPathTest, KnowsItsSuperclasses) {
  EXPECT_TRUE(CMClassPathIsA(broker, path("TST_Processor"), "cim_element", &status));
  EXPECT_FALSE(CMClassPathIsA(broker, path("TST_Processor"), "CIM_Point", &status));
  EXPECT_EQ(status.rc, CMPI_RC_OK);
  CMClassPathIsA(broker, path("TST_Nothing"), "CIM_Point", &status);
  EXPECT_EQ(status.rc, CMPI_RC_ERR_INVALID_CLASS);
}

}  // namespace
