#include <QV/ProviderHelper.h>
#include <gtest/gtest.h>
#include <unistd.h>

#include <array>

#include "tests/support/TemporaryDirectory.h"

namespace QV {
namespace {

// agent.ini is read once in a process: each case asks in a child.
void expectSystemName(const std::string& iniText, const std::string& expected) {
  const Testing::TemporaryDirectory directory;
  Testing::writeFile(directory / "agent.ini", iniText);
  ::setenv("QV_AGENT_INI", (directory / "agent.ini").c_str(), 1);
  EXPECT_EXIT(std::exit(getSystemName() == expected ? 0 : 1), testing::ExitedWithCode(0), "");
  ::unsetenv("QV_AGENT_INI");
}

std::string hostName() {
  std::array<char, 256> name{};
  ::gethostname(name.data(), name.size() - 1);
  return name.data();
}

TEST(SystemName, isTheConfiguredOne) { expectSystemName("[system]\nname = managed.example\n", "managed.example"); }

TEST(SystemName, isTheHostNameWithoutAConfiguredOne) { expectSystemName("", hostName()); }

TEST(SystemName, IsTheHostNameWithoutAgentIni) {
  ::setenv("QV_AGENT_INI", "/nowhere/agent.ini", 1);
  EXPECT_EXIT(std::exit(getSystemName() == hostName() ? 0 : 1), testing::ExitedWithCode(0), "");
  ::unsetenv("QV_AGENT_INI");
}

TEST(SystemName, isTheHostNameWhereAgentIniIsBroken) { expectSystemName("[nowhere]\nname = x\n", hostName()); }

}  // namespace
}  // namespace QV
