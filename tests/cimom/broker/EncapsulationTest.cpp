// SPDX-License-Identifier: Apache-2.0
#include "cimom/broker/Handle.h"
#include "tests/support/broker/ManagedElements.h"
#include "tests/support/broker/RecordingProvider.h"

namespace {

using namespace Cimom;
using namespace Testing;
using testing::ElementsAre;

class EncapsulationTest : public ManagedElementsFixture {
 protected:
  MessageSink collector() {
    return [this](int level, std::string_view component, std::string_view text) {
      messages.push_back(std::to_string(level) + "|" + std::string(component) + "|" + std::string(text));
    };
  }

  std::vector<std::string> messages;
};

TEST_F(EncapsulationTest, TheBrokerSaysWhatItIs) {
  EXPECT_EQ(CBBrokerVersion(broker), static_cast<unsigned>(CMPIVersion200));
  EXPECT_STREQ(CBBrokerName(broker), "cimomd");
  EXPECT_EQ(CBBrokerCapabilities(broker) & CMPI_MB_Indications & ~CMPI_MB_BasicRead, 0u);
  EXPECT_EQ(CBBrokerCapabilities(broker) & CMPI_MB_AssociationTraversal,
            static_cast<unsigned>(CMPI_MB_AssociationTraversal));
}

TEST_F(EncapsulationTest, MessagesReachTheLog) {
  manager.setLog(collector());
  EXPECT_EQ(CMLogMessage(broker, CMPI_SEV_WARNING, "ID", "text", nullptr).rc, CMPI_RC_OK);
  EXPECT_EQ(CMLogMessage(broker, CMPI_SEV_ERROR, nullptr, nullptr, CMNewString(broker, "string", nullptr)).rc,
            CMPI_RC_OK);
  EXPECT_EQ(CMLogMessage(broker, CMPI_SEV_ERROR, "ID", nullptr, nullptr).rc, CMPI_RC_ERR_INVALID_PARAMETER);
  EXPECT_THAT(messages, ElementsAre("3|ID|text", "1||string"));
}

TEST_F(EncapsulationTest, TheLogIsTheStandardErrorOutputAtFirst) {
  testing::internal::CaptureStderr();
  CMLogMessage(broker, CMPI_SEV_ERROR, "ID", "text", nullptr);
  CMLogMessage(broker, static_cast<Cmpi::Severity>(7), nullptr, "odd", nullptr);
  EXPECT_EQ(testing::internal::GetCapturedStderr(), "error: ID: text\nmessage: odd\n");
}

TEST_F(EncapsulationTest, TheTraceIsOffUntilASinkIsSet) {
  EXPECT_EQ(CMTraceMessage(broker, CMPI_LEV_INFO, "component", "lost", nullptr).rc, CMPI_RC_OK);
  manager.setTrace(collector());
  EXPECT_EQ(CMTraceMessage(broker, CMPI_LEV_WARNING, "component", "text", nullptr).rc, CMPI_RC_OK);
  EXPECT_THAT(messages, ElementsAre("2|component|text"));
}

TEST_F(EncapsulationTest, ADefaultMessageTakesItsArguments) {
  const CMPIString* plain = CMGetMessage(broker, "id", "no $0 here", &status, CMFmtArgs0());
  EXPECT_EQ(shownText(plain), "no $0 here");
  const CMPIString* filled = CMGetMessage(broker, "id", "$1 of $0 at $2$ $9", &status,
                                          CMFmtArgs3(CMFmtUint(4), CMFmtChars("two"), CMFmtSint64(-5)));
  EXPECT_EQ(shownText(filled), "two of 4 at -5$ $9");
  const CMPIString* all = CMGetMessage(
      broker, "id", "$0 $1 $2 $3 $4 $5 $6 $7 $8 $9", &status,
      CMFmtArgs10(CMFmtBoolean(1), CMFmtSint(-1), CMFmtUint(4294967295U), CMFmtSint64(-9223372036854775807LL),
                  CMFmtUint64(18446744073709551615ULL), CMFmtReal(1.5), CMFmtChars("c"),
                  CMFmtString(CMNewString(broker, "s", nullptr)), CMFmtChars(nullptr), CMFmtBoolean(0)));
  EXPECT_EQ(shownText(all), "true -1 4294967295 -9223372036854775807 18446744073709551615 1.500000 c s  false");
  EXPECT_EQ(broker->eft->getMessage(broker, "id", "$0", &status, 1, CMPI_args, nullptr), nullptr);
  EXPECT_EQ(status.rc, CMPI_RC_ERR_INVALID_DATA_TYPE);
}

TEST_F(EncapsulationTest, NoMessageFileIsFoundAndADefaultServes) {
  CMPIMsgFileHandle file = &status;
  EXPECT_EQ(CMOpenMessageFile(broker, "file", &file).rc, CMPI_RC_ERR_NOT_FOUND);
  EXPECT_EQ(file, nullptr);
  EXPECT_EQ(shownText(CMGetMessage2(broker, "id", file, "$0", &status, CMFmtArgs1(CMFmtBoolean(1)))), "true");
  EXPECT_EQ(status.rc, CMPI_RC_OK);
  EXPECT_EQ(CMCloseMessageFile(broker, file).rc, CMPI_RC_ERR_INVALID_HANDLE);
}

TEST_F(EncapsulationTest, QueriesAreNotSupported) {
  EXPECT_EQ(CMNewSelectExp(broker, "select * from x", "WQL", nullptr, &status), nullptr);
  EXPECT_EQ(status.rc, CMPI_RC_ERR_NOT_SUPPORTED);
}

TEST_F(EncapsulationTest, ObjectsTellTheirTypeAndText) {
  CMPIArray* array = CMNewArray(broker, 2, CMPI_uint16, nullptr);
  const CMPIUint16 number = 7;
  CMSetArrayElementAt(array, 0, &number, CMPI_uint16);
  CMPIArgs* args = CMNewArgs(broker, nullptr);
  CMAddArg(args, "Count", &number, CMPI_uint16);
  CMAddArg(args, "List", &array, CMPI_uint16A);
  CMAddContextEntry(request.context(), CMPIPrincipal, "alice", CMPI_chars);
  const std::string path = "root/test:TST_Processor.CreationClassName=\"TST_Processor\",Name=\"one\"";
  CMPIEnumeration* enumeration = make(Enumeration{{Value::string("a"), Value::uint32(2)}, 0});
  CMPIResult* result = make(Result{CMPI_null, {Value::uint32(2)}, {}});
  const CMPIError* error = CMNewCMPIError(broker, "owner", "id", "it broke", CMPIErrorSeverity{},
                                          CMPIErrorProbableCause{}, CMPI_RC_ERR_FAILED, nullptr);
  const struct {
    const void* object;
    const char* type;
    std::string text;
  } rows[] = {
      {CMNewString(broker, "text", nullptr), "CMPIString", "text"},
      {systemPath("one"), "CMPIObjectPath", path},
      {system("one"), "CMPIInstance",
       path + " {Caption=\"none\",CreationClassName=\"TST_Processor\",Name=\"one\",EnabledState=5,Vendor=\"nobody\"}"},
      {array, "CMPIArray", "{7,NULL}"},
      {CMNewDateTimeFromBinary(broker, 0, false, nullptr), "CMPIDateTime", "19700101000000.000000+000"},
      {args, "CMPIArgs", "{Count=7,List={7,NULL}}"},
      {request.context(), "CMPIContext", "{CMPIPrincipal=\"alice\"}"},
      {enumeration, "CMPIEnumeration", "{\"a\",2}"},
      {result, "CMPIResult", "{2}"},
      {error, "CMPIError", "it broke"},
      {broker, "CMPIBroker", "cimomd"},
  };
  for (const auto& row : rows) {
    EXPECT_EQ(shownText(CDGetType(broker, row.object, &status)), row.type);
    EXPECT_EQ(shownText(CDToString(broker, row.object, &status)), row.text);
    EXPECT_TRUE(CDIsOfType(broker, row.object, row.type, &status));
    EXPECT_FALSE(CDIsOfType(broker, row.object, "CMPISelectExp", &status));
  }
}

TEST_F(EncapsulationTest, AnObjectThatIsMissingIsAnInvalidParameterAndNoInvalidHandle) {
  CDGetType(broker, nullptr, &status);
  EXPECT_EQ(status.rc, CMPI_RC_ERR_INVALID_PARAMETER);
  CMNewInstance(broker, nullptr, &status);
  EXPECT_EQ(status.rc, CMPI_RC_ERR_INVALID_PARAMETER);
  EXPECT_EQ(CMSetNameSpaceFromObjectPath(systemPath("one"), nullptr).rc, CMPI_RC_ERR_INVALID_PARAMETER);
  EXPECT_EQ(CMSetObjectPath(system("one"), nullptr).rc, CMPI_RC_ERR_INVALID_PARAMETER);
  CMPIObjectPath empty = {nullptr, systemPath("one")->ft};
  EXPECT_EQ(CMSetNameSpace(&empty, "n").rc, CMPI_RC_ERR_INVALID_HANDLE) << "what is acted on";
  EXPECT_EQ(CMSetNameSpaceFromObjectPath(systemPath("one"), &empty).rc, CMPI_RC_ERR_INVALID_HANDLE) << "what is passed";
}

TEST_F(EncapsulationTest, TheTextOfManyValuesStaysShort) {
  Enumeration many;
  many.items.assign(100'000, Value::string(std::string(100, 'x')));
  const std::string text = shownText(CDToString(broker, make(std::move(many)), &status));
  EXPECT_LT(text.size(), 5000u);
  EXPECT_THAT(text, testing::EndsWith("…}"));
}

TEST_F(EncapsulationTest, AForeignObjectIsRecognisedAsSuch) {
  const struct {
    const void* hdl;
    const void* ft;
  } foreign = {&status, &status};
  EXPECT_EQ(CDGetType(broker, &foreign, &status), nullptr);
  EXPECT_EQ(status.rc, CMPI_RC_ERR_INVALID_HANDLE);
}

}  // namespace
