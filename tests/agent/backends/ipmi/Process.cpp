#include "tests/agent/backends/ipmi/Process.h"

#include <fcntl.h>
#include <signal.h>
#include <spawn.h>
#include <sys/wait.h>
#include <unistd.h>

#include <array>
#include <stdexcept>

extern char** environ;

namespace IpmiFixture {
namespace {

std::array<int, 2> openPipe() {
  std::array<int, 2> ends;
  if (::pipe2(ends.data(), O_CLOEXEC) != 0) {
    throw std::runtime_error("no pipe");
  }
  return ends;
}

}  // namespace

Process::Process(const std::vector<std::string>& command) {
  const auto input = openPipe();
  const auto output = openPipe();
  std::vector<char*> arguments;
  for (const std::string& word : command) {
    arguments.push_back(const_cast<char*>(word.c_str()));
  }
  arguments.push_back(nullptr);
  posix_spawn_file_actions_t actions;
  ::posix_spawn_file_actions_init(&actions);
  ::posix_spawn_file_actions_adddup2(&actions, input[0], STDIN_FILENO);
  ::posix_spawn_file_actions_adddup2(&actions, output[1], STDOUT_FILENO);
  const int error = ::posix_spawnp(&id_, arguments[0], &actions, nullptr, arguments.data(), environ);
  ::posix_spawn_file_actions_destroy(&actions);
  ::close(input[0]);
  ::close(output[1]);
  input_ = input[1];
  output_ = output[0];
  if (error != 0) {
    throw std::runtime_error(command.front() + " cannot be started");
  }
}

Process::~Process() {
  ::close(input_);
  ::kill(id_, SIGTERM);
  ::waitpid(id_, nullptr, 0);
  ::close(output_);
}

void Process::writeLine(const std::string& line) {
  const std::string text = line + '\n';
  if (::write(input_, text.data(), text.size()) != static_cast<ssize_t>(text.size())) {
    throw std::runtime_error("the program does not take its input");
  }
}

std::string Process::readLine() {
  std::string line;
  for (char next = 0; ::read(output_, &next, 1) == 1 && next != '\n';) {
    line.push_back(next);
  }
  return line;
}

std::string Process::readAll() {
  std::string text;
  std::array<char, 4096> part;
  for (ssize_t length = 0; (length = ::read(output_, part.data(), part.size())) > 0;) {
    text.append(part.data(), static_cast<std::size_t>(length));
  }
  return text;
}

std::string outputOf(const std::vector<std::string>& command) { return Process(command).readAll(); }

}  // namespace IpmiFixture
