// SPDX-License-Identifier: Apache-2.0
#include "tests/hosts/ObjectManager.h"

#include <arpa/inet.h>
#include <netinet/in.h>
#include <signal.h>
#include <sys/socket.h>
#include <unistd.h>

#include <cstdlib>
#include <filesystem>
#include <stdexcept>

#include "Paths.h"
#include "tests/hosts/HostProcesses.h"
#include "tests/hosts/OpenPegasus.h"
#include "tests/hosts/Sfcb.h"
#include "tests/support/client/CompositeStack.h"
#include "tests/support/system/Build.h"
#include "tests/support/system/Poll.h"
#include "tests/support/system/TemporaryDirectory.h"

namespace Testing {
namespace {

namespace fs = std::filesystem;

constexpr const char* agentIni = CONFIGURATION_DIR "/agent.ini";
constexpr const char* agentLog = "/var/tmp/agent.log";
constexpr const char* shared = INSTALL_PREFIX "/share/compositeipconfig";

// A TCP socket of 127.0.0.1; port 0 takes a free one.
class LoopbackSocket {
 public:
  explicit LoopbackSocket(std::uint16_t port) : descriptor_(::socket(AF_INET, SOCK_STREAM | SOCK_CLOEXEC, 0)) {
    address_.sin_family = AF_INET;
    address_.sin_port = htons(port);
    address_.sin_addr.s_addr = htonl(INADDR_LOOPBACK);
  }
  ~LoopbackSocket() { ::close(descriptor_); }
  LoopbackSocket(const LoopbackSocket&) = delete;
  LoopbackSocket& operator=(const LoopbackSocket&) = delete;

  bool connects() const { return ::connect(descriptor_, address(), sizeof address_) == 0; }

  std::uint16_t bind() {
    socklen_t size = sizeof address_;
    ::bind(descriptor_, address(), size);
    ::getsockname(descriptor_, reinterpret_cast<sockaddr*>(&address_), &size);
    return ntohs(address_.sin_port);
  }

 private:
  const sockaddr* address() const { return reinterpret_cast<const sockaddr*>(&address_); }

  const int descriptor_;
  sockaddr_in address_{};
};

std::string replaced(std::string text, const std::string& part, const std::string& by) {
  for (std::size_t at = 0; (at = text.find(part, at)) != std::string::npos; at += by.size()) {
    text.replace(at, part.size(), by);
  }
  return text;
}

}  // namespace

std::unique_ptr<ObjectManager> ObjectManager::find(const std::string& name, int processes) {
  const std::string variable = variableOf(name);
  const char* prefix = std::getenv(variable.c_str());
  if (!prefix) {
    return nullptr;
  }
  if (name == "sfcb") {
    return std::make_unique<Sfcb>(prefix, processes);
  }
  return std::make_unique<OpenPegasus>(prefix, processes);
}

std::string ObjectManager::variableOf(const std::string& name) {
  if (name == "sfcb") {
    return "HOSTS_SFCB";
  }
  if (name == "openpegasus") {
    return "HOSTS_PEGASUS";
  }
  throw std::invalid_argument("no object manager is called " + name + " here: sfcb or openpegasus");
}

ObjectManager::ObjectManager(std::string prefix, int processes)
    : prefix_(std::move(prefix)), processes_(processes), port_(LoopbackSocket(0).bind()) {}

std::string ObjectManager::missing() const {
  for (const std::string& part : parts()) {
    if (!fs::exists(fs::path(prefix_) / part)) {
      return prefix_ + " has no " + part + ": name the prefix that " + title() + " was installed to";
    }
  }
  if (Testing::run({"sh", "-c", "command -v wbemcli"}).status != 0) {
    return "wbemcli is not there: install the package sblim-wbemcli";
  }
  for (const char* file : {"cmake_install.cmake", "lib/libcompositeipconfigprovider.so.1",
                           "lib/libunderlyingipconfigprovider.so.1", "lib/libqvinstrumentation.so.1"}) {
    if (!fs::exists(built(file))) {
      return built(file) + " is not there: build the project first";
    }
  }
  return {};
}

Environment ObjectManager::environment() const {
  const char* path = std::getenv("PATH");
  return {{"PATH", prefix_ + "/bin:" + prefix_ + "/sbin:" + (path ? path : "/usr/sbin:/usr/bin:/sbin:/bin")}};
}

std::map<std::string, std::string> ObjectManager::differences() const {
  return {{"build/default", buildDirectory()},
          {"/etc/compositeipconfig", CONFIGURATION_DIR},
          {"/usr/local", INSTALL_PREFIX},
          {":5988", ":" + std::to_string(port_)}};
}

std::string ObjectManager::run(const std::string& commands) const {
  Process shell({"sh", "-euc", "cd '" SOURCE_DIR "'\n" + commands}, environment());
  shell.closeInput();
  const int status = shell.wait(std::chrono::seconds(120));
  const std::string said = shell.output() + shell.errors();
  if (status != 0) {
    throw std::runtime_error("status " + std::to_string(status) + " of\n" + commands + '\n' + said);
  }
  return said;
}

std::string ObjectManager::carryOut(const std::string& step, const Edit& edit) const {
  std::string commands = guide_.commands(step);
  if (edit) {
    commands = edit(commands);
  }
  for (const auto& [text, here] : differences()) {
    commands = replaced(commands, text, here);
  }
  return run(commands);
}

void ObjectManager::install(const Edit& edit) {
  if (!prepared_) {
    prepare();
  }
  prepared_ = true;
  carryOutAll(installing(), edit);
}

void ObjectManager::remove(const Edit& edit) { carryOutAll(removing(), edit); }

void ObjectManager::upgrade() { carryOutAll(upgrading(), {}); }

void ObjectManager::registerByCommand(const Edit& edit) { carryOutAll(registeringByCommand(), edit); }

void ObjectManager::takeOutByCommand() { carryOutAll(takingOutByCommand(), {}); }

// Comes back when what a step starts listens, and what it stops has ended.
void ObjectManager::carryOutAll(const std::vector<std::string>& steps, const Edit& edit) {
  for (const std::string& step : steps) {
    carryOut(step, edit);
    if (step == "install" && processes_ == 2) {
      registerSeparately();
    }
    if (step.ends_with(" stop")) {
      awaitEnd();
    }
    if (step.ends_with(" start")) {
      awaitListening();
    }
  }
}

// Without the group that both libraries are registered for, each gets a process.
void ObjectManager::registerSeparately() const {
  run("sed -i '/^ *group:/d' " + std::string(shared) + "/sfcb/*.reg\n" + "sed -i '/ModuleGroupName/d' " + shared +
      "/pegasus/*.peg.mof");
}

void ObjectManager::start(const Edit& edit) {
  carryOut(title() + " start", edit);
  awaitListening();
}

void ObjectManager::stop() {
  carryOut(title() + " stop");
  awaitEnd();
}

void ObjectManager::restart() {
  stop();
  start();
}

void ObjectManager::kill() {
  for (const pid_t process : processesRunning(programs())) {
    ::kill(process, SIGKILL);
  }
  awaitEnd();
}

bool ObjectManager::isListening() const { return LoopbackSocket(port_).connects(); }

void ObjectManager::awaitListening() const {
  if (!poll([this] { return isListening(); })) {
    throw std::runtime_error(title() + " does not listen on port " + std::to_string(port_));
  }
}

void ObjectManager::awaitEnd() const {
  if (!poll([this] { return processesRunning(programs()).empty(); })) {
    throw std::runtime_error(title() + " does not end");
  }
}

std::string ObjectManager::stateFile() { return "/var/lib/compositeipconfig/management-processor.json"; }

std::string ObjectManager::simulatedProcessor() { return Testing::simulatedProcessor(stateFile()); }

void ObjectManager::configureAgent(const std::string& processor, int logThreshold) const {
  fs::remove(agentLog);
  writeFile(agentIni, "[system]\nname = managed.example\n[log]\ndestination = file\nfile = " + std::string(agentLog) +
                          "\nthreshold = " + std::to_string(logThreshold) +
                          "\nthreshold.Tarnwick.SimulatedProcessor = 7000\n[host]\npublish = yes\n" + processor);
}

std::string ObjectManager::log() const { return readFile(agentLog); }

std::vector<pid_t> ObjectManager::providerProcesses(const std::string& library) {
  return processesMapping(library + "ipconfigprovider.so");
}

}  // namespace Testing
