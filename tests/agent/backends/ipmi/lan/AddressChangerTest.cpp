// SPDX-License-Identifier: Apache-2.0
// A change on BMCs of every temper.
#include <gmock/gmock.h>

#include "agent/backends/ipmi/lan/AddressChanger.h"
#include "tests/agent/backends/ipmi/ScriptedBmc.h"
#include "tests/support/agent/Addresses.h"
#include "tests/support/agent/RecordingLog.h"

namespace {

using namespace Testing;
using QV::AddressChange;
using QV::Ipmi::ConnectionLost;
using QV::Ipmi::HeldLocks;
using QV::Ipmi::IpmiError;
using QV::Ipmi::LanParameter;
using QV::Ipmi::NotSent;
using QV::Ipmi::ParameterData;
using testing::AllOf;
using testing::ElementsAre;
using testing::HasSubstr;
using testing::IsEmpty;
using testing::Pair;
using testing::ThrowsMessage;
using namespace std::chrono_literals;

const AddressChange bothValues{QV::ipv4("192.0.2.77"), QV::mask("255.255.255.128")};
const ParameterData oldAddress{192, 0, 2, 10}, newAddress{192, 0, 2, 77};
const ParameterData oldMask{255, 255, 255, 0}, newMask{255, 255, 255, 128};
const ParameterData fixed{1}, leased{2};

// The requests of a change: the lock, three to look, then source, address and mask as they differ.
constexpr unsigned lockRequest = 1, firstWrite = 5;

class AddressChangerTest : public testing::Test {
 protected:
  void change(const AddressChange& change, std::chrono::milliseconds patience = 0ms) {
    const auto onBegin = [this] { ++begun; };
    QV::Ipmi::AddressChanger(bmc, 1, held, onBegin, patience).apply(change);
  }
  auto refusal(const std::string& first, const std::string& second = "") {
    return ThrowsMessage<IpmiError>(AllOf(HasSubstr(first), HasSubstr(second)));
  }
  void expectNewValues() {
    EXPECT_EQ(bmc.values.at(LanParameter::AddressSource), fixed);
    EXPECT_EQ(bmc.values.at(LanParameter::IpAddress), newAddress);
    EXPECT_EQ(bmc.values.at(LanParameter::SubnetMask), newMask);
  }
  void expectOldValues() {
    EXPECT_EQ(bmc.values.at(LanParameter::IpAddress), oldAddress);
    EXPECT_EQ(bmc.values.at(LanParameter::SubnetMask), oldMask);
  }
  void expectNoLock() {
    EXPECT_FALSE(bmc.locked);
    EXPECT_THAT(held, IsEmpty());
  }

  ScriptedBmc bmc;
  HeldLocks held;
  int begun = 0;
};

TEST_F(AddressChangerTest, HoldsHoweverTheBmcApplies) {
  for (const auto applies :
       {ScriptedBmc::Applies::AtOnce, ScriptedBmc::Applies::OnCommit, ScriptedBmc::Applies::OnComplete}) {
    bmc = {};
    bmc.applies = applies;

    change(bothValues);

    expectNewValues();
    expectNoLock();
  }
}

TEST_F(AddressChangerTest, DoesWithoutALockWhereThereIsNone) {
  bmc.hasLock = false;
  takeLog();

  change(bothValues);

  expectNewValues();
  EXPECT_TRUE(contains(takeLog(), "Tarnwick.Ipmi", 4000, "has no set-in-progress lock"));
}

TEST_F(AddressChangerTest, WritesOnlyWhatDiffers) {
  change({QV::ipv4("192.0.2.77"), QV::mask("255.255.255.0")});

  EXPECT_THAT(bmc.written, ElementsAre(Pair(LanParameter::IpAddress, newAddress)));
}

TEST_F(AddressChangerTest, WritesTheMaskAlone) {
  change({std::nullopt, QV::mask("255.255.255.128")});

  EXPECT_THAT(bmc.written, ElementsAre(Pair(LanParameter::SubnetMask, newMask)));
}

TEST_F(AddressChangerTest, WritesNothingWhereTheValuesAreSoAlready) {
  change({QV::ipv4("192.0.2.10"), QV::mask("255.255.255.0")});

  EXPECT_THAT(bmc.written, IsEmpty());
  EXPECT_EQ(begun, 0);
}

TEST_F(AddressChangerTest, TellsThatItBeginsBeforeTheFirstWriteAndOnce) {
  bmc.applies = ScriptedBmc::Applies::AtOnce;
  bmc.beforeRequest = [&](unsigned number) {
    EXPECT_EQ(begun, number < firstWrite ? 0 : 1) << "request " << number;
    if (bmc.values[LanParameter::SubnetMask] == newMask) {
      bmc.values[LanParameter::SubnetMask] = {255, 255, 0, 0};
    }
  };

  EXPECT_THAT([&] { change(bothValues); }, refusal("the earlier values were put back"));

  EXPECT_EQ(begun, 1);
}

TEST_F(AddressChangerTest, MakesTheSourceStaticFirstAndKeepsTheMaskThatDhcpGave) {
  bmc.values[LanParameter::AddressSource] = leased;
  bmc.refusesAddressUnderDhcp = true;

  change({QV::ipv4("192.0.2.77"), std::nullopt});

  EXPECT_THAT(bmc.written,
              ElementsAre(Pair(LanParameter::AddressSource, fixed), Pair(LanParameter::IpAddress, newAddress),
                          Pair(LanParameter::SubnetMask, oldMask)));
}

TEST_F(AddressChangerTest, RefusesToMakeAnInterfaceStaticThatHasNoAddress) {
  bmc.values[LanParameter::AddressSource] = leased;
  bmc.values[LanParameter::IpAddress] = {0, 0, 0, 0};

  EXPECT_THAT([&] { change({std::nullopt, QV::mask("255.255.255.128")}); }, refusal("has no IP address yet"));

  EXPECT_THAT(bmc.written, IsEmpty());
}

TEST_F(AddressChangerTest, RefusesAnAddressWithoutAMaskWhereThereIsNone) {
  bmc.values[LanParameter::SubnetMask] = {0, 0, 0, 0};

  EXPECT_THAT([&] { change({QV::ipv4("192.0.2.77"), std::nullopt}); }, refusal("has no subnet mask yet"));

  EXPECT_THAT(bmc.written, IsEmpty());
}

TEST_F(AddressChangerTest, IsRefusedWhileAnotherHoldsTheLock) {
  bmc.lockedByAnother = true;

  EXPECT_THAT([&] { change(bothValues); }, refusal("LAN channel 1 is being changed by another client", "0x81"));

  EXPECT_THAT(bmc.written, IsEmpty());
  EXPECT_THAT(held, IsEmpty()) << "another client's lock is not ours to give back";
}

TEST_F(AddressChangerTest, NeedsNoLockOfAnothersWhereTheValuesAreSoAlready) {
  bmc.lockedByAnother = true;

  change({QV::ipv4("192.0.2.10"), QV::mask("255.255.255.0")});

  EXPECT_THAT(bmc.written, IsEmpty());
}

// Before the lock is granted another client has written the mask that is wanted; it ends with another one.
TEST_F(AddressChangerTest, LeavesNothingOutThatAnotherClientHadHalfWritten) {
  bmc.values[LanParameter::SubnetMask] = newMask;
  bmc.beforeRequest = [&](unsigned) {
    if (bmc.locked && bmc.written.empty()) {
      bmc.values[LanParameter::SubnetMask] = oldMask;
    }
  };

  change(bothValues);

  expectNewValues();
}

TEST_F(AddressChangerTest, KnowsItsOwnLockWhereTheRequestForItWentOutTwice) {
  bmc.lateRequest = lockRequest;

  change(bothValues);

  expectNewValues();
  expectNoLock();
}

TEST_F(AddressChangerTest, WaitsForAnotherClientsLockWhereTheRequestForItsOwnWentOutTwice) {
  bmc.lateRequest = lockRequest;
  bmc.lockedByAnother = true;
  bmc.beforeRequest = [&](unsigned number) {
    EXPECT_TRUE(bmc.written.empty() || !bmc.lockedByAnother);
    bmc.lockedByAnother = number < lockRequest + 2;
  };

  change(bothValues, 10s);

  expectNewValues();
  expectNoLock();
}

TEST_F(AddressChangerTest, ThatIsRefusedPutsBackWhatWasWritten) {
  for (const auto applies : {ScriptedBmc::Applies::AtOnce, ScriptedBmc::Applies::OnCommit}) {
    bmc = {};
    bmc.applies = applies;
    bmc.values[LanParameter::AddressSource] = leased;
    bmc.refuses[LanParameter::SubnetMask] = 0xCC;

    EXPECT_THAT([&] { change(bothValues); },
                refusal("refuses the subnet mask 255.255.255.128", "invalid value (0xCC); nothing was changed"));

    expectOldValues();
    EXPECT_EQ(bmc.values.at(LanParameter::AddressSource), leased);
    expectNoLock();
  }
}

TEST_F(AddressChangerTest, ThatIsRefusedSaysWhatCouldNotBePutBack) {
  bmc.refuses[LanParameter::SubnetMask] = 0xCC;
  bmc.beforeRequest = [&](unsigned number) {
    if (number == firstWrite + 2) {
      bmc.refuses[LanParameter::IpAddress] = 0xFF;
    }
  };

  EXPECT_THAT([&] { change(bothValues); }, refusal("could not be put back", "(0xFF)"));

  expectNoLock();
}

TEST_F(AddressChangerTest, ThatIsRefusedSaysThatAnEarlierValueIsNotKnown) {
  bmc.readRefused[LanParameter::IpAddress] = 0x80;
  bmc.refuses[LanParameter::SubnetMask] = 0xCC;

  EXPECT_THAT([&] { change(bothValues); }, refusal("could not be put back: the earlier IP address is not known"));

  expectNoLock();
}

TEST_F(AddressChangerTest, SaysThatThePrivilegeIsTooLow) {
  for (const LanParameter parameter : {LanParameter::IpAddress, LanParameter::SubnetMask}) {
    bmc = {};
    bmc.refuses[parameter] = 0xD4;
    EXPECT_THAT([&] { change(bothValues); }, refusal("privilege = admin", "nothing was changed"));
  }
}

TEST_F(AddressChangerTest, IsReadBackUntilASlowBmcShowsIt) {
  bmc.readsUntilApplied = 3;

  change(bothValues, 10s);

  expectNewValues();
}

TEST_F(AddressChangerTest, FailsWhereTheBmcAcceptsAndDoesNotApply) {
  bmc.applies = ScriptedBmc::Applies::Never;

  EXPECT_THAT([&] { change(bothValues); },
              refusal("IP address is 192.0.2.10, not 192.0.2.77, subnet mask is 255.255.255.0, not 255.255.255.128",
                      "the earlier values hold"));

  expectNoLock();
}

TEST_F(AddressChangerTest, PutsTheEarlierValuesBackWhereTheBmcAppliesAPart) {
  bmc.applies = ScriptedBmc::Applies::AtOnce;
  bmc.beforeRequest = [&](unsigned) {
    if (bmc.values[LanParameter::SubnetMask] == newMask) {
      bmc.values[LanParameter::SubnetMask] = {255, 255, 0, 0};
    }
  };

  EXPECT_THAT([&] { change(bothValues); },
              refusal("subnet mask is 255.255.0.0, not 255.255.255.128", "the earlier values were put back"));

  expectOldValues();
  expectNoLock();
}

TEST_F(AddressChangerTest, LeavesAnAddressThatAnotherClientWroteMeanwhile) {
  const ParameterData anothers{192, 0, 2, 78};
  bmc.beforeRequest = [&](unsigned number) {
    if (number > firstWrite + 2) {
      bmc.values[LanParameter::IpAddress] = anothers;
    }
  };

  EXPECT_THAT([&] { change(bothValues); },
              refusal("IP address is 192.0.2.78, not 192.0.2.77", "another client has changed it meanwhile"));

  EXPECT_EQ(bmc.values.at(LanParameter::IpAddress), anothers);
  expectNoLock();
}

TEST_F(AddressChangerTest, GivesTheLockBackWhereItsTimeEnds) {
  bmc.applies = ScriptedBmc::Applies::AtOnce;
  bmc.beforeRequest = [&](unsigned number) {
    if (number > firstWrite && !bmc.cleaningUp) {
      throw NotSent("operation_timeout is over");
    }
  };

  EXPECT_THAT([&] { change(bothValues); }, refusal("operation_timeout is over", "nothing was changed"));

  expectOldValues();
  expectNoLock();
}

TEST_F(AddressChangerTest, IsConfirmedWhereTheConnectionBreaksAndComesBack) {
  bmc.applies = ScriptedBmc::Applies::AtOnce;
  bmc.beforeRequest = [&](unsigned number) {
    if (number == firstWrite + 2) {
      throw ConnectionLost("session timeout");
    }
  };

  change(bothValues);

  expectNewValues();
  expectNoLock();
}

TEST_F(AddressChangerTest, FailsClearlyWhereTheConnectionBreaksBeforeTheValuesHold) {
  bmc.beforeRequest = [&](unsigned number) {
    if (number == firstWrite + 1) {
      throw ConnectionLost("session timeout");
    }
  };

  EXPECT_THAT([&] { change(bothValues); }, refusal("does not show it", "the earlier values hold"));

  expectNoLock();
}

TEST_F(AddressChangerTest, HasAnUnknownOutcomeWhereTheBmcIsGoneAndRemembersTheLock) {
  bmc.beforeRequest = [&](unsigned number) {
    if (number == firstWrite) {
      throw ConnectionLost("session timeout");
    }
    if (number > firstWrite) {
      throw NotSent("no session");
    }
  };
  takeLog();

  EXPECT_THAT([&] { change(bothValues); }, refusal("outcome of the change of lan1 is unknown", "set host to the new"));

  EXPECT_EQ(begun, 1);
  EXPECT_THAT(held, ElementsAre(Pair(1, QV::Ipmi::LockHolder::Us)));
  EXPECT_TRUE(contains(takeLog(), "Tarnwick.Ipmi", 6000, "lock of LAN channel 1 may stay set"));
}

TEST_F(AddressChangerTest, GivesTheLockBackInTheEndWhereTheBmcIsBusy) {
  constexpr unsigned unlock = firstWrite + 3;
  bmc.beforeRequest = [&](unsigned number) { bmc.busy = number == unlock || number == unlock + 1; };

  change(bothValues);

  expectNewValues();
  expectNoLock();
}

TEST_F(AddressChangerTest, LeavesAnotherClientsLockUntilThatOneIsDoneWhereTheConnectionBreaksWithItsOwn) {
  bmc.lockedByAnother = true;
  bmc.beforeRequest = [&](unsigned number) {
    if (number == lockRequest) {
      throw ConnectionLost("session timeout");
    }
    EXPECT_TRUE(bmc.progress.empty() || bmc.progress.back() == 1 || !bmc.lockedByAnother);
    bmc.lockedByAnother = number < lockRequest + 3;
  };

  EXPECT_THAT([&] { change(bothValues, 10s); }, refusal("session timeout"));

  expectNoLock();
}

TEST_F(AddressChangerTest, IsRefusedForAChannelThatReportsNothing) {
  bmc.values.clear();

  EXPECT_THAT([&] { change(bothValues); }, refusal("has no LAN channel 1"));

  EXPECT_THAT(bmc.written, IsEmpty());
}

TEST_F(AddressChangerTest, ChangesNothingWhereTheConnectionBreaksWithTheLock) {
  bmc.beforeRequest = [&](unsigned number) {
    if (number == lockRequest) {
      throw ConnectionLost("session timeout");
    }
  };

  EXPECT_THAT([&] { change(bothValues); }, refusal("session timeout"));

  EXPECT_EQ(begun, 0);
  expectNoLock();
}

}  // namespace
