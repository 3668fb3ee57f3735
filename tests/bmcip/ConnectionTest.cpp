// SPDX-License-Identifier: Apache-2.0
// How a server is found, trusted and logged in to, and what is said where that fails.
#include <gmock/gmock.h>

#include <filesystem>

#include "tests/bmcip/BmcipTest.h"
#include "tests/bmcip/RawServer.h"
#include "tests/support/system/Build.h"

namespace {

using namespace Testing;
using testing::AllOf;
using testing::HasSubstr;
using testing::IsEmpty;

class BmcipConnectionTest : public BmcipTest {
 protected:
  void expectFailure(const std::vector<std::string>& more, int status, const std::string& says) const {
    std::vector<std::string> arguments = {"show"};
    arguments.insert(arguments.end(), more.begin(), more.end());
    const Completed failed = bmcip(arguments);
    EXPECT_EQ(failed.status, status) << failed.errors;
    EXPECT_THAT(failed.errors, HasSubstr(says));
    EXPECT_THAT(failed.output, IsEmpty());
  }
};

TEST_F(BmcipConnectionTest, TakesItsUrlFromTheFirstThatNamesOne) {
  const RecordedServer server("sfcb");
  directory_.write(".config/bmcip.ini", "; mine\nurl = " + server.url() + "\ntimeout = 3\n");
  EXPECT_EQ(bmcip({"show"}).status, 0);
  environment_["BMCIP_URL"] = "http://127.0.0.1:1";
  EXPECT_EQ(bmcip({"show"}).status, 10);
  EXPECT_EQ(bmcip({"show", "--url", server.url()}).status, 0);
  EXPECT_EQ(bmcip({"--url", server.url(), "show"}).status, 0);
}

TEST_F(BmcipConnectionTest, NamesFileLineAndKeyOfAMistake) {
  const auto file = directory_.write("bmcip.ini", "timeout = 3\nurl = ftp://web1\n");
  expectFailure({"--config", file.string()}, 2, "bmcip.ini:2: url: \"ftp://web1\" must begin with http");
  directory_.write("bmcip.ini", "\ntimout = 3\n");
  expectFailure({"--config", file.string()}, 2, "bmcip.ini:2: unknown key \"timout\"");
  directory_.write("bmcip.ini", "timeout = soon\n");
  expectFailure({"--config", file.string()}, 2, "bmcip.ini:1: timeout: must be");
  expectFailure({"--config", directory_ / "missing.ini"}, 2, "missing.ini: No such file");
  environment_["BMCIP_URL"] = "what is this";
  expectFailure({}, 2, "BMCIP_URL: \"what is this\" must be a host");
  environment_.erase("BMCIP_URL");
  expectFailure({"--timeout", "0"}, 2, "--timeout: must be");
  expectFailure({"--parallel", "0"}, 2, "--parallel: must be a number from 1 to 10000");
  expectFailure({"--cacert", directory_ / "missing.pem"}, 2, "missing.pem cannot be read");
  expectFailure({"--cacert", directory_.path().string()}, 2, "cannot be read: it is a directory");
  expectFailure({"--config", directory_.path().string()}, 2, directory_.path().string() + ": is a directory");
  directory_.write("bmcip.ini", "[server]\nurl = web1\n");
  expectFailure({"--config", file.string()}, 2, "bmcip.ini:2: unknown key \"url\" in [server]: there are no sections");
}

TEST_F(BmcipConnectionTest, LooksForItsFileInTheHomeThatThereIs) {
  const RecordedServer server("sfcb");
  const auto file = directory_.write("configuration/bmcip.ini", "netrc = no\nurl = " + server.url() + "\n");
  directory_.write(".config/bmcip.ini", "url = http://127.0.0.1:1\n");
  EXPECT_EQ(bmcip({"show"}).status, 10);
  environment_["XDG_CONFIG_HOME"] = file.parent_path().string();
  EXPECT_EQ(bmcip({"show"}).status, 0);
  environment_["XDG_CONFIG_HOME"] = environment_["HOME"] = "";
  EXPECT_EQ(bmcip({"show", "--url", server.url()}).status, 0);
  expectFailure({"--netrc"}, 2, "/.netrc: cannot be read");
}

TEST_F(BmcipConnectionTest, SaysWhatAnHttpStatusMeans) {
  writePrivateFile(directory_ / "login", "admin:secret");
  struct Row {
    unsigned status;
    const char* cimError;
    std::vector<std::string> options;
    int exitStatus;
    const char* says;
  };
  for (const Row& row : std::vector<Row>{
           {401, "", {}, 13, "asks for a login: give --credentials"},
           {403, "", {"--credentials", directory_ / "login"}, 13, "does not accept this login (HTTP status 403)"},
           {404, "", {}, 16, "no object manager answers there (HTTP status 404 for /cimom)"},
           {503, "", {}, 10, "takes no more requests now (HTTP status 503)"},
           {500, "", {}, 15, "does not take the request: HTTP status 500"},
           {501, "unsupported-operation", {}, 15, "HTTP status 501, unsupported-operation"}}) {
    const Cimom::Http::Server server({}, [&](const Cimom::Http::Request&) {
      Cimom::Http::Response response{row.status, {}, ""};
      if (*row.cimError) {
        response.headers.add("CIMError", row.cimError);
      }
      return response;
    });
    std::vector<std::string> options = {"--url", "http://127.0.0.1:" + std::to_string(server.port())};
    options.insert(options.end(), row.options.begin(), row.options.end());
    expectFailure(options, row.exitStatus, row.says);
  }
}

TEST_F(BmcipConnectionTest, SaysWhyThereIsNoTls) {
  const RawServer server(RawServer::Manner::Babble);
  const std::string url = "https" + server.url().substr(4);
  expectFailure({"--url", url}, 12, "does the server speak https on this port?");
  const auto empty = directory_.write("empty.pem", "");
  expectFailure({"--url", url, "--cacert", empty.string()}, 12, "the file for --cacert cannot be used");
}

TEST_F(BmcipConnectionTest, OutlivesEveryHostileServer) {
  const auto show = [this](RawServer::Manner manner, const char* timeout, int status, const std::string& says) {
    const RawServer server(manner);
    expectFailure({"--url", server.url(), "--timeout", timeout}, status, says);
    EXPECT_EQ(server.connections(), 1U);
  };
  show(RawServer::Manner::Hang, "1", 11, "no answer within 1.0 s");
  show(RawServer::Manner::Drip, "1", 11, "no answer within 1.0 s");
  // These end long before the time is up, however busy the machine is.
  show(RawServer::Manner::BreakOff, "60", 10, "broke the connection off");
  show(RawServer::Manner::Flood, "60", 16, "larger than 1048576 bytes");
  show(RawServer::Manner::Headers, "60", 16, "larger than");
  show(RawServer::Manner::Redirect, "60", 15, "HTTP status 302");
  show(RawServer::Manner::Babble, "60", 16, "the reply cannot be read");
}

class BmcipLoginTest : public BmcipConnectionTest {
 protected:
  BmcipLoginTest() {
    const std::string hash = run({"openssl", "passwd", "-6", "secret"}).output;
    const Completed made = run({"openssl", "req", "-x509", "-newkey", "rsa:2048", "-nodes", "-subj", "/CN=localhost",
                                "-addext", "subjectAltName=DNS:localhost", "-keyout", directory_ / "key.pem", "-out",
                                directory_ / "certificate.pem"});
    EXPECT_EQ(made.status, 0) << made.errors;
    std::filesystem::permissions(directory_ / "key.pem", ownerOnly);
    writePrivateFile(directory_ / "passwords", "admin:" + hash);
    directory_.write("agent.ini", simulatedProcessor(directory_ / "processor.json"));
    std::vector<std::string> options = CompositeStack::options();
    options.insert(options.end(), {"--tls-certificate", directory_ / "certificate.pem", "--tls-key",
                                   directory_ / "key.pem", "--password-file", directory_ / "passwords"});
    cimomd_ = std::make_unique<Cimomd>(options, Environment{{"QV_AGENT_INI", directory_ / "agent.ini"}});
    environment_["BMCIP_URL"] = "https://localhost:" + std::to_string(cimomd_->port());
  }

  std::string trusted() const { return directory_ / "certificate.pem"; }

  std::unique_ptr<Cimomd> cimomd_;
};

TEST_F(BmcipLoginTest, TrustsTheAuthorityThatItIsGiven) {
  expectFailure({}, 12, "--cacert");
  expectFailure({"--cacert", trusted()}, 13, "asks for a login: give --credentials");
  environment_["BMCIP_URL"] = "https://127.0.0.1:" + std::to_string(cimomd_->port());
  expectFailure({"--cacert", trusted()}, 12, "certificate is not accepted");
  environment_["BMCIP_URL"] = "http://localhost:" + std::to_string(cimomd_->port());
  EXPECT_GE(bmcip({"show"}).status, 10);
}

TEST_F(BmcipLoginTest, TakesCredentialsFromAPrivateFile) {
  writePrivateFile(directory_ / "login", "admin:secret\n");
  EXPECT_EQ(bmcip({"show", "--cacert", trusted(), "--credentials", directory_ / "login"}).status, 0);
  writePrivateFile(directory_ / "login", "admin:wrong\n");
  expectFailure({"--cacert", trusted(), "--credentials", directory_ / "login"}, 13, "does not accept this login");
  for (const char* text : {"admin\n", ":secret\n", "admin:secret\noperator:secret\n"}) {
    writePrivateFile(directory_ / "login", text);
    expectFailure({"--credentials", directory_ / "login"}, 2, "must be one line, USER:PASSWORD");
  }
  expectFailure({"--credentials", directory_ / "nothing"}, 2, "nothing: cannot be read: No such file");
  expectFailure({"--credentials", directory_.path().string()}, 2, "is a directory");
  std::filesystem::permissions(directory_ / "login", std::filesystem::perms(0640));
  expectFailure({"--credentials", directory_ / "login"}, 2, "chmod 600");
}

TEST_F(BmcipLoginTest, TakesCredentialsFromNetrc) {
  writePrivateFile(directory_ / ".netrc", "machine localhost login admin password secret\n");
  EXPECT_EQ(bmcip({"show", "--cacert", trusted(), "--netrc"}).status, 0);
  expectFailure({"--cacert", trusted()}, 13, "asks for a login");
  std::filesystem::permissions(directory_ / ".netrc", std::filesystem::perms(0644));
  expectFailure({"--cacert", trusted(), "--netrc"}, 2, ".netrc: is open to others than its owner: chmod 600 it");
}

TEST_F(BmcipLoginTest, AsksForThePasswordAtTheTerminal) {
  const std::string command = built("bin/bmcip") + " show --user admin --cacert " + trusted();
  const Completed asked =
      run({"sh", "-c", "(sleep 1; echo secret) | script -qec '" + command + "' /dev/null"}, environment_);
  EXPECT_THAT(asked.output, AllOf(HasSubstr("Password of admin: "), HasSubstr("eth0")));
  const Completed alone = run({"setsid", "-w", built("bin/bmcip"), "show", "--user", "admin"}, environment_);
  EXPECT_EQ(alone.status, 2);
  EXPECT_THAT(alone.errors, HasSubstr("can only be asked for at a terminal"));
}

TEST_F(BmcipConnectionTest, WarnsOfAPasswordWithoutEncryption) {
  writePrivateFile(directory_ / "login", "admin:secret\n");
  const Completed warned = bmcip({"show", "--url", "http://nowhere.invalid", "--credentials", directory_ / "login"});
  EXPECT_THAT(warned.errors, HasSubstr("without encryption: use https://"));
}

}  // namespace
