// Processes that share a state file: killed in the middle of their work, and side by side.
#include <fcntl.h>
#include <gtest/gtest.h>
#include <signal.h>
#include <spawn.h>
#include <sys/wait.h>
#include <unistd.h>

#include <array>
#include <random>
#include <stdexcept>
#include <vector>

#include "agent/backends/simulated/SimulatedBackEnd.h"
#include "tests/agent/support/Addresses.h"
#include "tests/support/TemporaryDirectory.h"

namespace QV {
namespace {

// A state_writer of its own process; killed with the object where it still runs.
class Writer {
 public:
  Writer(const std::string& state, const std::string& interface, const std::string& network, int changes) {
    std::array<int, 2> pipe{};
    if (::pipe2(pipe.data(), O_CLOEXEC) != 0) {
      throw std::runtime_error("no pipe can be made");
    }
    output_ = pipe[0];
    posix_spawn_file_actions_t actions;
    ::posix_spawn_file_actions_init(&actions);
    ::posix_spawn_file_actions_adddup2(&actions, pipe[1], STDOUT_FILENO);
    std::vector<std::string> words = {STATE_WRITER, state, interface, network, std::to_string(changes)};
    std::vector<char*> arguments;
    for (std::string& word : words) {
      arguments.push_back(word.data());
    }
    arguments.push_back(nullptr);
    const int error = ::posix_spawn(&process_, STATE_WRITER, &actions, nullptr, arguments.data(), environ);
    ::posix_spawn_file_actions_destroy(&actions);
    ::close(pipe[1]);
    if (error != 0) {
      throw std::runtime_error("the writer cannot be started");
    }
  }
  ~Writer() {
    if (process_ > 0) {
      kill();
    }
    ::close(output_);
  }
  Writer(const Writer&) = delete;
  Writer& operator=(const Writer&) = delete;

  // Returns when the writer is about to make its first change.
  void awaitStart() const {
    char dot = 0;
    EXPECT_EQ(::read(output_, &dot, 1), 1);
  }

  void kill() {
    ::kill(process_, SIGKILL);
    await();
  }

  int await() {
    int status = 0;
    ::waitpid(process_, &status, 0);
    process_ = 0;
    return status;
  }

 private:
  pid_t process_ = 0;
  int output_ = -1;
};

TEST(StateWriters, thatAreKilledAtAnyMomentLeaveTheOldStateOrTheNewOne) {
  const Testing::TemporaryDirectory directory;
  const std::string state = directory / "state.json";
  SimulatedBackEnd processor(state);
  processor.change("eth0", {ipv4("192.0.2.1"), mask("255.255.255.0")});
  std::mt19937 random(20);
  std::uniform_int_distribution<int> microseconds(0, 1500);
  int interrupted = 0;
  for (int kills = 0; kills < 1000; ++kills) {
    // When a writer is killed somewhere in its work
    Writer writer(state, "eth0", "192.0.2", 0);
    writer.awaitStart();
    ::usleep(static_cast<useconds_t>(microseconds(random)));
    writer.kill();
    interrupted += std::filesystem::exists(state + ".new") ? 1 : 0;

    // Then the state is one of the two that it writes, whole
    const NetworkInterface interface = processor.read().interfaces.at(0);
    ASSERT_TRUE((interface.ipv4Address == ipv4("192.0.2.1") && interface.ipv4SubnetMask == mask("255.255.255.0")) ||
                (interface.ipv4Address == ipv4("192.0.2.2") && interface.ipv4SubnetMask == mask("255.255.0.0")))
        << Testing::readFile(state);
  }
  EXPECT_GT(interrupted, 0) << "no kill met a writer between its first byte and its last step";

  // And the next change works and sweeps up
  processor.change("eth0", {ipv4("192.0.2.3"), {}});
  EXPECT_EQ(processor.read().interfaces.at(0).ipv4Address, ipv4("192.0.2.3"));
  EXPECT_FALSE(std::filesystem::exists(state + ".new"));
}

TEST(StateWriters, areSeenByTheNextReadOfAProcessThatHasReadBefore) {
  const Testing::TemporaryDirectory directory;
  const std::string state = directory / "state.json";
  SimulatedBackEnd processor(state);
  ASSERT_EQ(processor.read().interfaces.at(0).ipv4Address, ipv4("192.0.2.10"));

  EXPECT_EQ(Writer(state, "eth0", "192.0.2", 1).await(), 0);

  EXPECT_EQ(processor.read().interfaces.at(0).ipv4Address, ipv4("192.0.2.1"));
}

TEST(StateWriters, thatRunAtOnceLoseNothing) {
  const Testing::TemporaryDirectory directory;
  const std::string state = directory / "state.json";
  Writer first(state, "eth0", "192.0.2", 300);
  Writer second(state, "eth1", "198.51.100", 300);
  EXPECT_EQ(first.await(), 0);
  EXPECT_EQ(second.await(), 0);
  const auto interfaces = SimulatedBackEnd(state).read().interfaces;
  EXPECT_EQ(interfaces.at(0).ipv4Address, ipv4("192.0.2.2"));
  EXPECT_EQ(interfaces.at(0).ipv4SubnetMask, mask("255.255.0.0"));
  EXPECT_EQ(interfaces.at(1).ipv4Address, ipv4("198.51.100.2"));
  EXPECT_EQ(interfaces.at(1).ipv4SubnetMask, mask("255.255.0.0"));
}

}  // namespace
}  // namespace QV
