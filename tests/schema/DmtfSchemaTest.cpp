// SPDX-License-Identifier: Apache-2.0
// Holds the subset of the DMTF's schema to the DMTF's own files, where there are some.
#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include <cstdlib>
#include <filesystem>
#include <map>
#include <set>

#include "Paths.h"
#include "tests/schema/ClassText.h"
#include "tests/support/system/Pattern.h"
#include "tests/support/system/TemporaryDirectory.h"

namespace Testing {

namespace {

using testing::IsEmpty;
using testing::Not;

// Both files of the subset: the second includes the first.
constexpr const char* subset = SOURCE_DIR "/schema/CIM_Interop.mof";

// What the subset says that it leaves out.
bool isForReaders(const std::string& qualifier) {
  static const std::set<std::string> names = {"Description", "MappingStrings", "ModelCorrespondence", "UMLPackagePath"};
  return names.contains(qualifier);
}

// The declarations of qualifiers by name, each with single blanks; the MOF reader does not keep their scopes.
std::map<std::string, std::string> qualifierDeclarations(const std::filesystem::path& file) {
  const std::string text = Pattern("\\s+").replaced(Pattern("//[^\n]*").replaced(readFile(file), ""), " ");
  std::map<std::string, std::string> declarations;
  for (const Pattern::Match& declaration : Pattern("Qualifier (\\w+) : [^;]*;").all(text)) {
    declarations[declaration[1]] = declaration[0];
  }
  return declarations;
}

class DmtfSchemaTest : public testing::Test {
 protected:
  void SetUp() override {
    const char* named = std::getenv("DMTF_SCHEMA");
    if (!named) {
      GTEST_SKIP() << "DMTF_SCHEMA does not name the DMTF's schema (.../cim_schema_2.41.0.mof): nothing is compared";
    }
    whole_ = named;
  }

  std::filesystem::path whole_;
};

TEST_F(DmtfSchemaTest, DeclaresTheClassesOfTheSubsetAsItDoes) {
  const Cimom::MofDeclarations ours = Cimom::MofReader().readPath(subset);
  Cimom::MofDeclarations theirs = Cimom::MofReader().readPath(whole_);
  ASSERT_THAT(ours.classes, Not(IsEmpty()));
  for (const Cimom::ClassDeclaration& our : ours.classes) {
    const Cimom::ClassDeclaration* found = findClass(theirs, our.own.name);
    ASSERT_TRUE(found) << our.own.name << " is not the DMTF's";
    Cimom::ClassDeclaration their = *found;
    their.own.methods.clear();
    EXPECT_EQ(textOf(our), textOf(their, isForReaders));
  }
}

TEST_F(DmtfSchemaTest, DeclaresTheQualifiersOfTheSubsetAsItDoes) {
  const auto ours = qualifierDeclarations(SOURCE_DIR "/schema/CIM_Subset.mof");
  const auto theirs = qualifierDeclarations(whole_.parent_path() / "qualifiers.mof");
  ASSERT_THAT(ours, Not(IsEmpty()));
  for (const auto& [name, declaration] : ours) {
    const auto found = theirs.find(name);
    ASSERT_NE(found, theirs.end()) << name << " is not declared in qualifiers.mof beside " << whole_;
    EXPECT_EQ(declaration, found->second);
  }
}

}  // namespace

}  // namespace Testing
