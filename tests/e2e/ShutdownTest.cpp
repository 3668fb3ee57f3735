// SPDX-License-Identifier: Apache-2.0
// How cimomd ends.
#include <gtest/gtest.h>
#include <signal.h>
#include <sys/stat.h>

#include <filesystem>

#include "tests/support/client/Cimomd.h"
#include "tests/support/system/Build.h"
#include "tests/support/system/Poll.h"

namespace {

using namespace Testing;
using namespace std::chrono_literals;

class ShutdownTest : public testing::Test {
 protected:
  static std::vector<std::string> options(const std::string& timeout) {
    auto options = Cimomd::probeOptions();
    options.insert(options.end(), {"--shutdown-timeout", timeout});
    return options;
  }

  bool has(const char* name) const { return std::filesystem::exists(directory_.path() / name); }
  Environment environment() const { return {{"PROBE_DIRECTORY", directory_.path().string()}}; }

  TemporaryDirectory directory_;
};

TEST_F(ShutdownTest, CleansTheProvidersUpOnSigterm) {
  Cimomd cimomd(Cimomd::probeOptions(), environment());
  ASSERT_EQ(cimomd.wbemcli({"ein"}, "TEST_Thing").status, 0);
  EXPECT_FALSE(has("cleaned"));
  EXPECT_EQ(cimomd.stop(), 0);
  EXPECT_TRUE(has("cleaned"));
  EXPECT_EQ(cimomd.process().errors(), "");
}

TEST_F(ShutdownTest, EndsOnSigintToo) {
  Cimomd cimomd(Cimomd::probeOptions());
  cimomd.process().signal(SIGINT);
  EXPECT_EQ(cimomd.process().wait(), 0);
}

TEST_F(ShutdownTest, WaitsForARequestThatIsBeingAnswered) {
  Cimomd cimomd(options("30"), environment());
  Process client({"wbemcli", "ei", cimomd.url("TEST_Slow")});
  ASSERT_TRUE(poll([&] { return has("reached"); }));
  cimomd.process().signal(SIGTERM);
  // It refuses others once it ends, and still waits for the one.
  ASSERT_TRUE(poll([&] { return cimomd.wbemcli({"ein"}, "TEST_Thing").status != 0; }));
  EXPECT_TRUE(cimomd.process().isRunning());
  EXPECT_FALSE(has("cleaned"));
  directory_.write("go", "");
  EXPECT_EQ(cimomd.process().wait(), 0);
  EXPECT_EQ(client.wait(), 0) << client.errors();
  EXPECT_TRUE(has("cleaned"));
}

TEST_F(ShutdownTest, EndsAtOnceOnASecondSignal) {
  Cimomd cimomd(options("30"), environment());
  Process client({"wbemcli", "ei", cimomd.url("TEST_Slow")});
  ASSERT_TRUE(poll([&] { return has("reached"); }));
  cimomd.process().signal(SIGTERM);
  ASSERT_TRUE(poll([&] { return cimomd.wbemcli({"ein"}, "TEST_Thing").status != 0; }));
  cimomd.process().signal(SIGTERM);
  EXPECT_EQ(cimomd.process().wait(), 1);
  EXPECT_NE(cimomd.process().errors().find("at once"), std::string::npos) << cimomd.process().errors();
  EXPECT_FALSE(has("cleaned"));
}

TEST_F(ShutdownTest, HearsSigtermWhileItStarts) {
  // Nobody ever writes the schema that it reads.
  const std::string schema = directory_ / "never.mof";
  ASSERT_EQ(mkfifo(schema.c_str(), 0600), 0);
  Process cimomd({built("bin/cimomd"), "--config", "/dev/null", "--port", "0", "--schema", schema, "--registration",
                  SOURCE_DIR "/tests/support/probe/Probe.reg", "--provider-dir", built("lib")});
  // It waits there with its signals blocked: "SigBlk: 0000000000004003" of SIGHUP, SIGINT and SIGTERM.
  const std::string status = "/proc/" + std::to_string(cimomd.id()) + "/status";
  ASSERT_TRUE(poll([&] { return readFile(status).find("SigBlk:\t0000000000004003") != std::string::npos; }));
  cimomd.signal(SIGTERM);
  EXPECT_EQ(cimomd.wait(), 0);
}

TEST_F(ShutdownTest, GoesOnAfterSighup) {
  Cimomd cimomd(Cimomd::probeOptions());
  cimomd.process().signal(SIGHUP);
  ASSERT_TRUE(poll([&] { return cimomd.process().errors().find("read again") != std::string::npos; }));
  EXPECT_EQ(cimomd.wbemcli({"ein"}, "TEST_Thing").status, 0);
  EXPECT_EQ(cimomd.stop(), 0);
}

TEST_F(ShutdownTest, GivesUpOnARequestThatTakesTooLong) {
  Cimomd cimomd(options("0"), environment());
  Process client({"wbemcli", "ei", cimomd.url("TEST_Slow")});
  ASSERT_TRUE(poll([&] { return has("reached"); }));
  EXPECT_EQ(cimomd.stop(), 1);
  EXPECT_NE(cimomd.process().errors().find("still in progress"), std::string::npos);
  EXPECT_FALSE(has("cleaned"));
}

TEST_F(ShutdownTest, SaysThatAProviderDidNotAnswerInTime) {
  auto limited = options("0");
  limited.insert(limited.end(), {"--operation-timeout", "1"});
  Cimomd cimomd(limited, environment());
  const Completed late = cimomd.wbemcli({"ei"}, "TEST_Slow");
  EXPECT_NE(late.errors.find("(1) CIM_ERR_FAILED"), std::string::npos) << late.errors;
  EXPECT_NE(late.errors.find("the provider did not answer within 1 s"), std::string::npos) << late.errors;
  EXPECT_EQ(cimomd.wbemcli({"ein"}, "TEST_Thing").status, 0);
  // The provider is still at work, and cannot be unloaded.
  EXPECT_EQ(cimomd.stop(), 1);
  EXPECT_FALSE(has("cleaned"));
}

TEST_F(ShutdownTest, OutlivesAProviderThatEndsTheThreadOfItsRequest) {
  if (sanitized()) {
    GTEST_SKIP() << "the sanitizers do not follow the unwinding of a thread";
  }
  Cimomd cimomd(Cimomd::probeOptions(), environment());
  for (int i = 0; i < 3; ++i) {
    const Completed ended = cimomd.wbemcli({"cm"}, "TEST_Machine.Name=\"one\"", {"Exit"});
    EXPECT_NE(ended.errors.find("(1) CIM_ERR_FAILED"), std::string::npos) << ended.errors;
    EXPECT_NE(ended.errors.find("provider ProbeProvider ended the thread of its request"), std::string::npos)
        << ended.errors;
    EXPECT_EQ(cimomd.wbemcli({"ein"}, "TEST_Thing").status, 0);
  }
  EXPECT_NE(cimomd.process().errors().find("cimomd: provider ProbeProvider ended its thread"), std::string::npos);
  EXPECT_EQ(cimomd.stop(), 0);
  EXPECT_TRUE(has("cleaned"));
}

TEST_F(ShutdownTest, OutlivesAClientThatGoesAway) {
  Cimomd cimomd(Cimomd::probeOptions(), environment());
  {
    Process client({"wbemcli", "ei", cimomd.url("TEST_Slow")});
    ASSERT_TRUE(poll([&] { return has("reached"); }));
  }
  directory_.write("go", "");
  EXPECT_EQ(cimomd.wbemcli({"ein"}, "TEST_Thing").status, 0);
  EXPECT_EQ(cimomd.stop(), 0);
}

}  // namespace
