#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include <atomic>
#include <cstdlib>
#include <new>

#include "agent/support/TemporaryDirectory.h"
#include "log/Channel.h"

namespace {
std::atomic<long> allocations = 0;
}

void* operator new(std::size_t size) {
  ++allocations;
  if (void* memory = std::malloc(size)) return memory;
  throw std::bad_alloc();
}
void operator delete(void* memory) noexcept { std::free(memory); }
void operator delete(void* memory, std::size_t) noexcept { std::free(memory); }

namespace TWLog {
namespace {

using QV::ChannelSettings;
using Destination = ChannelSettings::Destination;

TEST(Channel, letsPassWhatReachesItsThreshold) {
  const Channel channel({Destination::Stderr, "", 5000, {}});
  EXPECT_FALSE(channel.passes("C", 4999));
  EXPECT_TRUE(channel.passes("C", 5000));
  EXPECT_TRUE(channel.passes("C", 5001));
}

TEST(Channel, hasAThresholdOfItsOwnForAComponentThatIsNamed) {
  const Channel channel({Destination::Stderr, "", 5000, {{"chatty", 9000}, {"watched", 1000}}});
  EXPECT_FALSE(channel.passes("chatty", 6000));
  EXPECT_TRUE(channel.passes("chatty", 9000));
  EXPECT_TRUE(channel.passes("watched", 1000));
  EXPECT_FALSE(channel.passes("watched", 999));
  EXPECT_FALSE(channel.passes("Watched", 1000)) << "components are told apart by letter case";
}

TEST(Channel, letsNothingPassWhereItIsOff) {
  const Channel channel({Destination::Off, "", 0, {{"C", 0}}});
  EXPECT_FALSE(channel.passes("C", 9000));
  EXPECT_FALSE(channel.passes("C", std::numeric_limits<int>::max()));
}

TEST(Channel, refusesAMessageWithoutAnAllocation) {
  const Channel channel({Destination::Stderr, "", 6000, {{"Tarnwick.SomeOtherComponent", 4000}}});
  const std::string component = "Tarnwick.IPConfigAssignmentSettingProvider";
  const long before = allocations;
  const bool passed = channel.passes(component, 4000) || channel.passes(component, 3000);
  EXPECT_EQ(allocations, before);
  EXPECT_FALSE(passed);
}

TEST(Channel, writesALineToItsFile) {
  const TemporaryDirectory directory;
  Channel channel({Destination::File, directory / "log", 0, {}});
  const std::string component = "C";
  const std::string text = "one\ntwo";
  channel.send({"f", "F", 1, component, 6000, text});
  EXPECT_THAT(readFile(directory / "log"), testing::EndsWith(" 6000 C f (F:1): one\\ntwo\n"));
}

TEST(Channel, writesALineToStderr) {
  Channel channel({Destination::Stderr, "", 0, {}});
  const std::string component = "C";
  const std::string text = "x";
  testing::internal::CaptureStderr();
  channel.send({"f", "F", 1, component, 6000, text});
  EXPECT_EQ(testing::internal::GetCapturedStderr(), "6000 C f (F:1): x\n");
}

TEST(Channel, saysOnceThatItsFileCannotBeWritten) {
  const TemporaryDirectory directory;
  Channel channel({Destination::File, directory / "none/log", 0, {}});
  const std::string component = "C";
  const std::string text = "x";
  testing::internal::CaptureStderr();
  channel.send({"f", "F", 1, component, 6000, text});
  channel.send({"f", "F", 1, component, 6000, text});
  EXPECT_EQ(testing::internal::GetCapturedStderr(), "management agent: the log file " + (directory / "none/log") +
                                                        " cannot be written: No such file or directory; its messages "
                                                        "go to syslog\n");
}

}  // namespace
}  // namespace TWLog
