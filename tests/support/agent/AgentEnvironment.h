// An agent of its own for a test program: an agent.ini whose simulated processor, log and trace lie in a temporary
// directory, which shows the host, too, and whose log does not say once in a process that the processor is simulated.
// The agent's libraries read agent.ini once in a process, so it is put in place before the first test.
#pragma once

#include <gtest/gtest.h>

#include <filesystem>
#include <memory>
#include <string>

#include "tests/support/system/TemporaryDirectory.h"

namespace Testing {

class AgentEnvironment : public testing::Environment {
 public:
  static AgentEnvironment& instance() {
    static auto* environment = new AgentEnvironment;
    return *environment;
  }

  void SetUp() override {
    directory_ = std::make_unique<TemporaryDirectory>();
    const std::string ini = *directory_ / "agent.ini";
    writeFile(
        ini, "[system]\nname = managed.example\n[log]\ndestination = file\nfile = " + log() +
                 "\nthreshold.Tarnwick.SimulatedProcessor = 7000" + "\n[trace]\ndestination = file\nfile = " + trace() +
                 "\n[host]\npublish = yes\n[processor]\nbackend = simulated\n[simulated]\nstate = " + state() + "\n");
    ::setenv("QV_AGENT_INI", ini.c_str(), 1);
  }

  void TearDown() override { directory_.reset(); }

  std::string state() const { return *directory_ / "processor.json"; }
  std::string log() const { return *directory_ / "agent.log"; }
  std::string trace() const { return *directory_ / "agent.trace"; }

  // The factory configuration, an empty log and an empty trace again.
  void reset() const {
    std::filesystem::remove(state());
    for (const std::string& file : {log(), trace()}) {
      if (std::filesystem::exists(file)) {
        std::filesystem::resize_file(file, 0);
      }
    }
  }

 private:
  std::unique_ptr<TemporaryDirectory> directory_;
};

}  // namespace Testing
