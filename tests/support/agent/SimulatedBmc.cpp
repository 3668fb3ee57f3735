// SPDX-License-Identifier: Apache-2.0
#include "tests/support/agent/SimulatedBmc.h"

#include <signal.h>

#include <sstream>
#include <stdexcept>

#include "Paths.h"
#include "tests/support/system/TemporaryDirectory.h"

namespace Testing {
namespace {

namespace fs = std::filesystem;

// The value of "label<blanks>separator<blanks>value".
std::string valueOf(const std::string& text, const std::string& label, char separator) {
  std::istringstream lines(text);
  for (std::string line; std::getline(lines, line);) {
    const auto end = line.find(separator);
    if (end == std::string::npos) {
      continue;
    }
    const auto labelEnd = line.find_last_not_of(" \t", end - 1);
    if (line.substr(0, labelEnd + 1) != label) {
      continue;
    }
    const auto start = line.find_first_not_of(" \t", end + 1);
    return start == std::string::npos ? "" : line.substr(start);
  }
  return "(there is no " + label + ")";
}

}  // namespace

SimulatedBmc::SimulatedBmc(Personality personality) : personality_(personality) {
  writePrivateFile(directory_ / "password", "test\n");
  start();
}

SimulatedBmc::~SimulatedBmc() { stop(); }

void SimulatedBmc::start() {
  std::vector<std::string> command = {SOURCE_DIR "/tools/ipmi-sim-bmc"};
  if (port_ != 0) {
    command.insert(command.end(), {"-p", std::to_string(port_)});
  }
  if (personality_ == Personality::AppliesAtOnce) {
    command.push_back("-m");
  }
  command.push_back(directory_.path());
  process_ = std::make_unique<Process>(command);
  const std::string address = process_->readLine();
  const auto colon = address.find(':');
  if (colon == std::string::npos) {
    throw std::runtime_error("the simulated BMC does not start");
  }
  port_ = static_cast<std::uint16_t>(std::stoi(address.substr(colon + 1)));
}

QV::BackEndSettings SimulatedBmc::settings(std::uint16_t port) const {
  return {{"connection", "lan"}, {"operation_timeout", "30"},
          {"host", "127.0.0.1"}, {"port", std::to_string(port != 0 ? port : port_)},
          {"user", "admin"},     {"password_file", directory_ / "password"},
          {"cipher_suite", "3"}, {"workarounds", "opensesspriv"},
          {"cache", "0"},        {"generation_file", generationFile()}};
}

QV::BackEndSettings SimulatedBmc::patientSettings(std::uint16_t port) const {
  auto patient = settings(port);
  patient["operation_timeout"] = "60";
  patient["retransmission_timeout"] = "10";
  return patient;
}

std::string SimulatedBmc::ipmitool(const std::vector<std::string>& command) const {
  std::vector<std::string> full = {"ipmitool", "-I",    "lanplus", "-H",   "127.0.0.1", "-p", std::to_string(port_),
                                   "-U",       "admin", "-P",      "test", "-C",        "3"};
  full.insert(full.end(), command.begin(), command.end());
  return run(full, {{"HOME", directory_ / "home"}}).output;
}

std::string SimulatedBmc::witness(const std::string& label) const {
  return valueOf(ipmitool({"lan", "print", "1"}), label, ':');
}

void SimulatedBmc::hook(const std::string& step, const std::string& script) const {
  const std::string path = directory_ / ("on-" + step);
  // Renamed into its place: the simulator may be about to run it.
  writeFile(path + ".new", "#!/bin/sh\n" + script + '\n');
  fs::permissions(path + ".new", fs::perms::owner_all);
  fs::rename(path + ".new", path);
}

void SimulatedBmc::removeHook(const std::string& step) const { fs::remove(directory_ / ("on-" + step)); }

std::string SimulatedBmc::stored(const std::string& key) const {
  return valueOf(readFile(directory_ / "lan.state"), key, '=');
}

pid_t SimulatedBmc::simulator() const { return std::stoi(readFile(directory_ / "pid")); }

void SimulatedBmc::halt() const { ::kill(simulator(), SIGSTOP); }
void SimulatedBmc::resume() const { ::kill(simulator(), SIGCONT); }

void SimulatedBmc::kill() {
  ::kill(simulator(), SIGKILL);
  stop();
}

// A simulator that is killed cannot stop what it has started itself.
void SimulatedBmc::stop() {
  if (process_) {
    process_->closeInput();
    process_->wait();
    process_.reset();
  }
}

void SimulatedBmc::restart() {
  stop();
  start();
}

}  // namespace Testing
