// SPDX-License-Identifier: Apache-2.0
// The product as it leaves the build: what the library exports and needs, the tools, and the demonstration.
#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include <filesystem>
#include <set>
#include <sstream>

#include "Paths.h"
#include "tests/support/client/CompositeStack.h"
#include "tests/support/system/Build.h"

namespace {

using namespace Testing;
using testing::AllOf;
using testing::ContainsRegex;
using testing::HasSubstr;
using testing::Not;
using testing::SizeIs;
using testing::StartsWith;

const std::string library = built("lib/libcompositeipconfigprovider.so.1");

TEST(CompositeLibraryTest, ExportsExactlyItsEighteenFactories) {
  std::set<std::string> found;
  for (const std::string& line : linesOf(run({"nm", "-D", "--defined-only", library}).output)) {
    EXPECT_THAT(line, ContainsRegex(" T "));
    found.insert(line.substr(line.rfind(' ') + 1));
  }
  std::set<std::string> expected;
  for (const char* provider : {"CompositeIPConfigProvider", "IPProtocolendptProvider",
                               "IPConfigAssignmentSettingProvider", "IPConfigStaticAssnSettingDataProvider",
                               "IPConfigDHCPAssnSettingDataProvider", "IPRemoteServiceAccessPointProvider"}) {
    expected.insert(std::string(provider) + "_Create_InstanceMI");
  }
  for (const char* provider :
       {"IPProtocolHostedAccessPointProvider", "IPRemoteHostedAccessPointProvider", "IPConfigClientAccessProvider",
        "IPConfigElementSettingDataProvider", "IPConfigStaticOrderedMembetOfCollProvider",
        "IPConfigDHCPOrderedMembetOfCollProvider"}) {
    for (const char* kind : {"Instance", "Association"}) {
      expected.insert(std::string(provider) + "_Create_" + kind + "MI");
    }
  }
  EXPECT_EQ(found, expected);
  EXPECT_THAT(expected, SizeIs(18));
}

TEST(CompositeLibraryTest, IsNamedAsObjectManagersAndLoadersFindIt) {
  EXPECT_THAT(run({"readelf", "-d", library}).output, HasSubstr("Library soname: [libcompositeipconfigprovider.so.1]"));
  EXPECT_EQ(std::filesystem::canonical(built("lib/libcompositeipconfigprovider.so")),
            std::filesystem::canonical(library));
}

TEST(CompositeLibraryTest, NeedsTheAgentAndNothingOfIpmi) {
  const std::string everything = run({"ldd", library}).output;
  EXPECT_THAT(everything, AllOf(HasSubstr("libqvhelper.so.1"), HasSubstr("libqvinstrumentation.so.1"),
                                HasSubstr("libtwlog.so.1"), Not(HasSubstr("freeipmi")), Not(HasSubstr("not found"))));
}

class RegistrationToolTest : public testing::Test {
 protected:
  static Completed registration(std::vector<std::string> arguments) {
    arguments.insert(arguments.begin(), SOURCE_DIR "/tools/registration");
    return run(arguments);
  }

  static std::string table(const char* name) { return std::string(SOURCE_DIR "/schema/") + name + ".registration"; }

  static std::size_t count(const std::string& text, const std::string& part) {
    std::size_t found = 0;
    for (auto at = text.find(part); at != std::string::npos; at = text.find(part, at + 1)) {
      ++found;
    }
    return found;
  }

  void expectRefused(const std::string& line, const std::string& reason) const {
    const std::string file = directory_.write("bad.registration", "# fine\n" + line + "\n").string();
    for (const char* form : {"sfcb", "pegasus"}) {
      const Completed completed = registration({form, file});
      EXPECT_EQ(completed.status, 1) << line;
      EXPECT_THAT(completed.errors, AllOf(StartsWith(file + ":2: "), HasSubstr(reason)));
    }
  }

  TemporaryDirectory directory_;
};

TEST_F(RegistrationToolTest, WritesAStanzaForEachClass) {
  const Completed completed = registration({"sfcb", table("CompositeIPConfig"), table("UnderlyingIPConfig")});
  ASSERT_EQ(completed.status, 0) << completed.errors;
  const std::string end = "\n   group: compositeipconfig\n#\n";
  EXPECT_EQ(count(completed.output, "   type: instance\n   namespace: root/cimv2" + end), 6U);
  EXPECT_EQ(count(completed.output, "   type: instance association\n   namespace: root/cimv2" + end), 6U);
  EXPECT_EQ(count(completed.output, "   type: instance\n   namespace: root/yrnse" + end), 6U);
  EXPECT_EQ(count(completed.output, "   location: compositeipconfigprovider\n"), 12U);
  EXPECT_THAT(completed.output, HasSubstr("[YRNx_MgmtHwDHCPOrderedMemberOfCollection]\n"
                                          "   provider: IPConfigDHCPOrderedMembetOfCollProvider\n"
                                          "   location: compositeipconfigprovider\n"
                                          "   type: instance association\n"));
}

TEST_F(RegistrationToolTest, WritesTheInstancesThatOpenPegasusWants) {
  const Completed completed = registration({"pegasus", table("CompositeIPConfig"), table("UnderlyingIPConfig")});
  ASSERT_EQ(completed.status, 0) << completed.errors;
  EXPECT_EQ(count(completed.output, "instance of PG_ProviderModule {"), 2U);
  EXPECT_EQ(count(completed.output, "  UserContext = 4;\n  ModuleGroupName = \"compositeipconfig\";\n};\n"), 2U);
  EXPECT_EQ(count(completed.output, "instance of PG_Provider {"), 13U);
  EXPECT_EQ(count(completed.output, "instance of PG_ProviderCapabilities {"), 18U);
  EXPECT_EQ(count(completed.output, "ProviderType = { 2 };"), 12U);
  EXPECT_EQ(count(completed.output, "ProviderType = { 2, 3 };"), 6U);
  EXPECT_EQ(count(completed.output, "Namespaces = { \"root/yrnse\" };"), 6U);
}

TEST_F(RegistrationToolTest, NamesEveryFactoryOfTheLibraryAndNoOther) {
  std::set<std::string> registered;
  std::istringstream lines(contentOf(table("CompositeIPConfig")));
  for (std::string line; std::getline(lines, line);) {
    std::istringstream words(line.substr(0, line.find('#')));
    std::string className, nameSpace, provider, location;
    if (!(words >> className >> nameSpace >> provider >> location)) {
      continue;
    }
    for (std::string kind; words >> kind;) {
      registered.insert(provider + (kind == "instance" ? "_Create_InstanceMI" : "_Create_AssociationMI"));
    }
  }
  std::set<std::string> exported;
  for (const std::string& line : linesOf(run({"nm", "-D", "--defined-only", library}).output)) {
    exported.insert(line.substr(line.rfind(' ') + 1));
  }
  EXPECT_EQ(registered, exported);
}

TEST_F(RegistrationToolTest, RefusesATableOfAnotherShape) {
  expectRefused("Class root/cimv2 Provider", "expected class, namespace, provider, library and at least one kind");
  expectRefused("Class root/cimv2 Provider library", "at least one kind");
  expectRefused("Class root/cimv2 Provider library method", "unknown kind \"method\"");
  expectRefused("Class root/cimv2 Provider library instance indication", "unknown kind \"indication\"");
}

TEST_F(RegistrationToolTest, ShowsHowItIsUsed) {
  EXPECT_EQ(registration({}).status, 2);
  EXPECT_EQ(registration({"sfcb"}).status, 2);
  const Completed completed = registration({"other", table("CompositeIPConfig")});
  EXPECT_EQ(completed.status, 2);
  EXPECT_THAT(completed.errors, HasSubstr("registration sfcb TABLE..."));
  EXPECT_NE(registration({"sfcb", "/nowhere"}).status, 0);
}

class ClassFilesToolTest : public testing::Test {
 protected:
  Completed classFiles(const std::string& objectManager, const std::string& differences, const std::string& mof) const {
    return run({SOURCE_DIR "/tools/class-files", objectManager, directory_.write("differences", differences).string(),
                directory_.write("classes.mof", mof).string()});
  }

  void expectRefused(const std::string& differences, const std::string& mof, const std::string& reason) const {
    const Completed completed = classFiles("sfcb", differences, mof);
    EXPECT_EQ(completed.status, 1) << differences << mof;
    EXPECT_THAT(completed.errors, HasSubstr(reason));
  }

  const std::string mof_ =
      "class A : B {\n    [Key, Override(\"N\"), Description(\"Key, Override(\\\"N\\\"), one\")]\n  string N;\n};\n"
      "class C : D {\n    [Key, Override(\"N\"), MaxLen(8)]\n  string N;\n};\n";
  TemporaryDirectory directory_;
};

TEST_F(ClassFilesToolTest, LeavesOutWhatTheObjectManagerIsListedFor) {
  const std::string table = "# comment\nA superclass,keys pegasus,sfcb # why\nC keys sfcb\n";
  const Completed changed = classFiles("sfcb", table, mof_);
  ASSERT_EQ(changed.status, 0) << changed.errors;
  EXPECT_EQ(changed.output,
            "class A {\n    [Description(\"Key, Override(\\\"N\\\"), one\")]\n  string N;\n};\n"
            "class C : D {\n    [Override(\"N\"), MaxLen(8)]\n  string N;\n};\n");
  EXPECT_EQ(classFiles("cimomd", table, mof_).output, mof_);
  EXPECT_EQ(classFiles("sfcb", "", mof_).output, mof_);
}

TEST_F(ClassFilesToolTest, RefusesADifferenceThatItCannotMake) {
  expectRefused("A superclass\n", mof_, "differences:1: expected a class, what it is without, and object managers");
  expectRefused("A methods sfcb\n", mof_, "differences:1: unknown part \"methods\"");
  expectRefused("X keys sfcb\n", mof_, "there is no class X here");
  expectRefused("A superclass sfcb\n", "class A {\n};\n", "classes.mof:1: A has no superclass on this line");
  expectRefused("A keys sfcb\n", "class A {\n  [MaxLen(8), Key]\n  string N;\n};\n", "classes.mof:2: Key must not be");
  expectRefused("A superclass sfcb\n", "class A : B {\n  [Override(\"N\")]\n  string N;\n};\n",
                "classes.mof:2: Override must not be");
  EXPECT_EQ(run({SOURCE_DIR "/tools/class-files"}).status, 2);
}

}  // namespace
