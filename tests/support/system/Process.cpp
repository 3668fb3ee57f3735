// SPDX-License-Identifier: Apache-2.0
#include "tests/support/system/Process.h"

#include <fcntl.h>
#include <signal.h>
#include <spawn.h>
#include <sys/wait.h>
#include <unistd.h>

#include <array>
#include <cerrno>
#include <fstream>
#include <iterator>
#include <stdexcept>
#include <system_error>
#include <thread>

#include "tests/support/system/Poll.h"

namespace Testing {
namespace {

std::vector<char*> pointersTo(std::vector<std::string>& texts) {
  std::vector<char*> pointers;
  for (std::string& text : texts) {
    pointers.push_back(text.data());
  }
  pointers.push_back(nullptr);
  return pointers;
}

std::vector<std::string> environmentWith(const Environment& added) {
  std::vector<std::string> entries;
  for (char** entry = environ; *entry; ++entry) {
    if (!added.contains(std::string(*entry).substr(0, std::string(*entry).find('=')))) {
      entries.emplace_back(*entry);
    }
  }
  for (const auto& [name, value] : added) {
    entries.push_back(name + "=" + value);
  }
  return entries;
}

// What the program starts with: its input from a pipe, its output into files, and no signal blocked that the test's own
// threads may block.
class SpawnSettings {
 public:
  SpawnSettings(const std::filesystem::path& directory, int input) {
    posix_spawn_file_actions_init(&actions);
    posix_spawnattr_init(&attributes);
    posix_spawn_file_actions_adddup2(&actions, input, STDIN_FILENO);
    redirect(STDOUT_FILENO, directory / "output");
    redirect(STDERR_FILENO, directory / "errors");
    sigset_t none;
    sigemptyset(&none);
    posix_spawnattr_setsigmask(&attributes, &none);
    posix_spawnattr_setflags(&attributes, POSIX_SPAWN_SETSIGMASK);
  }
  ~SpawnSettings() {
    posix_spawnattr_destroy(&attributes);
    posix_spawn_file_actions_destroy(&actions);
  }
  SpawnSettings(const SpawnSettings&) = delete;
  SpawnSettings& operator=(const SpawnSettings&) = delete;

  posix_spawn_file_actions_t actions{};
  posix_spawnattr_t attributes{};

 private:
  void redirect(int descriptor, const std::filesystem::path& file) {
    posix_spawn_file_actions_addopen(&actions, descriptor, file.c_str(), O_CREAT | O_WRONLY | O_APPEND, 0600);
  }
};

}  // namespace

Process::Process(const std::vector<std::string>& command, const Environment& environment) : name_(command.at(0)) {
  std::array<int, 2> ends{};
  if (::pipe2(ends.data(), O_CLOEXEC) != 0) {
    throw std::system_error(errno, std::generic_category(), "pipe");
  }
  const Ground::Descriptor programsEnd(ends[0]);
  input_ = Ground::Descriptor(ends[1]);
  std::vector<std::string> arguments = command;
  std::vector<std::string> entries = environmentWith(environment);
  const SpawnSettings settings(directory_.path(), programsEnd.number());
  const int error = posix_spawnp(&id_, name_.c_str(), &settings.actions, &settings.attributes,
                                 pointersTo(arguments).data(), pointersTo(entries).data());
  if (error != 0) {
    throw std::system_error(error, std::generic_category(), name_);
  }
}

Process::~Process() {
  if (isRunning()) {
    kill(id_, SIGKILL);
    waitpid(id_, nullptr, 0);
  }
}

void Process::signal(int number) const { kill(id_, number); }

void Process::signalGroup(int number) const { kill(-id_, number); }

bool Process::isRunning() {
  int state = 0;
  if (status_ < 0 && waitpid(id_, &state, WNOHANG) == id_) {
    status_ = WIFEXITED(state) ? WEXITSTATUS(state) : 128 + WTERMSIG(state);
  }
  return status_ < 0;
}

int Process::wait(std::chrono::seconds patience) {
  if (!poll([this] { return !isRunning(); }, patience)) {
    throw std::runtime_error(name_ + " does not end: " + errors());
  }
  return status_;
}

void Process::writeLine(const std::string& line) const {
  const std::string text = line + '\n';
  if (::write(input_.number(), text.data(), text.size()) != static_cast<ssize_t>(text.size())) {
    throw std::runtime_error(name_ + " does not take its input");
  }
}

void Process::closeInput() { input_ = Ground::Descriptor(); }

std::string Process::readLine() {
  std::string written;
  std::size_t end = std::string::npos;
  const bool answered = poll([&] {
    // Asked first: what the program wrote before it ended is then in the file.
    const bool running = isRunning();
    written = output();
    end = written.find('\n', read_);
    return end != std::string::npos || !running;
  });
  if (!answered) {
    throw std::runtime_error(name_ + " writes no line: " + errors());
  }
  const std::string line = written.substr(read_, end == std::string::npos ? end : end - read_);
  read_ = end == std::string::npos ? written.size() : end + 1;
  return line;
}

std::string Process::output() const { return readFile(directory_ / "output"); }

std::string Process::errors() const { return readFile(directory_ / "errors"); }

Completed run(const std::vector<std::string>& command, const Environment& environment, std::chrono::seconds patience) {
  Process process(command, environment);
  process.closeInput();
  const int status = process.wait(patience);
  return {status, process.output(), process.errors()};
}

}  // namespace Testing
