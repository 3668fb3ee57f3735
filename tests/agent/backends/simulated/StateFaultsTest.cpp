// SPDX-License-Identifier: Apache-2.0
// A power cut, and a disk that fails, at every system call of a change: the state is the old one or the new one, whole,
// who is told so has it, and the next writer works and leaves nothing lying about.
#include <gmock/gmock.h>
#include <sys/syscall.h>

#include <algorithm>
#include <cerrno>
#include <cstring>
#include <filesystem>
#include <iostream>
#include <map>

#include "agent/backends/simulated/SimulatedBackEnd.h"
#include "agent/backends/simulated/StateText.h"
#include "tests/support/agent/Addresses.h"
#include "tests/support/system/SystemCalls.h"
#include "tests/support/system/TemporaryDirectory.h"

namespace {

using namespace QV;
using namespace Testing;

const AddressChange change{ipv4("198.51.100.7"), mask("255.255.0.0")};

class StateFaultsTest : public testing::Test {
 protected:
  // A state as it is before the change, in a directory that has nothing else but its lock.
  void SetUp() override {
    ManagementProcessor processor = processor_.read();
    file_ = readFile(state_);
    old_ = writeState(processor);
    processor.interfaces.at(0).ipv4Address = change.ipv4Address;
    processor.interfaces.at(0).ipv4SubnetMask = change.ipv4SubnetMask;
    changed_ = writeState(processor);
  }

  TracedWork changeWith(const std::optional<Intervention>& intervention) {
    writeFile(state_, file_);
    return traced([this] { processor_.change("eth0", change); }, intervention);
  }

  std::string read() { return writeState(processor_.read()); }

  // What is true however the change ended.
  void expectOldOrNewAndANextWriterThatWorks() {
    EXPECT_THAT(read(), testing::AnyOf(old_, changed_));
    EXPECT_NO_THROW(processor_.change("eth1", {ipv4("203.0.113.9"), {}}));
    EXPECT_EQ(processor_.read().interfaces.at(1).ipv4Address, ipv4("203.0.113.9"));
    const auto names = std::filesystem::directory_iterator(directory_.path());
    EXPECT_EQ(std::distance(begin(names), end(names)), 2) << "the state and its lock, and nothing else";
  }

  const TemporaryDirectory directory_;
  const std::string state_ = directory_ / "state.json";
  SimulatedBackEnd processor_{state_};
  std::string file_;
  std::string old_;  // what it reads as, before and after
  std::string changed_;
};

TEST_F(StateFaultsTest, AKillAtAnySystemCallLeavesTheOldStateOrTheNewOne) {
  unsigned oldStates = 0;
  unsigned newStates = 0;
  unsigned calls = 0;
  // Until a change makes fewer calls and ends by itself: the pause after a lock is left out where it is over already.
  while (changeWith(Intervention{calls + 1, std::nullopt}).killed) {
    SCOPED_TRACE("killed at system call " + std::to_string(++calls));
    ++(read() == old_ ? oldStates : newStates);
    expectOldOrNewAndANextWriterThatWorks();
  }
  EXPECT_GT(oldStates, 0u);
  EXPECT_GT(newStates, 0u);
  std::cout << calls << " system calls; " << oldStates << " kills left the old state, " << newStates
            << " the new one\n";
}

TEST_F(StateFaultsTest, AFailureOfAnySystemCallIsToldOrDoesNotMatter) {
  const auto calls = static_cast<unsigned>(changeWith(std::nullopt).calls.size());
  unsigned done = 0;
  unsigned failed = 0;
  for (const int error : {EIO, ENOSPC, EINTR}) {
    for (unsigned call = 1; call <= calls; ++call) {
      SCOPED_TRACE(std::string(::strerrorname_np(error)) + " of system call " + std::to_string(call));
      const auto outcome = changeWith(Intervention{call, error});
      ++(outcome.failure ? failed : done);
      if (!outcome.failure) {
        EXPECT_EQ(read(), changed_) << "it was said to be done";
      } else {
        const bool saysSo = outcome.failure->find("is replaced") != std::string::npos;
        EXPECT_EQ(read(), saysSo ? changed_ : old_) << *outcome.failure;
      }
      expectOldOrNewAndANextWriterThatWorks();
    }
  }
  EXPECT_GT(failed, 0u);
  std::cout << done + failed << " failures of system calls; " << failed << " changes failed, " << done
            << " were done all the same\n";
}

// "STEP PATH" for what brings a text to the disk, the same steps in a row as one.
std::vector<std::string> stepsOf(const std::vector<SystemCall>& calls) {
  const std::map<long, std::string> ofDescriptors = {{SYS_write, "write "}, {SYS_fsync, "fsync "}};
  std::map<std::uint64_t, std::string> open;
  std::vector<std::string> steps;
  for (const SystemCall& call : calls) {
    const auto step = ofDescriptors.find(call.number);
    if (call.number == SYS_openat && call.result >= 0) {
      open[static_cast<std::uint64_t>(call.result)] = call.path;
    } else if (call.number == SYS_rename && call.result == 0) {
      steps.push_back("rename " + call.path);
    } else if (step != ofDescriptors.end()) {
      steps.push_back(step->second + open[call.arguments[0]]);
    }
  }
  steps.erase(std::unique(steps.begin(), steps.end()), steps.end());
  return steps;
}

// What a power cut leaves is what the disk was made to take until then, and in no other order.
TEST_F(StateFaultsTest, TheTextIsOnTheDiskBeforeItsNameAndTheNameBeforeItIsSaidToBeDone) {
  EXPECT_THAT(stepsOf(changeWith(std::nullopt).calls),
              testing::ElementsAre("write " + state_ + ".new", "fsync " + state_ + ".new", "rename " + state_,
                                   "fsync " + directory_.path().string()));
}

}  // namespace
