// SPDX-License-Identifier: Apache-2.0
#include <gmock/gmock.h>
#include <gtest/gtest.h>
#include <sys/wait.h>
#include <syslog.h>
#include <unistd.h>

#include <algorithm>
#include <array>
#include <cstdarg>
#include <cstdio>
#include <limits>
#include <string>
#include <utility>
#include <vector>

#include "agent/log/Channel.h"
#include "tests/support/system/AllocationCount.h"
#include "tests/support/system/Poll.h"
#include "tests/support/system/TemporaryDirectory.h"

namespace {

using namespace TWLog;
using namespace Testing;

std::vector<std::pair<int, std::string>> sentToSyslog;

[[gnu::format(printf, 2, 0)]] void recordSyslog(int priority, const char* format, va_list arguments) {
  std::array<char, 1024> text{};
  std::vsnprintf(text.data(), text.size(), format, arguments);
  sentToSyslog.emplace_back(priority, text.data());
}

}  // namespace

// In place of the C library's: what would go to the machine's syslog, which a test must neither need nor fill. Where
// the product is hardened (_FORTIFY_SOURCE) it calls the second.
extern "C" void syslog(int priority, const char* format, ...) {
  va_list arguments;
  va_start(arguments, format);
  recordSyslog(priority, format, arguments);
  va_end(arguments);
}
extern "C" [[gnu::format(printf, 3, 4)]] void __syslog_chk(int priority, int /*flag*/, const char* format, ...) {
  va_list arguments;
  va_start(arguments, format);
  recordSyslog(priority, format, arguments);
  va_end(arguments);
}

namespace {

using QV::ChannelSettings;
using Destination = ChannelSettings::Destination;

TEST(ChannelTest, LetsPassWhatReachesItsThreshold) {
  const Channel channel({Destination::Stderr, "", 5000, {}});
  EXPECT_FALSE(channel.passes("C", 4999));
  EXPECT_TRUE(channel.passes("C", 5000));
  EXPECT_TRUE(channel.passes("C", 5001));
}

TEST(ChannelTest, HasAThresholdOfItsOwnForAComponentThatIsNamed) {
  const Channel channel({Destination::Stderr, "", 5000, {{"chatty", 9000}, {"watched", 1000}}});
  EXPECT_FALSE(channel.passes("chatty", 6000));
  EXPECT_TRUE(channel.passes("chatty", 9000));
  EXPECT_TRUE(channel.passes("watched", 1000));
  EXPECT_FALSE(channel.passes("watched", 999));
  EXPECT_FALSE(channel.passes("Watched", 1000)) << "components are told apart by letter case";
}

TEST(ChannelTest, LetsNothingPassWhereItIsOff) {
  const Channel channel({Destination::Off, "", 0, {{"C", 0}}});
  EXPECT_FALSE(channel.passes("C", 9000));
  EXPECT_FALSE(channel.passes("C", std::numeric_limits<int>::max()));
}

TEST(ChannelTest, RefusesAMessageWithoutAnAllocation) {
  const Channel channel({Destination::Stderr, "", 6000, {{"Tarnwick.SomeOtherComponent", 4000}}});
  const std::string component = "Tarnwick.IPConfigAssignmentSettingProvider";
  const long before = allocationCount();
  const bool passed = channel.passes(component, 4000) || channel.passes(component, 3000);
  EXPECT_EQ(allocationCount(), before);
  EXPECT_FALSE(passed);
}

TEST(ChannelTest, WritesALineToItsFile) {
  const TemporaryDirectory directory;
  Channel channel({Destination::File, directory / "log", 0, {}});
  const std::string component = "C";
  const std::string text = "one\ntwo";
  channel.send({"f", "F", 1, component, 6000, text});
  EXPECT_THAT(readFile(directory / "log"), testing::EndsWith(" 6000 C f (F:1): one\\ntwo\n"));
}

TEST(ChannelTest, NamesTheProcessThatAForkMade) {
  const TemporaryDirectory directory;
  Channel channel({Destination::File, directory / "log", 0, {}});
  const std::string component = "C";
  const std::string text = "x";
  channel.send({"f", "F", 1, component, 6000, text});
  const pid_t child = ::fork();
  if (child == 0) {
    channel.send({"f", "F", 1, component, 6000, text});
    ::_exit(0);
  }
  ::waitpid(child, nullptr, 0);
  const auto of = [](pid_t process) { return " [" + std::to_string(process) + "] "; };
  EXPECT_THAT(readFile(directory / "log"),
              testing::AllOf(testing::HasSubstr(of(::getpid())), testing::HasSubstr(of(child))));
}

TEST(ChannelTest, WritesALineToStderr) {
  Channel channel({Destination::Stderr, "", 0, {}});
  const std::string component = "C";
  const std::string text = "x";
  testing::internal::CaptureStderr();
  channel.send({"f", "F", 1, component, 6000, text});
  EXPECT_EQ(testing::internal::GetCapturedStderr(), "6000 C f (F:1): x\n");
}

TEST(ChannelTest, SaysOnceThatItsFileCannotBeWritten) {
  const TemporaryDirectory directory;
  Channel channel({Destination::File, directory / "none/log", 0, {}});
  const std::string component = "C";
  const std::string text = "x";
  sentToSyslog.clear();
  testing::internal::CaptureStderr();
  channel.send({"f", "F", 1, component, 6000, text});
  channel.send({"f", "F", 1, component, 6000, text});
  EXPECT_EQ(testing::internal::GetCapturedStderr(), "management agent: the log file " + (directory / "none/log") +
                                                        " cannot be written: No such file or directory; its messages "
                                                        "go to syslog\n");
  const std::pair lost(LOG_DAEMON | LOG_ERR, std::string("6000 C f (F:1): x"));
  EXPECT_THAT(sentToSyslog, testing::ElementsAre(testing::_, lost, lost)) << "the notice, then each message";
}

TEST(ChannelTest, SaysAgainThatItsFileCannotBeWrittenAfterItCouldBe) {
  const TemporaryDirectory directory;
  Channel channel({Destination::File, directory / "later/log", 0, {}});
  const std::string component = "C";
  const std::string text = "x";
  const Message message{"f", "F", 1, component, 6000, text};
  testing::internal::CaptureStderr();
  channel.send(message);
  std::filesystem::create_directory(directory / "later");
  channel.send(message);
  std::filesystem::remove_all(directory / "later");
  sentToSyslog.clear();
  EXPECT_TRUE(poll([&] {
    channel.send(message);
    return !sentToSyslog.empty();
  }));
  const std::string notices = testing::internal::GetCapturedStderr();
  EXPECT_EQ(std::count(notices.begin(), notices.end(), '\n'), 2);
}

TEST(ChannelTest, TellsSyslogTheSeverity) {
  Channel channel({Destination::Syslog, "", 0, {}});
  const std::string component = "C";
  const std::string text = "100 %s";
  sentToSyslog.clear();
  for (const int level : {6000, 5999, 5000, 4999, 4000, 3999}) {
    channel.send({"f", "F", 1, component, level, text});
  }
  EXPECT_THAT(sentToSyslog, testing::ElementsAre(testing::Pair(LOG_DAEMON | LOG_ERR, "6000 C f (F:1): 100 %s"),
                                                 testing::Pair(LOG_DAEMON | LOG_WARNING, "5999 C f (F:1): 100 %s"),
                                                 testing::Pair(LOG_DAEMON | LOG_WARNING, testing::_),
                                                 testing::Pair(LOG_DAEMON | LOG_INFO, "4999 C f (F:1): 100 %s"),
                                                 testing::Pair(LOG_DAEMON | LOG_INFO, testing::_),
                                                 testing::Pair(LOG_DAEMON | LOG_DEBUG, "3999 C f (F:1): 100 %s")));
}

}  // namespace
