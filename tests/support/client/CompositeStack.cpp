// SPDX-License-Identifier: Apache-2.0
#include "tests/support/client/CompositeStack.h"

#include <fstream>
#include <iterator>

#include "tests/support/system/Build.h"

namespace Testing {
std::string contentOf(const std::filesystem::path& file) {
  std::ifstream stream(file, std::ios::binary);
  return {std::istreambuf_iterator<char>(stream), {}};
}

CompositeStack::CompositeStack(const std::string& processor, int logThreshold, const std::vector<std::string>& more) {
  const std::string ini = "[system]\nname = managed.example\n[log]\ndestination = file\nfile = " +
                          (directory_.path() / "agent.log").string() + "\nthreshold = " + std::to_string(logThreshold) +
                          "\nthreshold.Tarnwick.SimulatedProcessor = 7000\n[host]\npublish = yes\n" + processor;
  std::vector<std::string> all = options();
  all.insert(all.end(), more.begin(), more.end());
  cimomd_ = std::make_unique<Cimomd>(all, Environment{{"QV_AGENT_INI", directory_.write("agent.ini", ini).string()}});
}

std::vector<std::string> CompositeStack::options() {
  return {"--schema",       built("share/cimomd"),
          "--registration", built("share/cimomd/CompositeIPConfig.reg"),
          "--registration", built("share/cimomd/UnderlyingIPConfig.reg"),
          "--provider-dir", built("lib")};
}

std::string CompositeStack::log() const { return contentOf(directory_.path() / "agent.log"); }

std::string simulatedProcessor(const std::filesystem::path& state) {
  return "[processor]\nbackend = simulated\n[simulated]\nstate = " + state.string() + "\n";
}

}  // namespace Testing
