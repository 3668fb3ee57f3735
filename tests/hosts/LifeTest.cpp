// What happens to a provider process in its life: it is left idle or disabled, killed, restarted, upgraded, removed.
#include <gmock/gmock.h>
#include <gtest/gtest.h>
#include <signal.h>

#include <atomic>
#include <future>

#include "tests/e2e/support/CompositeObjects.h"
#include "tests/e2e/support/FactoryState.h"
#include "tests/e2e/support/Poll.h"
#include "tests/hosts/HostProcesses.h"
#include "tests/hosts/HostTest.h"

namespace {

using namespace Testing;
using testing::Contains;
using testing::HasSubstr;
using testing::IsEmpty;
using testing::Not;
using testing::SizeIs;

class HostLife : public HostTest {
 protected:
  static void expectServing() {
    EXPECT_THAT(host().names("ein", clientAccess), SizeIs(6));
    EXPECT_EQ(host().get(endpoint("eth0")).at("IPv4Address"), quoted("192.0.2.10"));
  }

  static void killProviders() {
    for (const pid_t process : ObjectManager::providerProcesses()) kill(process, SIGKILL);
  }
};

TEST_F(HostLife, GoesOnAfterTheProvidersWereUnloaded) {
  expectServing();
  ASSERT_TRUE(host().unloadProviders());
  host().allowProviders();
  expectServing();
  EXPECT_THAT(ObjectManager::providerProcesses(), SizeIs(host().processes()));
}

TEST_F(HostLife, GoesOnAfterAProviderProcessWasKilled) {
  expectServing();
  const auto before = ObjectManager::providerProcesses();
  ASSERT_THAT(before, SizeIs(host().processes()));
  killProviders();
  // The request that finds out may fail; none after it.
  host().wbemcli("ein", clientAccess);
  expectServing();
  for (const pid_t process : ObjectManager::providerProcesses()) EXPECT_THAT(before, Not(Contains(process)));
}

TEST_F(HostLife, GoesOnAfterProviderProcessesWereKilledDuringRequests) {
  expectServing();
  std::atomic<bool> enough = false;
  std::vector<std::future<int>> clients;
  for (int i = 0; i < 2; ++i)
    clients.push_back(std::async(std::launch::async, [&] {
      int answered = 0;
      while (!enough) answered += host().wbemcli("ein", elementSetting).status == 0 ? 1 : 0;
      return answered;
    }));
  for (int i = 0; i < 3; ++i) {
    EXPECT_TRUE(poll([] { return !ObjectManager::providerProcesses().empty(); }));
    killProviders();
  }
  enough = true;
  for (auto& client : clients) client.get();
  host().wbemcli("ein", clientAccess);
  expectServing();
}

TEST_F(HostLife, EndsAndBeginsWithTheObjectManager) {
  expectServing();
  host().stop();
  EXPECT_THAT(ObjectManager::providerProcesses(), IsEmpty());
  host().start();
  expectServing();
}

TEST_F(HostLife, GoesOnAfterAnUpgrade) {
  host().modify(endpoint("eth0"), "IPv4Address=192.0.2.77");
  host().upgrade();
  EXPECT_EQ(host().get(endpoint("eth0")).at("IPv4Address"), quoted("192.0.2.77"));
  EXPECT_THAT(host().names("ein", clientAccess), SizeIs(6));
}

TEST_F(HostLife, LeavesNothingWhereItIsRemoved) {
  expectServing();
  host().remove();
  EXPECT_FALSE(std::filesystem::exists(INSTALL_PREFIX "/lib/cmpi/libcompositeipconfigprovider.so"));
  EXPECT_FALSE(std::filesystem::exists(INSTALL_PREFIX "/lib/libqvhelper.so.1"));
  host().start();
  EXPECT_THAT(host().wbemcli("ecn", "").output, Not(HasSubstr("YRNx_")));
  for (const ClassCase& row : classCases())
    EXPECT_THAT(host().failure("ei", row.className), HasSubstr("(5) CIM_ERR_INVALID_CLASS")) << row.className;
  for (const Enumeration& row : enumerations())
    EXPECT_THAT(host().failure("ei", row.association), HasSubstr("(5) CIM_ERR_INVALID_CLASS")) << row.association;
  EXPECT_THAT(host().failure("ei", "YRNQV_IPProtocolEndpoint", {}, "root/yrnse"),
              HasSubstr("(3) CIM_ERR_INVALID_NAMESPACE"));
  EXPECT_THAT(ObjectManager::providerProcesses(), IsEmpty());

  host().stop();
  host().install();
  host().configureAgent(ObjectManager::simulatedProcessor());
  host().restart();
  expectServing();
}

}  // namespace
