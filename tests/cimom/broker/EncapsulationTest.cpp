#include "tests/support/broker/ManagedElements.h"
#include "tests/support/broker/RecordingProvider.h"

namespace {

using namespace Cimom;
using namespace Testing;
using testing::ElementsAre;
using testing::HasSubstr;

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
  EXPECT_EQ(CMLogMessage(broker, CMPI_SEV_ERROR, "ID", nullptr, nullptr).rc, CMPI_RC_ERR_INVALID_HANDLE);
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
  const auto getMessage = broker->eft->getMessage;
  const CMPIString* plain = getMessage(broker, "id", "no $0 here", &status, 0);
  EXPECT_EQ(shownText(plain), "no $0 here");
  const CMPIString* filled = getMessage(broker, "id", "$1 of $0 at $2$ $9", &status, 3, CMPI_uint32, 4u, CMPI_chars,
                                        "two", CMPI_sint64, static_cast<CMPISint64>(-5));
  EXPECT_EQ(shownText(filled), "two of 4 at -5$ $9");
  EXPECT_EQ(getMessage(broker, "id", "$0", &status, 1, CMPI_args, nullptr), nullptr);
  EXPECT_EQ(status.rc, CMPI_RC_ERR_INVALID_DATA_TYPE);
  EXPECT_EQ(shownText(broker->eft->getMessage2(broker, "id", nullptr, "$0", &status, 1, CMPI_boolean, 1)), "true");
}

TEST_F(EncapsulationTest, MessageFilesAndQueriesAreNotSupported) {
  CMPIMsgFileHandle file = &status;
  EXPECT_EQ(broker->eft->openMessageFile(broker, "file", &file).rc, CMPI_RC_ERR_NOT_SUPPORTED);
  EXPECT_EQ(file, nullptr);
  EXPECT_EQ(broker->eft->closeMessageFile(broker, nullptr).rc, CMPI_RC_ERR_NOT_SUPPORTED);
  EXPECT_EQ(CMNewSelectExp(broker, "select * from x", "WQL", nullptr, &status), nullptr);
  EXPECT_EQ(status.rc, CMPI_RC_ERR_NOT_SUPPORTED);
}

TEST_F(EncapsulationTest, ObjectsTellTheirTypeAndText) {
  CMPIArray* array = CMNewArray(broker, 2, CMPI_uint16, nullptr);
  const CMPIUint16 number = 7;
  CMSetArrayElementAt(array, 0, &number, CMPI_uint16);
  const struct {
    const void* object;
    const char* type;
    const char* text;
  } rows[] = {
      {CMNewString(broker, "text", nullptr), "CMPIString", "text"},
      {systemPath("one"), "CMPIObjectPath", "root/test:TST_Processor.CreationClassName=\"TST_Processor\",Name=\"one\""},
      {system("one"), "CMPIInstance", "TST_Processor"},
      {array, "CMPIArray", "{7,NULL}"},
      {CMNewDateTimeFromBinary(broker, 0, false, nullptr), "CMPIDateTime", "19700101000000.000000+000"},
      {CMNewArgs(broker, nullptr), "CMPIArgs", "CMPIArgs"},
      {request.context(), "CMPIContext", "CMPIContext"},
  };
  for (const auto& row : rows) {
    EXPECT_EQ(shownText(CDGetType(broker, row.object, &status)), row.type);
    EXPECT_THAT(shownText(CDToString(broker, row.object, &status)), HasSubstr(row.text));
    EXPECT_TRUE(CDIsOfType(broker, row.object, row.type, &status));
    EXPECT_FALSE(CDIsOfType(broker, row.object, "CMPIEnumeration", &status));
  }
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
