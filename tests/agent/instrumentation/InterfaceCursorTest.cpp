// SPDX-License-Identifier: Apache-2.0
#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include "agent/backends/simulated/StateText.h"
#include "agent/instrumentation/InterfaceCursor.h"
#include "tests/agent/instrumentation/RecordingBackEnd.h"
#include "tests/support/agent/Addresses.h"
#include "tests/support/system/TemporaryDirectory.h"
#include "tests/support/system/Throws.h"

namespace {

using namespace QV;
using namespace Testing;
using NodeLexicon::IpInterfaceNode;
using NodeLexicon::Ipv4Address;
using NodeLexicon::Ipv4SubnetMask;
using NodeLexicon::NodeName;
using NodeLexicon::NodeType;
using NodeLexicon::Properties;
using testing::ElementsAre;
using testing::EndsWith;
using testing::HasSubstr;
using testing::IsEmpty;

// A cursor on the first of the factory configuration's interfaces: eth0, 192.0.2.10/24; eth1, DHCP.
class InterfaceCursorTest : public testing::Test {
 protected:
  InterfaceCursorTest() { cursor_.select(IpInterfaceNode); }

  std::string get(Properties property) {
    std::string value = "unread";
    return cursor_.get(property, value) ? value : "unreadable";
  }

  void install(const ManagementProcessor& processor) {
    writeFile(state_, writeState(processor));
    cursor_.select(IpInterfaceNode);
  }

  NetworkInterface onProcessor(std::size_t index) { return backEnd_->read().interfaces.at(index); }

  const TemporaryDirectory directory_;
  const std::string state_ = directory_ / "state.json";
  const std::shared_ptr<RecordingBackEnd> backEnd_ = std::make_shared<RecordingBackEnd>(state_);
  InterfaceCursor cursor_{backEnd_};
};

TEST_F(InterfaceCursorTest, WalksTheInterfacesInOrder) {
  EXPECT_TRUE(cursor_.onNode());
  EXPECT_EQ(get(NodeName), "eth0");
  EXPECT_EQ(get(Ipv4Address), "192.0.2.10");
  EXPECT_EQ(get(Ipv4SubnetMask), "255.255.255.0");
  cursor_.advance();
  EXPECT_EQ(get(NodeName), "eth1");
  cursor_.advance();
  EXPECT_FALSE(cursor_.onNode());
}

TEST_F(InterfaceCursorTest, ReadsAndWritesNothingPastTheEnd) {
  cursor_.advance();
  cursor_.advance();
  cursor_.advance();
  EXPECT_FALSE(cursor_.onNode());
  EXPECT_EQ(get(NodeName), "unreadable");
  EXPECT_FALSE(cursor_.set(Ipv4Address, "192.0.2.99"));
  EXPECT_THAT(backEnd_->changes, IsEmpty());
}

TEST_F(InterfaceCursorTest, StandsNowhereBeforeItIsSet) { EXPECT_FALSE(InterfaceCursor(backEnd_).onNode()); }

TEST_F(InterfaceCursorTest, FindsNoNodesOfAnotherType) {
  cursor_.select(static_cast<NodeType>(30));
  EXPECT_FALSE(cursor_.onNode());
}

TEST_F(InterfaceCursorTest, StartsAgainWhenItIsSetAgain) {
  cursor_.advance();
  cursor_.select(IpInterfaceNode);
  EXPECT_EQ(get(NodeName), "eth0");
}

TEST_F(InterfaceCursorTest, PassesOverANodeWhoseNameCannotBeRead) {
  ManagementProcessor processor = factoryConfiguration();
  processor.interfaces[0].name.reset();
  install(processor);
  EXPECT_EQ(get(NodeName), "unreadable");
  EXPECT_EQ(get(NodeName), "eth1");
}

TEST_F(InterfaceCursorTest, WritesNothingToANodeWithoutAName) {
  ManagementProcessor processor = factoryConfiguration();
  processor.interfaces[0].name.reset();
  install(processor);
  EXPECT_FALSE(cursor_.set(Ipv4Address, "192.0.2.99"));
  cursor_.flush();
  EXPECT_THAT(backEnd_->changes, IsEmpty());
}

TEST_F(InterfaceCursorTest, StaysOnANodeWhoseAddressCannotBeRead) {
  ManagementProcessor processor = factoryConfiguration();
  processor.interfaces[0].ipv4Address.reset();
  install(processor);
  EXPECT_EQ(get(Ipv4Address), "unreadable");
  EXPECT_EQ(get(NodeName), "eth0");
}

TEST_F(InterfaceCursorTest, KnowsNoOtherProperties) {
  EXPECT_EQ(get(static_cast<Properties>(27)), "unreadable");
  EXPECT_FALSE(cursor_.set(static_cast<Properties>(27), "x"));
  EXPECT_FALSE(cursor_.set(NodeName, "eth9"));
}

TEST_F(InterfaceCursorTest, SendsAddressAndMaskAsOneChange) {
  EXPECT_TRUE(cursor_.set(Ipv4Address, "198.51.100.7"));
  EXPECT_THAT(backEnd_->changes, IsEmpty()) << "the mask may follow";
  EXPECT_TRUE(cursor_.set(Ipv4SubnetMask, "255.255.0.0"));
  EXPECT_THAT(backEnd_->changes, ElementsAre("eth0 198.51.100.7 255.255.0.0"));
  cursor_.flush();
  EXPECT_THAT(backEnd_->changes, testing::SizeIs(1));
}

TEST_F(InterfaceCursorTest, ReadsNoValuesToFindAnInterfaceAndToChangeBoth) {
  EXPECT_EQ(get(NodeName), "eth0");
  cursor_.advance();
  EXPECT_EQ(get(NodeName), "eth1");
  cursor_.set(Ipv4Address, "198.51.100.7");
  cursor_.set(Ipv4SubnetMask, "255.255.0.0");
  EXPECT_EQ(backEnd_->reads, 0u);
  EXPECT_THAT(backEnd_->changes, ElementsAre("eth1 198.51.100.7 255.255.0.0"));
}

TEST_F(InterfaceCursorTest, ReadsTheValuesOnceForAllThatAreAskedFor) {
  get(Ipv4Address);
  get(Ipv4SubnetMask);
  cursor_.advance();
  get(Ipv4Address);
  EXPECT_EQ(backEnd_->reads, 1u);
}

TEST_F(InterfaceCursorTest, FindsTheInterfaceByItsNameWhereOthersCameOrWent) {
  ManagementProcessor processor = factoryConfiguration();
  processor.interfaces.insert(processor.interfaces.begin(), NetworkInterface{});
  writeFile(state_, writeState(processor));
  EXPECT_EQ(get(Ipv4Address), "192.0.2.10");

  cursor_.select(IpInterfaceNode);
  cursor_.advance();
  processor.interfaces = {processor.interfaces[2]};
  writeFile(state_, writeState(processor));
  EXPECT_EQ(get(NodeName), "eth0");
  EXPECT_EQ(get(Ipv4Address), "unreadable");
}

TEST_F(InterfaceCursorTest, SendsAnAddressAloneWhenItMovesOn) {
  cursor_.set(Ipv4Address, "192.0.2.99");
  cursor_.advance();
  EXPECT_THAT(backEnd_->changes, ElementsAre("eth0 192.0.2.99 -"));
}

TEST_F(InterfaceCursorTest, SendsAnAddressAloneWhenItIsSetAgain) {
  cursor_.set(Ipv4Address, "192.0.2.99");
  cursor_.select(IpInterfaceNode);
  EXPECT_THAT(backEnd_->changes, ElementsAre("eth0 192.0.2.99 -"));
  EXPECT_EQ(get(Ipv4Address), "192.0.2.99");
}

TEST_F(InterfaceCursorTest, SendsAMaskAlone) {
  cursor_.set(Ipv4SubnetMask, "255.255.0.0");
  EXPECT_THAT(backEnd_->changes, ElementsAre("eth0 - 255.255.0.0"));
}

TEST_F(InterfaceCursorTest, TakesTheLastOfSeveralAddresses) {
  cursor_.set(Ipv4Address, "192.0.2.98");
  cursor_.set(Ipv4Address, "192.0.2.99");
  cursor_.flush();
  EXPECT_THAT(backEnd_->changes, ElementsAre("eth0 192.0.2.99 -"));
}

TEST_F(InterfaceCursorTest, MakesTheSourceStatic) {
  cursor_.advance();
  cursor_.set(Ipv4Address, "198.51.100.99");
  cursor_.flush();
  EXPECT_EQ(onProcessor(1).ipv4Origin, AddressOrigin::Static);
  EXPECT_EQ(onProcessor(1).ipv4Address, ipv4("198.51.100.99"));
  EXPECT_EQ(onProcessor(1).ipv4SubnetMask, mask("255.255.255.0"));
}

TEST_F(InterfaceCursorTest, ReadsWhatItWrote) {
  cursor_.set(Ipv4Address, "198.51.100.7");
  EXPECT_EQ(get(Ipv4Address), "192.0.2.10") << "not sent yet";
  cursor_.set(Ipv4SubnetMask, "255.255.0.0");
  EXPECT_EQ(get(Ipv4Address), "198.51.100.7");
  EXPECT_EQ(get(Ipv4SubnetMask), "255.255.0.0");
}

TEST_F(InterfaceCursorTest, RefusesAnAddressBeforeAnythingIsSent) {
  EXPECT_EQ(thrownBy([&] { cursor_.set(Ipv4Address, "127.0.0.1"); }),
            "interface eth0: the IPv4 address '127.0.0.1' is a loopback address; nothing was changed");
  cursor_.flush();
  EXPECT_THAT(backEnd_->changes, IsEmpty());
}

TEST_F(InterfaceCursorTest, AbandonsTheAddressWithARefusedMask) {
  cursor_.set(Ipv4Address, "192.0.2.99");
  EXPECT_EQ(thrownBy([&] { cursor_.set(Ipv4SubnetMask, "255.0.255.0"); }),
            "interface eth0: the subnet mask '255.0.255.0' is not contiguous; nothing was changed");
  cursor_.flush();
  cursor_.advance();
  EXPECT_THAT(backEnd_->changes, IsEmpty());
}

TEST_F(InterfaceCursorTest, AbandonsAnEarlierAddressWithARefusedOne) {
  cursor_.set(Ipv4Address, "192.0.2.99");
  EXPECT_THROW(cursor_.set(Ipv4Address, "x"), std::invalid_argument);
  cursor_.flush();
  EXPECT_THAT(backEnd_->changes, IsEmpty());
}

TEST_F(InterfaceCursorTest, TakesANewChangeAfterARefusedOne) {
  EXPECT_THROW(cursor_.set(Ipv4Address, "x"), std::invalid_argument);
  cursor_.set(Ipv4Address, "192.0.2.99");
  cursor_.flush();
  EXPECT_THAT(backEnd_->changes, ElementsAre("eth0 192.0.2.99 -"));
}

TEST_F(InterfaceCursorTest, RefusesTheNetworkAndTheBroadcastAddressOfTheNewMask) {
  cursor_.set(Ipv4Address, "192.0.3.255");
  EXPECT_THAT(thrownBy([&] { cursor_.set(Ipv4SubnetMask, "255.255.254.0"); }), HasSubstr("its broadcast address"));
  cursor_.set(Ipv4Address, "192.0.2.255");
  EXPECT_NO_THROW(cursor_.set(Ipv4SubnetMask, "255.255.254.0")) << "a host's under the wider mask";
}

TEST_F(InterfaceCursorTest, RefusesAnAddressAloneThatIsNoHostUnderTheCurrentMask) {
  cursor_.set(Ipv4Address, "192.0.2.255");
  EXPECT_THAT(thrownBy([&] { cursor_.flush(); }), EndsWith("its broadcast address; nothing was changed"));
  EXPECT_THAT(backEnd_->changes, IsEmpty());
}

TEST_F(InterfaceCursorTest, RefusesAMaskAloneUnderWhichTheCurrentAddressIsNoHost) {
  ManagementProcessor processor = factoryConfiguration();
  processor.interfaces[0].ipv4Address = ipv4("192.0.2.8");
  install(processor);
  EXPECT_THAT(thrownBy([&] { cursor_.set(Ipv4SubnetMask, "255.255.255.252"); }), HasSubstr("the network itself"));
  EXPECT_THAT(backEnd_->changes, IsEmpty());
}

TEST_F(InterfaceCursorTest, DoesNotHoldAnAddressAgainstACurrentMaskThatTellsNothing) {
  ManagementProcessor processor = factoryConfiguration();
  processor.interfaces[0].ipv4Address = ipv4("0.0.0.0");
  processor.interfaces[0].ipv4SubnetMask = mask("0.0.0.0");
  install(processor);
  cursor_.set(Ipv4Address, "192.0.2.255");
  cursor_.flush();
  EXPECT_THAT(backEnd_->changes, ElementsAre("eth0 192.0.2.255 -"));
}

TEST_F(InterfaceCursorTest, DoesNotHoldAMaskAgainstACurrentAddressThatTellsNothing) {
  ManagementProcessor processor = factoryConfiguration();
  processor.interfaces[0].ipv4Address = ipv4("0.0.0.0");
  install(processor);
  cursor_.set(Ipv4SubnetMask, "255.255.0.0");
  EXPECT_THAT(backEnd_->changes, ElementsAre("eth0 - 255.255.0.0"));
}

TEST_F(InterfaceCursorTest, PassesOnWhatTheProcessorThrowsAndSendsNothingTwice) {
  backEnd_->unreachable = true;
  cursor_.set(Ipv4Address, "192.0.2.99");
  EXPECT_EQ(thrownBy([&] { cursor_.set(Ipv4SubnetMask, "255.255.255.0"); }), "the processor does not answer");
  EXPECT_EQ(get(Ipv4Address), "192.0.2.10");
  cursor_.flush();
  EXPECT_THAT(backEnd_->changes, testing::SizeIs(1));
}

TEST_F(InterfaceCursorTest, StaysOnTheNodeWhoseChangeFailed) {
  backEnd_->unreachable = true;
  cursor_.set(Ipv4Address, "192.0.2.99");
  EXPECT_THROW(cursor_.advance(), std::runtime_error);
  EXPECT_EQ(get(NodeName), "eth0");
  EXPECT_NO_THROW(cursor_.advance());
  EXPECT_EQ(get(NodeName), "eth1");
}

}  // namespace
