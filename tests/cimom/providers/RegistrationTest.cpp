// SPDX-License-Identifier: Apache-2.0
#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include "cimom/ObjectManager.h"
#include "tests/support/system/TemporaryDirectory.h"

namespace {

using namespace Cimom;
using namespace Testing;
using testing::ElementsAre;
using testing::HasSubstr;
using testing::SizeIs;
using testing::ThrowsMessage;

class RegistrationTest : public testing::Test {
 protected:
  std::vector<ProviderRegistration> read(std::string_view text) {
    return readRegistration(directory.write("test.reg", text));
  }

  // What the reader says, without the directory.
  std::string complaint(std::string_view text) {
    try {
      read(text);
    } catch (const ConfigurationError& error) {
      return std::string(error.what()).substr(directory.path().string().size() + 1);
    }
    return {};
  }

  TemporaryDirectory directory;
};

TEST_F(RegistrationTest, AStanzaNamesAClassAndItsProvider) {
  const auto all = read(
      "# the first\n[CIM_One]\n   provider: OneProvider\n   location: onelib\n   type: instance association\n"
      "   namespace: root/cimv2 root/other\n#\n\n[ CIM_Two ]\nprovider:TwoProvider # who\n  location:\ttwolib\r\n"
      "  group: ours\n  type: association method\n  namespace: root/cimv2\n  namespace: root/third");
  ASSERT_THAT(all, SizeIs(2));
  EXPECT_EQ(all[0].className, "CIM_One");
  EXPECT_EQ(all[0].provider, "OneProvider");
  EXPECT_EQ(all[0].location, "onelib");
  EXPECT_TRUE(all[0].instance);
  EXPECT_TRUE(all[0].association);
  EXPECT_THAT(all[0].namespaces, ElementsAre("root/cimv2", "root/other"));
  EXPECT_THAT(all[0].registeredAt, HasSubstr("test.reg:2"));
  EXPECT_EQ(all[1].className, "CIM_Two");
  EXPECT_EQ(all[1].provider, "TwoProvider");
  EXPECT_EQ(all[1].location, "twolib");
  EXPECT_FALSE(all[0].method);
  EXPECT_FALSE(all[1].instance);
  EXPECT_TRUE(all[1].association);
  EXPECT_TRUE(all[1].method);
  EXPECT_THAT(all[1].namespaces, ElementsAre("root/cimv2", "root/third"));
}

TEST_F(RegistrationTest, ADirectoryRegistersWhatItsFilesDo) {
  for (const char* name : {"b.reg", "a.reg", "c.peg.mof"}) {
    directory.write(std::string("all/") + name,
                    std::string("[") + name[0] + "]\nprovider: P\nlocation: l\ntype: instance\nnamespace: n\n");
  }
  const auto all = readRegistration(directory.path() / "all");
  ASSERT_THAT(all, SizeIs(2));
  EXPECT_EQ(all[0].className, "a");
  EXPECT_EQ(all[1].className, "b");
}

TEST_F(RegistrationTest, ADirectoryWithoutRegistrationsIsRefused) {
  directory.write("none/c.peg.mof", "");
  EXPECT_THAT([this] { readRegistration(directory.path() / "none"); },
              ThrowsMessage<ConfigurationError>(HasSubstr("none: contains no *.reg file")));
}

TEST_F(RegistrationTest, AnEmptyFileRegistersNothing) { EXPECT_THAT(read("# nothing\n\n"), SizeIs(0)); }

TEST_F(RegistrationTest, WhatIsWrongIsNamedWithItsLine) {
  const std::string stanza = "[C]\nprovider: P\nlocation: l\ntype: instance\nnamespace: n\n";
  const struct {
    std::string text;
    const char* says;
  } rows[] = {
      {"provider: P\n", "test.reg:1: expected \"[ClassName]\" before the first key"},
      {"[C\n", "test.reg:1: expected \"[ClassName]\", not \"[C\""},
      {"[ ]\n", "test.reg:1: expected \"[ClassName]\", not \"[ ]\""},
      {"[C]\nnonsense\n", "test.reg:2: expected \"[ClassName]\" or \"key: value\", not \"nonsense\""},
      {"[C]\ncolour: red\n", "test.reg:2: unknown key \"colour\""},
      {"[C]\nprovider:\n", "test.reg:2: \"provider\" has no value"},
      {"[C]\nprovider: a\nprovider: b\n", "test.reg:3: duplicate \"provider\""},
      {"[C]\ntype: instance indication\n",
       "test.reg:2: unknown type \"indication\": must be instance, association or method"},
      {"\n[C]\nlocation: l\ntype: instance\nnamespace: n\n", "test.reg:2: [C]: \"provider\" is missing"},
      {"[C]\nprovider: P\ntype: instance\nnamespace: n\n", "test.reg:1: [C]: \"location\" is missing"},
      {"[C]\nprovider: P\nlocation: l\nnamespace: n\n" + stanza, "test.reg:1: [C]: \"type\" is missing"},
      {stanza + "[D]\nprovider: P\nlocation: l\ntype: instance\n", "test.reg:6: [D]: \"namespace\" is missing"},
  };
  for (const auto& row : rows) {
    EXPECT_THAT(complaint(row.text), HasSubstr(row.says)) << row.text;
  }
}

TEST_F(RegistrationTest, AFileThatCannotBeReadIsNamed) {
  EXPECT_THROW(readRegistration(directory.path() / "none.reg"), ConfigurationError);
  EXPECT_THROW(readRegistration(directory.path()), ConfigurationError);
}

TEST_F(RegistrationTest, AClassHasOneProviderInANamespace) {
  ObjectManager manager;
  manager.loadRegistration(directory.write("one.reg",
                                           "[C]\nprovider: P\nlocation: l\ntype: instance\nnamespace: root/a\n"
                                           "[C]\nprovider: P\nlocation: l\ntype: instance\nnamespace: root/b\n"));
  EXPECT_TRUE(manager.classes().hasNamespace("root/b"));
  const auto second =
      directory.write("two.reg", "[c]\nprovider: Q\nlocation: l\ntype: instance\nnamespace: root/c /root/B\n");
  try {
    manager.loadRegistration(second);
    FAIL();
  } catch (const ConfigurationError& error) {
    EXPECT_THAT(error.what(), HasSubstr("two.reg:1: class c already has a provider in /root/B, registered at "));
    EXPECT_THAT(error.what(), HasSubstr("one.reg:6"));
  }
}

}  // namespace
