// SPDX-License-Identifier: Apache-2.0
// cimomd with the probe provider, asked by wbemcli.
#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include <future>

#include "tests/support/client/Cimomd.h"

namespace {

using namespace Testing;
using testing::AllOf;
using testing::HasSubstr;
using testing::Not;

const std::string thing = "TEST_Thing.Name=\"thing\",Number=1";
const std::string part = "TEST_Part.Name=\"thing\",Number=3";

class WbemcliTest : public testing::Test {
 protected:
  // What a successful run wrote.
  std::string ask(const std::vector<std::string>& operation, const std::string& object,
                  const std::vector<std::string>& more = {}) {
    const Completed completed = cimomd_.wbemcli(operation, object, more);
    EXPECT_EQ(completed.status, 0) << completed.errors << completed.output;
    return completed.output;
  }

  // What a failed run wrote.
  std::string fail(const std::vector<std::string>& operation, const std::string& object,
                   const std::vector<std::string>& more = {}) {
    const Completed completed = cimomd_.wbemcli(operation, object, more);
    EXPECT_NE(completed.status, 0) << completed.output;
    return completed.errors + completed.output;
  }

  Cimomd cimomd_{Cimomd::probeOptions()};
};

TEST_F(WbemcliTest, EnumeratesInstancesWithEveryTypeOfProperty) {
  const std::string output = ask({"ei", "-nl"}, "TEST_Thing");
  for (const char* line : {"-Name=\"thing\"",
                           "-Number=1",
                           "-Number=2",
                           "-Flag=TRUE",
                           "-Letter=\xE2\x82\xAC",
                           "-U8=255",
                           "-U32=4294967295",
                           "-U64=18446744073709551615",
                           "-S8=-128",
                           "-S16=-32768",
                           "-S32=-2147483647",
                           "-S64=-9223372036854775807",
                           "-R32=1.5",
                           "-R64=-0.25",
                           "-Moment=20260102030405.000000+060",
                           "-Text=\"<plain> & \\\"quoted\\\" \xE2\x82\xAC\"",
                           "-Texts=\"one\",\"two\",\"\"",
                           "-Unset=",
                           "-WithDefault=5",
                           "-Numbers=14,15"}) {
    EXPECT_THAT(output, HasSubstr(line));
  }
}

TEST_F(WbemcliTest, EnumeratesSubclassesToo) {
  EXPECT_THAT(ask({"ei", "-nl"}, "TEST_Thing"), HasSubstr("-Number=3"));
  EXPECT_THAT(ask({"ein"}, "TEST_Thing"), HasSubstr("root/test:TEST_Part.Name=\"thing\",Number=3"));
}

TEST_F(WbemcliTest, EnumeratesNames) {
  EXPECT_THAT(ask({"ein"}, "TEST_Thing"), HasSubstr("root/test:TEST_Thing.Name=\"thing\",Number=1\n"));
}

TEST_F(WbemcliTest, GetsAnInstanceByItsNumericKeys) {
  EXPECT_THAT(ask({"gi", "-nl"}, thing), AllOf(HasSubstr("-Number=1"), Not(HasSubstr("-Number=2"))));
  EXPECT_THAT(ask({"gi", "-nl"}, "TEST_Numbered.Id=-7", {"Id"}), HasSubstr("-Id=-7"));
}

TEST_F(WbemcliTest, GetsOnlyThePropertiesAskedFor) {
  const std::string output = ask({"gi", "-nl"}, thing, {"Flag,U8"});
  EXPECT_THAT(output, AllOf(HasSubstr("-Flag=TRUE"), HasSubstr("-U8=255"), Not(HasSubstr("-U32"))));
}

TEST_F(WbemcliTest, ModifiesAnInstance) {
  ask({"mi"}, thing, {"Text=\"changed\""});
  EXPECT_THAT(ask({"gi", "-nl"}, thing), HasSubstr("-Text=\"changed\""));
}

TEST_F(WbemcliTest, ReadsTheSchema) {
  EXPECT_THAT(ask({"gc", "-nl"}, "TEST_Part"),
              AllOf(HasSubstr("test:TEST_Part"), HasSubstr("-Extra="), HasSubstr("-Name=")));
  EXPECT_THAT(ask({"ecn"}, ""), AllOf(HasSubstr("TEST_Thing"), HasSubstr("TEST_Link")));
}

TEST_F(WbemcliTest, TraversesAssociationsFromEitherEnd) {
  EXPECT_THAT(ask({"ai", "-nl"}, thing), AllOf(HasSubstr("TEST_Part."), HasSubstr("-Extra=\"extra\"")));
  EXPECT_THAT(ask({"ain"}, thing), HasSubstr("root/test:" + part));
  EXPECT_THAT(ask({"ain"}, part), HasSubstr("root/test:" + thing));
  EXPECT_THAT(ask({"ri", "-nl"}, thing), AllOf(HasSubstr("TEST_Link."), HasSubstr("-Strength=9")));
  EXPECT_THAT(ask({"rin"}, thing), HasSubstr("TEST_Link."));
  EXPECT_THAT(ask({"ain", "-ac", "TEST_Link"}, thing), HasSubstr("root/test:" + part));
}

TEST_F(WbemcliTest, FindsNothingWhereNothingIsAssociated) {
  EXPECT_EQ(ask({"ain"}, "TEST_Thing.Name=\"thing\",Number=2"), "");
}

TEST_F(WbemcliTest, ShowsWhatXmlCannotCarryAsAReplacement) {
  EXPECT_THAT(ask({"ei", "-nl"}, "TEST_Numbered", {"Text"}), HasSubstr("control \xEF\xBF\xBD and \xEF\xBF\xBD"));
}

TEST_F(WbemcliTest, IsToldWhatFailed) {
  EXPECT_THAT(fail({"ei"}, "TEST_Failing"), AllOf(HasSubstr("CIM_ERR_ACCESS_DENIED"), HasSubstr("out of <order>")));
  EXPECT_THAT(fail({"ei"}, "TEST_Nowhere"), HasSubstr("CIM_ERR_INVALID_CLASS"));
  EXPECT_THAT(fail({"gi"}, "TEST_Thing.Name=\"thing\",Number=9"), HasSubstr("CIM_ERR_NOT_FOUND"));
  EXPECT_THAT(fail({"gi"}, "TEST_Thing.Name=\"thing\",Number=99999"), HasSubstr("CIM_ERR_INVALID_PARAMETER"));
  const Completed elsewhere = run({"wbemcli", "ei", cimomd_.url("TEST_Thing", "root/nowhere")});
  EXPECT_THAT(elsewhere.errors + elsewhere.output, HasSubstr("CIM_ERR_INVALID_NAMESPACE"));
}

TEST_F(WbemcliTest, GetsAnEmptyAnswerFromAClassWithoutAProvider) { EXPECT_EQ(ask({"ei"}, "TEST_Unserved"), ""); }

TEST_F(WbemcliTest, IsServedBesideOthers) {
  std::vector<std::future<Completed>> clients;
  for (int i = 0; i < 16; ++i) {
    clients.push_back(std::async(std::launch::async, [this] { return cimomd_.wbemcli({"ein"}, "TEST_Thing"); }));
  }
  const std::string expected = ask({"ein"}, "TEST_Thing");
  for (auto& client : clients) {
    EXPECT_EQ(client.get().output, expected);
  }
}

TEST(WbemcliWithPasswordTest, IsServedWhenItIsRight) {
  const TemporaryDirectory directory;
  const std::string passwords = directory / "passwords";
  writePrivateFile(passwords, "admin:$5$saltsalt$0IyaXrmV7.sGNS6tirgqHLqX/G.FBvgkYA.lpPdS5sA\n");
  std::vector<std::string> options = Cimomd::probeOptions();
  options.insert(options.end(), {"--password-file", passwords});
  const Cimomd cimomd(options);
  const auto ask = [&](const std::string& credentials) {
    const std::string url = cimomd.url("TEST_Thing");
    return run({"wbemcli", "ein", "http://" + credentials + url.substr(url.find("127"))});
  };
  EXPECT_EQ(ask("admin:secret@").status, 0);
  EXPECT_NE(ask("admin:wrong@").status, 0);
  EXPECT_NE(ask("").status, 0);
}

TEST(WbemcliOverTlsTest, IsServed) {
  const TemporaryDirectory directory;
  const std::string key = (directory.path() / "key.pem").string();
  const std::string certificate = (directory.path() / "certificate.pem").string();
  const Completed made = run({"openssl", "req", "-x509", "-newkey", "rsa:2048", "-nodes", "-subj", "/CN=localhost",
                              "-keyout", key, "-out", certificate});
  ASSERT_EQ(made.status, 0) << made.errors;
  std::vector<std::string> options = Cimomd::probeOptions();
  options.insert(options.end(), {"--tls-certificate", certificate, "--tls-key", key});
  const Cimomd cimomd(options);
  const std::string url = cimomd.url("TEST_Thing");
  const Completed asked = run({"wbemcli", "ein", "-noverify", "https" + url.substr(4)});
  EXPECT_EQ(asked.status, 0) << asked.errors;
  EXPECT_THAT(asked.output, HasSubstr("TEST_Thing.Name=\"thing\",Number=1"));
  EXPECT_NE(run({"wbemcli", "ein", url}).status, 0);
}

}  // namespace
