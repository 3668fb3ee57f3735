#include <QV/ProviderHelper.h>
#include <gtest/gtest.h>

#include "ground/HostName.h"
#include "tests/support/system/TemporaryDirectory.h"

namespace {

using namespace QV;
using namespace Testing;

// agent.ini is read once in a process: each case asks in a child.
void expectSystemName(const std::string& iniText, const std::string& expected) {
  const TemporaryDirectory directory;
  writeFile(directory / "agent.ini", iniText);
  ::setenv("QV_AGENT_INI", (directory / "agent.ini").c_str(), 1);
  EXPECT_EXIT(std::exit(getSystemName() == expected ? 0 : 1), testing::ExitedWithCode(0), "");
  ::unsetenv("QV_AGENT_INI");
}

TEST(SystemNameTest, IsTheConfiguredOne) { expectSystemName("[system]\nname = managed.example\n", "managed.example"); }

TEST(SystemNameTest, IsTheHostNameWithoutAConfiguredOne) { expectSystemName("", Ground::hostName()); }

TEST(SystemNameTest, IsTheHostNameWhereAgentIniIsBroken) {
  expectSystemName("[nowhere]\nname = x\n", Ground::hostName());
}

TEST(SystemNameTest, IsTheHostNameWithoutAgentIni) {
  ::setenv("QV_AGENT_INI", "/nowhere/agent.ini", 1);
  EXPECT_EXIT(std::exit(getSystemName() == Ground::hostName() ? 0 : 1), testing::ExitedWithCode(0), "");
  ::unsetenv("QV_AGENT_INI");
}

}  // namespace
