// SPDX-License-Identifier: Apache-2.0
// The classes as object managers are given them: what the build wrote below share/.
#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include <filesystem>
#include <fstream>
#include <map>
#include <sstream>

#include "Paths.h"
#include "cimom/providers/ProviderRegistration.h"
#include "cimom/schema/ClassRepository.h"
#include "tests/schema/ClassText.h"
#include "tests/support/system/Build.h"

namespace Testing {

namespace {

using Cimom::ClassDeclaration;
using Cimom::MofDeclarations;
using Cimom::MofReader;
using Cimom::Qualifier;
using testing::Contains;
using testing::HasSubstr;
using testing::IsEmpty;
using testing::Not;
using testing::SizeIs;

constexpr const char* objectManagers[] = {"cimomd", "sfcb", "pegasus"};
constexpr const char* sets[] = {"CompositeIPConfig", "UnderlyingIPConfig"};

std::filesystem::path fileOf(const std::string& objectManager, const std::string& name) {
  return std::filesystem::path(built("share")) / objectManager / name;
}

// A MOF file, read with the DMTF's qualifiers known.
MofDeclarations read(const std::filesystem::path& file) {
  MofReader reader;
  reader.readPath(SOURCE_DIR "/schema/CIM_Subset.mof");
  return reader.readPath(file);
}

struct Difference {
  std::string className;
  bool withoutSuperclass;
  bool withoutKeys;
};

// The lines of CompositeIPConfig.differences for an object manager.
std::vector<Difference> differencesFor(const std::string& objectManager) {
  std::vector<Difference> differences;
  std::ifstream table(SOURCE_DIR "/schema/CompositeIPConfig.differences");
  for (std::string line; std::getline(table, line);) {
    std::istringstream words(line.substr(0, line.find('#')));
    std::string className, without, managers;
    if (!(words >> className >> without >> managers) ||
        (',' + managers + ',').find(',' + objectManager + ',') == std::string::npos) {
      continue;
    }
    differences.push_back(
        {className, without.find("superclass") != std::string::npos, without.find("keys") != std::string::npos});
  }
  return differences;
}

void apply(const Difference& difference, ClassDeclaration& declaration) {
  const auto strip = [&](const char* name) {
    for (Cimom::PropertyDeclaration& property : declaration.own.properties) {
      std::erase_if(property.qualifiers, [&](const Qualifier& qualifier) { return qualifier.name == name; });
    }
  };
  if (difference.withoutSuperclass) {
    declaration.superclassName.clear();
    strip("Override");
  }
  if (difference.withoutKeys) {
    strip("Key");
  }
}

class ClassFilesTest : public testing::TestWithParam<const char*> {};

TEST_P(ClassFilesTest, DeclareWhatTheSourcesDoButForTheListedDifferences) {
  for (const char* set : sets) {
    const std::string name = std::string(set) + ".mof";
    MofDeclarations expected = read(std::filesystem::path(SOURCE_DIR "/schema") / name);
    if (set == sets[0]) {
      for (const Difference& difference : differencesFor(GetParam())) {
        for (ClassDeclaration& declaration : expected.classes) {
          if (declaration.own.name == difference.className) {
            apply(difference, declaration);
          }
        }
      }
    }
    const MofDeclarations written = read(fileOf(GetParam(), name));
    ASSERT_THAT(written.classes, SizeIs(expected.classes.size())) << name;
    for (std::size_t i = 0; i < expected.classes.size(); ++i) {
      EXPECT_EQ(textOf(written.classes[i]), textOf(expected.classes[i]));
    }
  }
}

TEST_P(ClassFilesTest, ResolveAgainstTheDmtfsClasses) {
  for (const char* set : sets) {
    Cimom::ClassRepository repository;
    MofReader reader;
    repository.add(reader.readPath(SOURCE_DIR "/schema/CIM_Subset.mof"));
    EXPECT_NO_THROW(repository.add(reader.readPath(fileOf(GetParam(), std::string(set) + ".mof"))));
  }
}

TEST_P(ClassFilesTest, LetReferencesNameTheEndsOfElementSettingDataWithoutKeysWhereTheObjectManagerNeedsThat) {
  const bool keyed = std::string(GetParam()) == "cimomd";
  Cimom::ClassRepository repository;
  MofReader reader;
  repository.add(reader.readPath(SOURCE_DIR "/schema/CIM_Subset.mof"));
  repository.add(reader.readPath(fileOf(GetParam(), "CompositeIPConfig.mof")));
  const Cimom::ClassDefinition* found = repository.find("YRNx_MgmtHwIPElementSettingData");
  ASSERT_TRUE(found);
  EXPECT_TRUE(found->isAssociation());
  EXPECT_EQ(found->isA("CIM_ElementSettingData"), keyed);
  EXPECT_THAT(found->properties, SizeIs(7));
  for (const Cimom::PropertyDeclaration& property : found->properties) {
    EXPECT_EQ(property.isKey(), keyed && (property.name == "ManagedElement" || property.name == "SettingData"))
        << property.name;
  }
}

INSTANTIATE_TEST_SUITE_P(Of, ClassFilesTest, testing::ValuesIn(objectManagers),
                         [](const auto& row) { return std::string(row.param); });

TEST(RegistrationFilesTest, AreReadByCimomdAndNameTheClassesOfTheirSet) {
  for (const char* objectManager : {"cimomd", "sfcb"}) {
    for (const char* set : sets) {
      const MofDeclarations declared = read(fileOf(objectManager, std::string(set) + ".mof"));
      const auto registered = Cimom::readRegistration(fileOf(objectManager, std::string(set) + ".reg"));
      EXPECT_THAT(registered, SizeIs(declared.classes.size()));
      for (const Cimom::ProviderRegistration& registration : registered) {
        EXPECT_TRUE(findClass(declared, registration.className)) << registration.className;
      }
    }
  }
}

TEST(OwnClassesTest, SayWhatEveryClassAndPropertyIs) {
  for (const char* set : sets) {
    for (const ClassDeclaration& declaration : read(fileOf("cimomd", std::string(set) + ".mof")).classes) {
      const Cimom::ClassDefinition& own = declaration.own;
      EXPECT_TRUE(Cimom::findQualifier(own.qualifiers, "Description")) << own.name;
      EXPECT_THAT(own.properties, Not(IsEmpty())) << own.name;
      for (const Cimom::PropertyDeclaration& property : own.properties) {
        EXPECT_TRUE(Cimom::findQualifier(property.qualifiers, "Description")) << own.name << '.' << property.name;
      }
    }
  }
}

}  // namespace

}  // namespace Testing
