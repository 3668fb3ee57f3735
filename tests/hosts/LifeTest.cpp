// What happens to a provider process in its life: it is left idle or disabled, killed, restarted, upgraded, removed.
#include <gmock/gmock.h>
#include <gtest/gtest.h>
#include <signal.h>

#include <algorithm>
#include <chrono>
#include <filesystem>
#include <map>
#include <stdexcept>

#include "tests/hosts/HostProcesses.h"
#include "tests/hosts/HostTest.h"
#include "tests/support/client/CompositeObjects.h"
#include "tests/support/client/FactoryState.h"
#include "tests/support/system/Poll.h"
#include "tests/support/system/TemporaryDirectory.h"

namespace {

using namespace Testing;
using testing::Contains;
using testing::HasSubstr;
using testing::IsEmpty;
using testing::Not;
using testing::SizeIs;
using testing::ThrowsMessage;

class HostLifeTest : public HostTest {
 protected:
  static void expectServing() {
    EXPECT_THAT(host().names("ein", Classes::clientAccess), SizeIs(6));
    EXPECT_EQ(host().get(endpoint("eth0")).at("IPv4Address"), quoted("192.0.2.10"));
  }

  static void expectNothingRegistered() {
    EXPECT_THAT(host().wbemcli("ecn", "").output, Not(HasSubstr("YRNx_")));
    for (const ClassCase& row : classCases()) {
      EXPECT_THAT(host().failure("ei", row.className), HasSubstr("(5) CIM_ERR_INVALID_CLASS")) << row.className;
    }
    for (const Enumeration& row : enumerations()) {
      EXPECT_THAT(host().failure("ei", row.association), HasSubstr("(5) CIM_ERR_INVALID_CLASS")) << row.association;
    }
    EXPECT_THAT(host().failure("ei", "YRNQV_IPProtocolEndpoint", {}, "root/yrnse"),
                HasSubstr("(3) CIM_ERR_INVALID_NAMESPACE"));
    EXPECT_THAT(ObjectManager::providerProcesses(), IsEmpty());
  }

  // Has the command register the composite classes in another namespace.
  static ObjectManager::Edit inNamespace(const std::string& nameSpace) {
    return [nameSpace](const std::string& commands) {
      const auto command = commands.find("compositeipconfig-register");
      return command == std::string::npos ? commands
                                          : commands.substr(0, commands.find('\n', command)) + " -n " + nameSpace;
    };
  }

  // Comes back when they are gone and whoever started them has seen it.
  static void killAll(const std::vector<pid_t>& processes) {
    for (const pid_t process : processes) {
      kill(process, SIGKILL);
    }
    EXPECT_TRUE(poll([&] {
      return std::none_of(processes.begin(), processes.end(), [](pid_t process) { return kill(process, 0) == 0; });
    }));
  }
};

TEST_F(HostLifeTest, GoesOnAfterTheProvidersWereUnloaded) {
  expectServing();
  ASSERT_TRUE(host().unloadProviders());
  host().allowProviders();
  expectServing();
  EXPECT_THAT(ObjectManager::providerProcesses(), SizeIs(host().processes()));
}

TEST_F(HostLifeTest, GoesOnAfterAProviderProcessWasKilled) {
  for (int i = 0; i < 3; ++i) {
    expectServing();
    const auto before = ObjectManager::providerProcesses();
    ASSERT_THAT(before, SizeIs(host().processes()));
    killAll(before);
    expectServing();
    for (const pid_t process : ObjectManager::providerProcesses()) {
      EXPECT_THAT(before, Not(Contains(process)));
    }
  }
}

TEST_F(HostLifeTest, GoesOnAfterAProviderProcessWasKilledDuringARequest) {
  // Given a request that the providers, halted, do not answer
  expectServing();
  const auto before = ObjectManager::providerProcesses();
  for (const pid_t process : before) {
    kill(process, SIGSTOP);
  }
  Process request({"wbemcli", "ein", host().url(Classes::clientAccess)});
  EXPECT_FALSE(poll([&] { return !request.isRunning(); }, std::chrono::milliseconds(500)));

  // When
  killAll(before);

  // Then
  if (host().answersRequestsThatItLost()) {
    EXPECT_NE(request.wait(), 0);
    EXPECT_TRUE(host().guide().explains(request.errors())) << request.errors();
  } else {
    // It waits for ever, and so may those after it, until the object manager is started anew.
    host().kill();
    host().start();
  }
  expectServing();
}

TEST_F(HostLifeTest, EndsAndBeginsWithTheObjectManager) {
  expectServing();
  host().stop();
  EXPECT_THAT(ObjectManager::providerProcesses(), IsEmpty());
  host().start();
  expectServing();
}

TEST_F(HostLifeTest, GoesOnAfterAnUpgrade) {
  host().modify(endpoint("eth0"), "IPv4Address=192.0.2.77");
  host().upgrade();
  EXPECT_EQ(host().get(endpoint("eth0")).at("IPv4Address"), quoted("192.0.2.77"));
  EXPECT_THAT(host().names("ein", Classes::clientAccess), SizeIs(6));
}

TEST_F(HostLifeTest, LeavesNothingWhereItIsRemoved) {
  expectServing();
  host().remove();
  EXPECT_FALSE(std::filesystem::exists(INSTALL_PREFIX "/lib/cmpi/libcompositeipconfigprovider.so"));
  EXPECT_FALSE(std::filesystem::exists(INSTALL_PREFIX "/lib/libqvhelper.so.1"));
  host().start();
  expectNothingRegistered();

  host().stop();
  host().install();
  host().configureAgent(ObjectManager::simulatedProcessor());
  host().restart();
  expectServing();
}

TEST_F(HostLifeTest, IsTakenOutAndRegisteredByTheCommandAsWell) {
  // Given what was registered by hand
  expectServing();
  host().takeOutByCommand();
  host().start();
  expectNothingRegistered();

  // When taken out again, registered, and registered again
  host().takeOutByCommand();
  host().registerByCommand();
  expectServing();
  host().stop();
  host().registerByCommand();

  // Then
  expectServing();
}

TEST_F(HostLifeTest, IsRegisteredInAnotherNamespaceByTheCommand) {
  host().takeOutByCommand();
  host().registerByCommand(inNamespace("root/other"));
  EXPECT_THAT(host().names("ein", clientAccess, "root/other"), SizeIs(6));
  EXPECT_THAT(host().failure("ei", clientAccess), HasSubstr("(5) CIM_ERR_INVALID_CLASS"));

  // It stays there until it is taken out.
  host().stop();
  host().registerByCommand();
  EXPECT_THAT(host().names("ein", clientAccess, "root/other"), SizeIs(6));
  host().stop();
  EXPECT_THROW(host().registerByCommand(inNamespace("root/cimv2")), std::runtime_error);
  if (!host().isListening()) {
    host().start();
  }
  host().takeOutByCommand();
  host().registerByCommand();
  expectServing();
  EXPECT_THAT(host().failure("ei", clientAccess, {}, "root/other"), HasSubstr("(3) CIM_ERR_INVALID_NAMESPACE"));
}

TEST_F(HostLifeTest, IsAsItWasWhereTheCommandFails) {
  host().takeOutByCommand();
  std::map<std::string, std::string> classes;
  for (const char* directory : {"sfcb", "pegasus"}) {
    const std::string file =
        INSTALL_PREFIX "/share/compositeipconfig/" + std::string(directory) + "/UnderlyingIPConfig.mof";
    classes[file] = readFile(file);
    writeFile(file, classes[file] + "class\n");
  }
  EXPECT_THAT([] { host().registerByCommand(); },
              ThrowsMessage<std::runtime_error>(HasSubstr(host().title() + " is as it was before")));
  for (const auto& [file, text] : classes) {
    writeFile(file, text);
  }

  if (!host().isListening()) {
    host().start();
  }
  expectNothingRegistered();
  host().takeOutByCommand();
  host().registerByCommand();
  expectServing();
}

}  // namespace
