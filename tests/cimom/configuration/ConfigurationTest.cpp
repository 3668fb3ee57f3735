// SPDX-License-Identifier: Apache-2.0
// What cimomd works with: its command line, the configuration file, and what is installed beside it.
#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include "cimom/configuration/Configuration.h"
#include "tests/support/system/TemporaryDirectory.h"

namespace {

using namespace Cimom;
using namespace Testing;
using testing::AllOf;
using testing::ElementsAre;
using testing::HasSubstr;

class ConfigurationTest : public testing::Test {
 protected:
  ConfigurationTest() {
    for (const auto& directory : {installation_.schema, installation_.registration, installation_.providerDirectory}) {
      std::filesystem::create_directories(directory);
    }
  }

  Configuration read(std::vector<const char*> arguments) const {
    arguments.insert(arguments.begin(), "cimomd");
    return readCommandLine(static_cast<int>(arguments.size()), arguments.data(), installation_).value();
  }

  std::string complaint(const std::vector<const char*>& arguments) const {
    try {
      read(arguments);
    } catch (const UsageError& error) {
      return error.what();
    }
    return {};
  }

  const TemporaryDirectory directory_;
  const Installation installation_{directory_.path() / "etc/cimomd.ini", directory_.path() / "share/classes",
                                   directory_.path() / "share/registrations", directory_.path() / "lib/cmpi"};
};

TEST_F(ConfigurationTest, SaysWhatToGiveWhereThereIsNothingToServe) {
  EXPECT_THAT(complaint({}), AllOf(HasSubstr("nothing to serve: write " + installation_.configurationFile.string()),
                                   HasSubstr("--config"), HasSubstr("--help")));
}

TEST_F(ConfigurationTest, IsTheInstalledOneWhereNothingElseIsSaid) {
  const Configuration configuration = read({"--port", "1"});
  EXPECT_THAT(configuration.schemas, ElementsAre(installation_.schema));
  EXPECT_THAT(configuration.registrations, ElementsAre(installation_.registration));
  EXPECT_THAT(configuration.providerDirectories, ElementsAre(installation_.providerDirectory));
}

TEST_F(ConfigurationTest, ReadsTheInstalledFileWhereThereIsOne) {
  directory_.write("etc/cimomd.ini", "port = 7\nschema = mine.mof\n");
  const Configuration configuration = read({});
  EXPECT_EQ(configuration.port, 7);
  EXPECT_THAT(configuration.schemas, ElementsAre(directory_.path() / "etc/mine.mof"));
  EXPECT_THAT(configuration.registrations, ElementsAre(installation_.registration));
  EXPECT_EQ(read({"--port", "8"}).port, 8);
}

TEST_F(ConfigurationTest, ReadsNoOtherFileThanTheOneThatIsNamed) {
  directory_.write("etc/cimomd.ini", "nonsense = 1\n");
  EXPECT_THAT(complaint({}), HasSubstr("cimomd.ini:1: unknown key \"nonsense\""));
  EXPECT_EQ(read({"--config", "/dev/null"}).port, 5988);
  EXPECT_THAT(complaint({"--config", ""}), HasSubstr("--config: must not be empty"));
}

TEST_F(ConfigurationTest, DoesNotPassOverAnInstalledFileThatCannotBeRead) {
  std::filesystem::create_directories(installation_.configurationFile);
  EXPECT_THAT(complaint({"--port", "1"}), HasSubstr("cimomd.ini: is a directory"));
}

TEST_F(ConfigurationTest, IsExactUnlessItSaysBare) {
  EXPECT_FALSE(read({"--port", "1"}).bare);
  EXPECT_FALSE(read({"--strictness", "exact"}).bare);
  EXPECT_TRUE(read({"--strictness", "bare"}).bare);
  EXPECT_EQ(complaint({"--strictness", "Bare"}), "--strictness: must be exact or bare, not \"Bare\"");
}

TEST_F(ConfigurationTest, TakesThePortOfHttpsWithTls) {
  EXPECT_EQ(read({"--tls-certificate", "cert.pem", "--tls-key", "key.pem"}).port, 5989);
  EXPECT_EQ(read({"--tls-certificate", "cert.pem", "--tls-key", "key.pem", "--port", "5988"}).port, 5988);
}

TEST_F(ConfigurationTest, TakesFilesRelativeToItsOwnAndNamesAsTheyAre) {
  directory_.write("etc/cimomd.ini",
                   "server-name = bmc.example\nserver-name = bmc\nrequest-log = requests.log\ntrace = yes\n"
                   "user = cimomd\n");
  const Configuration configuration = read({});
  EXPECT_THAT(configuration.serverNames, ElementsAre("bmc.example", "bmc"));
  EXPECT_EQ(configuration.requestLog, directory_.path() / "etc/requests.log");
  EXPECT_TRUE(configuration.trace);
  EXPECT_EQ(configuration.user, "cimomd");
  EXPECT_EQ(read({"--request-log", "-"}).requestLog, "-") << "the standard output";
  EXPECT_FALSE(read({"--trace", "no"}).trace);
}

TEST_F(ConfigurationTest, RefusesValuesWithTheirPlace) {
  const struct {
    const char* line;
    const char* says;
  } rows[] = {
      {"schema =", "cimomd.ini:1: schema: must not be empty"},
      {"request-log =", "cimomd.ini:1: request-log: must not be empty"},
      {"server-name =", "cimomd.ini:1: server-name: must"},
      {"trace = perhaps", "cimomd.ini:1: trace: must"},
      {"tls-key = key.pem", "tls-certificate and tls-key must be given together"},
  };
  for (const auto& row : rows) {
    directory_.write("etc/cimomd.ini", std::string(row.line) + "\n");
    EXPECT_THAT(complaint({}), HasSubstr(row.says));
  }
}

TEST_F(ConfigurationTest, NamesWhatIsNotInstalledAndTheOptionForIt) {
  std::filesystem::remove_all(installation_.providerDirectory);
  EXPECT_THAT(complaint({"--port", "1"}),
              AllOf(HasSubstr("--provider-dir: must be given"), HasSubstr(installation_.providerDirectory.string())));
  EXPECT_EQ(complaint({"--port", "1", "--provider-dir", "/nowhere"}), "");
}

}  // namespace
