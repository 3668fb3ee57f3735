#include "tests/e2e/support/CompositeStack.h"

#include <gtest/gtest.h>

#include <fstream>
#include <iterator>
#include <sstream>

namespace Testing {
std::string contentOf(const std::filesystem::path& file) {
  std::ifstream stream(file, std::ios::binary);
  return {std::istreambuf_iterator<char>(stream), {}};
}

CompositeStack::CompositeStack(const std::string& processor, int logThreshold) {
  const std::string ini = "[system]\nname = managed.example\n[log]\ndestination = file\nfile = " +
                          (directory_.path() / "agent.log").string() + "\nthreshold = " + std::to_string(logThreshold) +
                          "\n" + processor;
  cimomd_ =
      std::make_unique<Cimomd>(options(), Environment{{"QV_AGENT_INI", directory_.write("agent.ini", ini).string()}});
}

std::vector<std::string> CompositeStack::options() {
  return {"--schema",       BINARY_DIR "/share/cimomd",
          "--registration", BINARY_DIR "/share/cimomd/CompositeIPConfig.reg",
          "--registration", BINARY_DIR "/share/cimomd/UnderlyingIPConfig.reg",
          "--provider-dir", BINARY_DIR "/lib"};
}

Completed CompositeStack::wbemcli(const std::string& operation, const std::string& object,
                                  const std::vector<std::string>& more, const std::string& nameSpace) const {
  std::vector<std::string> command = {"wbemcli"};
  std::istringstream words(operation);
  for (std::string word; words >> word;) command.push_back(word);
  command.push_back(url(object, nameSpace));
  command.insert(command.end(), more.begin(), more.end());
  return run(command);
}

std::vector<std::string> CompositeStack::paths(const std::string& operation, const std::string& object,
                                               const std::string& nameSpace) const {
  const Completed completed = wbemcli(operation, object, {}, nameSpace);
  EXPECT_EQ(completed.status, 0) << operation << ' ' << object << '\n' << completed.errors;
  return linesOf(completed.output);
}

std::vector<std::string> CompositeStack::names(const std::string& operation, const std::string& object,
                                               const std::string& nameSpace) const {
  std::vector<std::string> names = paths(operation, object, nameSpace);
  for (std::string& name : names) name = objectOf(name);
  return names;
}

std::vector<Printed> CompositeStack::instances(const std::string& operation, const std::string& object,
                                               const std::string& properties, const std::string& nameSpace) const {
  const std::vector<std::string> more = properties.empty() ? std::vector<std::string>{} : std::vector{properties};
  const Completed completed = wbemcli(operation + " -nl", object, more, nameSpace);
  EXPECT_EQ(completed.status, 0) << operation << ' ' << object << '\n' << completed.errors;
  return instancesOf(completed.output);
}

std::map<std::string, std::string> CompositeStack::get(const std::string& object, const std::string& nameSpace) const {
  const std::vector<Printed> found = instances("gi", object, {}, nameSpace);
  EXPECT_EQ(found.size(), 1U) << object;
  return found.empty() ? std::map<std::string, std::string>{} : found.front().values;
}

void CompositeStack::modify(const std::string& object, const std::string& values) const {
  const Completed completed = wbemcli("mi", object, {values});
  EXPECT_EQ(completed.status, 0) << object << ' ' << values << '\n' << completed.errors;
}

std::string CompositeStack::failure(const std::string& operation, const std::string& object,
                                    const std::vector<std::string>& more, const std::string& nameSpace) const {
  const Completed completed = wbemcli(operation, object, more, nameSpace);
  EXPECT_NE(completed.status, 0) << operation << ' ' << object << '\n' << completed.output;
  return completed.errors;
}

std::string CompositeStack::log() const { return contentOf(directory_.path() / "agent.log"); }

std::string simulatedProcessor(const std::filesystem::path& state) {
  return "[processor]\nbackend = simulated\n[simulated]\nstate = " + state.string() + "\n";
}

}  // namespace Testing
