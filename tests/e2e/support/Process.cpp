#include "tests/e2e/support/Process.h"

#include <fcntl.h>
#include <signal.h>
#include <spawn.h>
#include <sys/wait.h>

#include <fstream>
#include <iterator>
#include <stdexcept>
#include <system_error>
#include <thread>

#include "tests/e2e/support/Poll.h"

namespace Testing {
namespace {

std::string contentOf(const std::filesystem::path& file) {
  std::ifstream stream(file, std::ios::binary);
  return {std::istreambuf_iterator<char>(stream), {}};
}

std::vector<char*> pointersTo(std::vector<std::string>& texts) {
  std::vector<char*> pointers;
  for (std::string& text : texts) pointers.push_back(text.data());
  pointers.push_back(nullptr);
  return pointers;
}

std::vector<std::string> environmentWith(const Environment& added) {
  std::vector<std::string> entries;
  for (char** entry = environ; *entry; ++entry)
    if (!added.contains(std::string(*entry).substr(0, std::string(*entry).find('=')))) entries.emplace_back(*entry);
  for (const auto& [name, value] : added) entries.push_back(name + "=" + value);
  return entries;
}

// What the program starts with: its output into files, and no signal blocked that the test's own threads may block.
class SpawnSettings {
 public:
  explicit SpawnSettings(const std::filesystem::path& directory) {
    posix_spawn_file_actions_init(&actions);
    posix_spawnattr_init(&attributes);
    redirect(1, directory / "output");
    redirect(2, directory / "errors");
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
  std::vector<std::string> arguments = command;
  std::vector<std::string> entries = environmentWith(environment);
  const SpawnSettings settings(directory_.path());
  const int error = posix_spawnp(&id_, name_.c_str(), &settings.actions, &settings.attributes,
                                 pointersTo(arguments).data(), pointersTo(entries).data());
  if (error != 0) throw std::system_error(error, std::generic_category(), name_);
}

Process::~Process() {
  if (!isRunning()) return;
  kill(id_, SIGKILL);
  waitpid(id_, nullptr, 0);
}

void Process::signal(int number) const { kill(id_, number); }

bool Process::isRunning() {
  int state = 0;
  if (status_ < 0 && waitpid(id_, &state, WNOHANG) == id_)
    status_ = WIFEXITED(state) ? WEXITSTATUS(state) : 128 + WTERMSIG(state);
  return status_ < 0;
}

int Process::wait(std::chrono::seconds patience) {
  if (!poll([this] { return !isRunning(); }, patience)) throw std::runtime_error(name_ + " does not end: " + errors());
  return status_;
}

std::string Process::output() const { return contentOf(directory_.path() / "output"); }

std::string Process::errors() const { return contentOf(directory_.path() / "errors"); }

Completed run(const std::vector<std::string>& command, const Environment& environment) {
  Process process(command, environment);
  const int status = process.wait();
  return {status, process.output(), process.errors()};
}

}  // namespace Testing
