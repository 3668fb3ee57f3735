// SPDX-License-Identifier: Apache-2.0
// The [ipmi] section: defaults, forms, and refusals that name key, value and reason.
#include <gmock/gmock.h>

#include "agent/backends/ipmi/settings/IpmiSettings.h"
#include "tests/support/system/TemporaryDirectory.h"

namespace {

using namespace Testing;

namespace fs = std::filesystem;
using QV::BackEndSettings;
using QV::Ipmi::ChannelChoice;
using QV::Ipmi::IpmiSettings;
using QV::Ipmi::Ipv6Choice;
using QV::Ipmi::parseSettings;
using QV::Ipmi::readKey;
using QV::Ipmi::readPassword;
using testing::AllOf;
using testing::ElementsAre;
using testing::HasSubstr;
using testing::ThrowsMessage;
using namespace std::chrono_literals;

class IpmiSettingsTest : public testing::Test {
 protected:
  void SetUp() override { writePrivateFile(password, "secret\n"); }

  BackEndSettings lan(const BackEndSettings& more = {}) const {
    BackEndSettings section = {
        {"connection", "lan"}, {"host", "bmc.example"}, {"user", "admin"}, {"password_file", password}};
    for (const auto& [key, value] : more) {
      section[key] = value;
    }
    return section;
  }

  const TemporaryDirectory directory;
  const std::string password = directory / "password";
};

auto refusal(const std::string& setting, const std::string& reason) {
  return ThrowsMessage<std::runtime_error>(AllOf(HasSubstr("[ipmi]: " + setting), HasSubstr(reason)));
}

TEST_F(IpmiSettingsTest, OfAnEmptySectionAreInBand) {
  const IpmiSettings settings = parseSettings({});

  EXPECT_EQ(settings.connection, IpmiSettings::Connection::InBand);
  EXPECT_EQ(settings.device, "/dev/ipmi0");
  EXPECT_EQ(settings.channels.mode, ChannelChoice::Mode::InUse);
  EXPECT_EQ(settings.operationTimeout, 5s);
  EXPECT_EQ(settings.sessionTimeout, 3s);
  EXPECT_EQ(settings.retransmissionTimeout, 500ms);
  EXPECT_EQ(settings.cache, 1s);
  EXPECT_EQ(settings.generationFile, "/var/lib/compositeipconfig/ipmi-generation");
}

TEST_F(IpmiSettingsTest, OfALanConnectionHaveSoundDefaults) {
  const IpmiSettings settings = parseSettings(lan());

  EXPECT_EQ(settings.connection, IpmiSettings::Connection::Lan);
  EXPECT_EQ(settings.host, "bmc.example");
  EXPECT_EQ(settings.port, 623);
  EXPECT_EQ(settings.cipherSuite, 17);
  EXPECT_EQ(settings.privilege, 4);
  EXPECT_EQ(settings.workarounds, 0u);
  EXPECT_EQ(readPassword(settings), "secret");
  EXPECT_EQ(readKey(settings), "");
}

TEST_F(IpmiSettingsTest, TakeEveryKey) {
  writePrivateFile(directory / "key", "0x0102fF\n");
  const IpmiSettings settings = parseSettings(lan({{"port", "9623"},
                                                   {"k_g_file", directory / "key"},
                                                   {"cipher_suite", "3"},
                                                   {"privilege", "operator"},
                                                   {"workarounds", "opensesspriv, authcap"},
                                                   {"channels", "8 1,8"},
                                                   {"ipv6", "dynamic"},
                                                   {"operation_timeout", "2.5"},
                                                   {"session_timeout", "1"},
                                                   {"retransmission_timeout", "0.25"},
                                                   {"cache", "0"},
                                                   {"generation_file", "/run/generation"}}));

  EXPECT_EQ(settings.port, 9623);
  EXPECT_EQ(readKey(settings), "\x01\x02\xff");
  EXPECT_EQ(settings.cipherSuite, 3);
  EXPECT_EQ(settings.privilege, 3);
  EXPECT_EQ(settings.workarounds, 0x11u);
  EXPECT_EQ(settings.channels.mode, ChannelChoice::Mode::Listed);
  EXPECT_THAT(settings.channels.listed, ElementsAre(1, 8));
  EXPECT_EQ(settings.ipv6, Ipv6Choice::Dynamic);
  EXPECT_EQ(settings.operationTimeout, 2500ms);
  EXPECT_EQ(settings.sessionTimeout, 1000ms);
  EXPECT_EQ(settings.retransmissionTimeout, 250ms);
  EXPECT_EQ(settings.cache, 0ms);
  EXPECT_EQ(settings.generationFile, "/run/generation");
}

TEST_F(IpmiSettingsTest, FitTheTimeOutsOfASessionIntoAnOperation) {
  const IpmiSettings settings = parseSettings({{"operation_timeout", "1"}});

  EXPECT_EQ(settings.sessionTimeout, 600ms);
  EXPECT_EQ(settings.retransmissionTimeout, 100ms);
}

TEST_F(IpmiSettingsTest, RefuseBadValuesByNameAndReason) {
  struct Case {
    const char* key;
    const char* value;
    const char* reason;
  };
  const Case cases[] = {{"hostname", "x", "there is no such key"},
                        {"device", "/dev/ipmi0", "belongs to connection = inband"},
                        {"connection", "serial", "must be one of inband, lan"},
                        {"connection", "", "must be one of inband, lan"},
                        {"port", "0", "from 1 to 65535"},
                        {"port", "65536", "from 1 to 65535"},
                        {"port", "-1", "from 1 to 65535"},
                        {"port", "623 ", "from 1 to 65535"},
                        {"port", "99999999999999999999", "from 1 to 65535"},
                        {"user", "seventeen letters", "at most 16 bytes"},
                        {"cipher_suite", "0", "only 3, 8, 12 and 17"},
                        {"cipher_suite", "seventeen", "from 0 to 255"},
                        {"privilege", "root", "must be one of user, operator, admin"},
                        {"workarounds", "opensesspriv,magic", "must be one of authcap"},
                        {"channels", "0", "from 1 to 11"},
                        {"channels", "1,12", "from 1 to 11"},
                        {"channels", ", ", "must not be an empty list"},
                        {"ipv6", "both", "must be one of off, static, dynamic"},
                        {"operation_timeout", "0", "seconds from 0.1 to 60"},
                        {"operation_timeout", "nan", "seconds from 0.1 to 60"},
                        {"operation_timeout", "1e9", "seconds from 0.1 to 60"},
                        {"operation_timeout", "5s", "seconds from 0.1 to 60"},
                        {"session_timeout", "6", "seconds from 0.04 to 5"},
                        {"retransmission_timeout", "2", "seconds from 0.01 to 1.5"},
                        {"cache", "-1", "seconds from 0 to 60"},
                        {"generation_file", "generation", "must be an absolute path"},
                        {"generation_file", "", "must be an absolute path"},
                        {"password_file", "/nowhere/password", "cannot be read: No such file"}};
  for (const auto& [key, value, reason] : cases) {
    const BackEndSettings settings = lan({{key, value}});
    EXPECT_THAT([&] { parseSettings(settings); }, refusal(key, reason)) << key << " = " << value;
  }
}

TEST_F(IpmiSettingsTest, NameTheKeyThatIsMissing) {
  for (const char* key : {"host", "user", "password_file"}) {
    BackEndSettings section = lan();
    section.erase(key);
    EXPECT_THAT([&] { parseSettings(section); }, refusal(key, "is missing"));
    section[key] = "";
    EXPECT_THAT([&] { parseSettings(section); }, refusal(key, "is missing"));
  }
}

TEST_F(IpmiSettingsTest, KeepTheKeysOfLanOutOfAnInBandConnection) {
  EXPECT_THAT([] { parseSettings({{"host", "bmc"}}); }, refusal("host = bmc", "belongs to connection = lan"));
}

TEST_F(IpmiSettingsTest, RefuseSecretsThatAreTooLongOrMalformed) {
  writePrivateFile(password, "twenty-one characters\n");
  EXPECT_THAT([&] { parseSettings(lan()); }, refusal("password_file", "at most 20 bytes"));

  writePrivateFile(password, "secret\n");
  for (const char* key : {"0x123", "0xgg", "0x", "0x0 01"}) {
    writePrivateFile(directory / "key", key);
    EXPECT_THAT(
        [&] {
          parseSettings(lan({{"k_g_file", directory / "key"}}));
        },
        refusal("k_g_file", "hexadecimal"))
        << key;
  }
}

TEST_F(IpmiSettingsTest, RefuseASecretThatOthersMayTouch) {
  for (const auto others : {fs::perms::group_read, fs::perms::others_read, fs::perms::group_write}) {
    fs::permissions(password, ownerOnly | others);
    EXPECT_THAT([&] { parseSettings(lan()); }, refusal("password_file", "chmod 600"));
  }
}

TEST_F(IpmiSettingsTest, TakeTheFirstLineOfASecretFileAsItIs) {
  writePrivateFile(password, " with blanks \r\nsecond line");
  EXPECT_EQ(readPassword(parseSettings(lan())), " with blanks ");
}

TEST_F(IpmiSettingsTest, RefuseASecretFileWithoutASecret) {
  writePrivateFile(password, "\nsecret\n");
  EXPECT_THAT([&] { parseSettings(lan()); }, refusal("password_file", "its first line must hold the secret"));
}

}  // namespace
