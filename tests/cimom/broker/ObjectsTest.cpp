// SPDX-License-Identifier: Apache-2.0
#include "cimom/broker/Handle.h"
#include "tests/support/broker/ManagedElements.h"
#include "tests/support/broker/RecordingProvider.h"

namespace {

using namespace Cimom;
using namespace Testing;

class ObjectsTest : public ManagedElementsFixture {
 protected:
  CMPIEnumeration* enumerationOf(std::vector<const char*> texts) {
    Enumeration model;
    for (const char* text : texts) {
      model.items.push_back(Value::string(text));
    }
    return make(std::move(model));
  }
};

TEST_F(ObjectsTest, AStringShowsItsCharactersInBothWays) {
  const CMPIString* string = CMNewString(broker, "text", &status);
  EXPECT_STREQ(CMGetCharsPtr(string, &status), "text");
  EXPECT_STREQ(CMGetCharPtr(string), "text");
  EXPECT_EQ(status.rc, CMPI_RC_OK);
}

TEST_F(ObjectsTest, AnArrayStartsWithNullsAndTakesItsTypeOnly) {
  CMPIArray* array = CMNewArray(broker, 2, CMPI_uint16, &status);
  const CMPIUint16 number = 14;
  const CMPIUint32 wide = 14;
  EXPECT_EQ(CMGetArrayCount(array, nullptr), 2u);
  EXPECT_EQ(CMGetArrayType(array, nullptr), CMPI_uint16);
  EXPECT_TRUE(CMIsNullValue(CMGetArrayElementAt(array, 0, nullptr)));
  EXPECT_EQ(CMSetArrayElementAt(array, 1, &number, CMPI_uint16).rc, CMPI_RC_OK);
  EXPECT_EQ(CMSetArrayElementAt(array, 0, &wide, CMPI_uint32).rc, CMPI_RC_ERR_TYPE_MISMATCH);
  EXPECT_EQ(CMSetArrayElementAt(array, 2, &number, CMPI_uint16).rc, CMPI_RC_ERR_NO_SUCH_PROPERTY);
  EXPECT_EQ(CMGetArrayElementAt(array, 1, nullptr).value.uint16, 14);
  EXPECT_TRUE(CMIsNullValue(CMGetArrayElementAt(array, 2, &status)));
  EXPECT_EQ(status.rc, CMPI_RC_ERR_NO_SUCH_PROPERTY);
}

TEST_F(ObjectsTest, AnArrayOfCharsIsOneOfStrings) {
  CMPIArray* array = CMNewArray(broker, 1, CMPI_chars, &status);
  EXPECT_EQ(CMGetArrayType(array, nullptr), CMPI_string);
  EXPECT_EQ(CMSetArrayElementAt(array, 0, "text", CMPI_chars).rc, CMPI_RC_OK);
  EXPECT_EQ(shownText(CMGetArrayElementAt(array, 0, nullptr).value.string), "text");
}

TEST_F(ObjectsTest, AnArrayNeedsAnElementType) {
  for (const CMPIType type : {CMPI_uint16A, CMPI_filter, 0x7777}) {
    EXPECT_EQ(CMNewArray(broker, 1, type, &status), nullptr) << type;
    EXPECT_EQ(status.rc, CMPI_RC_ERR_INVALID_DATA_TYPE) << type;
  }
}

TEST_F(ObjectsTest, AnEnumerationEndsAndReportsStepsPastItsEnd) {
  CMPIEnumeration* two = enumerationOf({"a", "b"});
  EXPECT_TRUE(CMHasNext(two, &status));
  EXPECT_EQ(shownText(CMGetNext(two, &status).value.string), "a");
  EXPECT_EQ(shownText(CMGetNext(two, &status).value.string), "b");
  EXPECT_FALSE(CMHasNext(two, &status));
  EXPECT_EQ(status.rc, CMPI_RC_OK) << "the end of a walk is no failure";
  EXPECT_TRUE(CMIsNullValue(CMGetNext(two, &status)));
  EXPECT_EQ(status.rc, 18);
}

TEST_F(ObjectsTest, AnEnumerationBecomesAnArrayWhereverItsWalkIs) {
  CMPIEnumeration* two = enumerationOf({"a", "b"});
  CMGetNext(two, nullptr);
  const CMPIArray* array = CMToArray(two, &status);
  EXPECT_EQ(CMGetArrayCount(array, nullptr), 2u);
  EXPECT_EQ(CMGetArrayType(array, nullptr), CMPI_string);
  EXPECT_EQ(shownText(CMGetNext(two, nullptr).value.string), "b");
  EXPECT_EQ(CMGetArrayCount(CMToArray(enumerationOf({}), &status), nullptr), 0u);
}

TEST_F(ObjectsTest, ArgumentsAndContextEntriesAreFoundByNameAndByIndex) {
  CMPIArgs* args = CMNewArgs(broker, &status);
  const CMPIUint32 number = 9;
  EXPECT_EQ(CMAddArg(args, "Count", &number, CMPI_uint32).rc, CMPI_RC_OK);
  EXPECT_EQ(CMAddContextEntry(request.context(), "Entry", "text", CMPI_chars).rc, CMPI_RC_OK);

  CMPIString* name = nullptr;
  EXPECT_EQ(CMGetArg(args, "count", nullptr).value.uint32, 9u);
  EXPECT_EQ(CMGetArgAt(args, 0, &name, nullptr).value.uint32, 9u);
  EXPECT_EQ(shownText(name), "Count");
  EXPECT_EQ(CMGetArgCount(args, nullptr), 1u);
  EXPECT_EQ(shownText(CMGetContextEntryAt(request.context(), 0, &name, nullptr).value.string), "text");
  EXPECT_EQ(shownText(name), "Entry");
  CMGetArg(args, "Other", &status);
  EXPECT_EQ(status.rc, CMPI_RC_ERR_NO_SUCH_PROPERTY);
  CMGetContextEntryAt(request.context(), 1, nullptr, &status);
  EXPECT_EQ(status.rc, CMPI_RC_ERR_NO_SUCH_PROPERTY);
}

TEST_F(ObjectsTest, ATimeStampKeepsItsOffset) {
  const CMPIDateTime* stamp = CMNewDateTimeFromChars(broker, "19700101013000.000001+060", &status);
  EXPECT_EQ(CMGetBinaryFormat(stamp, nullptr), 30u * 60 * 1'000'000 + 1);
  EXPECT_FALSE(CMIsInterval(stamp, nullptr));
  EXPECT_EQ(shownText(CMGetStringFormat(stamp, nullptr)), "19700101013000.000001+060");
}

TEST_F(ObjectsTest, AnIntervalCountsDays) {
  const CMPIUint64 length = (2ull * 86'400 + 3'661) * 1'000'000 + 5;
  const CMPIDateTime* interval = CMNewDateTimeFromBinary(broker, length, true, &status);
  EXPECT_TRUE(CMIsInterval(interval, nullptr));
  EXPECT_EQ(shownText(CMGetStringFormat(interval, nullptr)), "00000002010101.000005:000");
  const CMPIDateTime* same = CMNewDateTimeFromChars(broker, "00000002010101.000005:000", &status);
  EXPECT_EQ(CMGetBinaryFormat(same, nullptr), length);
}

TEST_F(ObjectsTest, TheCurrentTimeIsATimeStamp) {
  const CMPIDateTime* now = CMNewDateTime(broker, &status);
  EXPECT_GT(CMGetBinaryFormat(now, nullptr), 1'600'000'000'000'000ull);
  EXPECT_EQ(shownText(CMGetStringFormat(now, nullptr)).substr(21), "+000");
}

TEST_F(ObjectsTest, RefusesMalformedDateTimes) {
  for (const char* text : {"", "now", "20240230120000.000000+000", "20241301120000.000000+000",
                           "20240101250000.000000+000", "2024010112000x.000000+000", "20240101120000,000000+000",
                           "20240101120000.000000*000", "00000001000000.000000:060", "19691231235959.000000+000",
                           "20240101120000.000000+0000", "2024**********.******+000"}) {
    EXPECT_EQ(CMNewDateTimeFromChars(broker, text, &status), nullptr) << text;
    EXPECT_EQ(status.rc, CMPI_RC_ERR_INVALID_PARAMETER) << text;
  }
}

TEST_F(ObjectsTest, AnErrorHoldsWhatIsSetAndNothingElse) {
  CMPIError* error = CMNewCMPIError(broker, "owner", "ID7", "it broke", static_cast<CMPIErrorSeverity>(6),
                                    static_cast<CMPIErrorProbableCause>(130), CMPI_RC_ERR_FAILED, &status);
  CMPIArray* actions = CMNewArray(broker, 1, CMPI_string, nullptr);
  CMSetArrayElementAt(actions, 0, "replace it", CMPI_chars);
  EXPECT_EQ(CMSetErrorType(error, static_cast<CMPIErrorType>(1)).rc, CMPI_RC_OK);
  EXPECT_EQ(CMSetErrorSource(error, "disk").rc, CMPI_RC_OK);
  EXPECT_EQ(CMSetErrorSourceFormat(error, static_cast<CMPIErrorSrcFormat>(2)).rc, CMPI_RC_OK);
  EXPECT_EQ(CMSetRecommendedActions(error, actions).rc, CMPI_RC_OK);
  EXPECT_EQ(CMSetMessageArguments(error, actions).rc, CMPI_RC_OK);
  CMPIArray* numbers = CMNewArray(broker, 1, CMPI_uint32, nullptr);
  EXPECT_EQ(CMSetRecommendedActions(error, numbers).rc, CMPI_RC_ERR_INVALID_PARAMETER);
  EXPECT_EQ(CMSetMessageArguments(error, numbers).rc, CMPI_RC_ERR_INVALID_PARAMETER);
  EXPECT_EQ(CMSetProbableCauseDescription(error, "dust").rc, CMPI_RC_OK);
  EXPECT_EQ(CMSetOtherErrorSourceFormat(error, "ours").rc, CMPI_RC_OK);
  EXPECT_EQ(CMSetCIMStatusCodeDescription(error, "failed").rc, CMPI_RC_OK);

  EXPECT_EQ(shownText(CMGetOwningEntity(error, nullptr)), "owner");
  EXPECT_EQ(shownText(CMGetMessageID(error, nullptr)), "ID7");
  EXPECT_EQ(shownText(CMGetErrorMessage(error, nullptr)), "it broke");
  EXPECT_EQ(CMGetPerceivedSeverity(error, nullptr), static_cast<CMPIErrorSeverity>(6));
  EXPECT_EQ(CMGetProbableCause(error, nullptr), static_cast<CMPIErrorProbableCause>(130));
  EXPECT_EQ(CMGetCIMStatusCode(error, nullptr), CMPI_RC_ERR_FAILED);
  EXPECT_EQ(CMGetErrorType(error, nullptr), static_cast<CMPIErrorType>(1));
  EXPECT_EQ(CMGetErrorSourceFormat(error, nullptr), static_cast<CMPIErrorSrcFormat>(2));
  EXPECT_EQ(shownText(CMGetErrorSource(error, nullptr)), "disk");
  EXPECT_EQ(shownText(CMGetProbableCauseDescription(error, nullptr)), "dust");
  EXPECT_EQ(shownText(CMGetOtherErrorSourceFormat(error, nullptr)), "ours");
  EXPECT_EQ(shownText(CMGetCIMStatusCodeDescription(error, nullptr)), "failed");
  EXPECT_EQ(CMGetArrayCount(CMGetRecommendedActions(error, nullptr), nullptr), 1u);
  EXPECT_EQ(CMGetArrayCount(CMGetMessageArguments(error, nullptr), nullptr), 1u);
  EXPECT_EQ(CMGetOtherErrorType(error, &status), nullptr);
  EXPECT_EQ(status.rc, CMPI_RC_OK);
  EXPECT_EQ(CMSetOtherErrorType(error, "odd").rc, CMPI_RC_OK);
  EXPECT_EQ(shownText(CMGetOtherErrorType(error, nullptr)), "odd");
}

}  // namespace
