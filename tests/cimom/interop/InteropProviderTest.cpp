// SPDX-License-Identifier: Apache-2.0
// What cimomd says of itself, through the up-calls that a client's requests become.
#include <cmpimacs.h>
#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include "Paths.h"
#include "cimom/ObjectManager.h"
#include "cimom/broker/RequestScope.h"
#include "cimom/interop/InteropProvider.h"

namespace {

using namespace Cimom;
using testing::AllOf;
using testing::ElementsAre;
using testing::HasSubstr;
using testing::IsEmpty;
using testing::SizeIs;
using testing::StartsWith;
using testing::UnorderedElementsAre;

constexpr const char* pathOfManager =
    "root/"
    "interop:CIM_ObjectManager.Name=\"CompositeIPConfig:cimomd\",SystemCreationClassName=\"CIM_ComputerSystem\","
    "SystemName=\"here\","
    "CreationClassName=\"CIM_ObjectManager\"";

// The macros of CMPI evaluate what they are given more than once.
CMPIValue next(CMPIEnumeration* objects) { return CMGetNext(objects, nullptr).value; }

std::string textOf(const CMPIString* text) { return text ? CMGetCharsPtr(text, nullptr) : "null"; }

class InteropProviderTest : public testing::Test {
 protected:
  InteropProviderTest() {
    manager_.loadSchema(SOURCE_DIR "/schema/CIM_Interop.mof");
    manager_.loadSchemaText("class TEST_Central { [Key] string Name; };", "root/test");
    const Profile whole{"Whole", "2.0", "All of it.", "TEST_Central", {"Part"}};
    const Profile part{"Part", "1.1", "Half of it.", "TEST_Nowhere", {}};
    const LinkedProvider interop = interopProvider(manager_.classes(), {"here", "9.8.7", {whole, part}});
    for (const ProviderRegistration& registration : interop.registrations) {
      manager_.addProvider(registration, interop.instanceFactory, interop.associationFactory);
    }
    manager_.checkProviders();
  }

  CMPIObjectPath* path(const std::string& className, const std::string& instanceId = {}) {
    CMPIObjectPath* made = CMNewObjectPath(manager_.broker(), "root/interop", className.c_str(), nullptr);
    if (!instanceId.empty()) {
      CMAddKey(made, "InstanceID", instanceId.c_str(), CMPI_chars);
    }
    return made;
  }

  // The one object manager, as a client has got its path.
  CMPIObjectPath* managerPath() {
    CMPIEnumeration* names =
        CBEnumInstanceNames(manager_.broker(), scope_.context(), path("CIM_ObjectManager"), nullptr);
    return next(names).ref;
  }

  std::vector<std::string> pathsOf(CMPIEnumeration* names) {
    std::vector<std::string> texts;
    while (names && CMHasNext(names, nullptr)) {
      const CMPIObjectPath* name = next(names).ref;
      texts.push_back(textOf(CDToString(manager_.broker(), name, nullptr)));
    }
    return texts;
  }

  std::vector<std::string> pathsOf(const std::string& className) {
    return pathsOf(CBEnumInstanceNames(manager_.broker(), scope_.context(), path(className), nullptr));
  }

  // A text property of every instance of a class.
  std::vector<std::string> propertyOf(const std::string& className, const char* property) {
    CMPIEnumeration* instances =
        CBEnumInstances(manager_.broker(), scope_.context(), path(className), nullptr, nullptr);
    std::vector<std::string> texts;
    while (instances && CMHasNext(instances, nullptr)) {
      const CMPIInstance* instance = next(instances).inst;
      texts.push_back(textOf(CMGetProperty(instance, property, nullptr).value.string));
    }
    return texts;
  }

  ObjectManager manager_;
  RequestScope scope_{manager_.broker()};
};

TEST_F(InteropProviderTest, ThereIsOneObjectManagerWithNameAndVersion) {
  EXPECT_THAT(pathsOf("CIM_ObjectManager"), ElementsAre(pathOfManager));
  EXPECT_THAT(propertyOf("CIM_ObjectManager", "ElementName"), ElementsAre("cimomd"));
  EXPECT_THAT(propertyOf("CIM_ObjectManager", "Description"),
              ElementsAre("cimomd, an embedded CIM object manager, version 9.8.7"));
}

TEST_F(InteropProviderTest, ThereIsANamespaceForEachThatTheServerHas) {
  EXPECT_THAT(propertyOf("CIM_Namespace", "Name"), ElementsAre("root/interop", "root/test"));
  EXPECT_THAT(pathsOf(CBAssociatorNames(manager_.broker(), scope_.context(), managerPath(), "CIM_NamespaceInManager",
                                        nullptr, nullptr, nullptr, nullptr)),
              SizeIs(2));
}

TEST_F(InteropProviderTest, AProfileIsTheProductsOwnAndSaysHowFarItGoes) {
  EXPECT_THAT(propertyOf("CIM_RegisteredProfile", "RegisteredName"), ElementsAre("Whole", "Part"));
  EXPECT_THAT(propertyOf("CIM_RegisteredProfile", "RegisteredVersion"), ElementsAre("2.0", "1.1"));
  EXPECT_THAT(propertyOf("CIM_RegisteredProfile", "Description"), ElementsAre("All of it.", "Half of it."));
  EXPECT_THAT(propertyOf("CIM_RegisteredProfile", "OtherRegisteredOrganization"),
              ElementsAre("CompositeIPConfig", "CompositeIPConfig"));
}

TEST_F(InteropProviderTest, AReferencedProfileIsTheAntecedent) {
  const std::vector<std::string> references = pathsOf("CIM_ReferencedProfile");
  ASSERT_THAT(references, SizeIs(1));
  EXPECT_THAT(references.front(), AllOf(HasSubstr("Antecedent=\"root/interop:CIM_RegisteredProfile.InstanceID="
                                                  "\\\"CompositeIPConfig:Part:1.1\\\"\""),
                                        HasSubstr("CompositeIPConfig:Whole:2.0")));
  EXPECT_THAT(pathsOf(CBAssociatorNames(manager_.broker(), scope_.context(),
                                        path("CIM_RegisteredProfile", "CompositeIPConfig:Whole:2.0"),
                                        "CIM_ReferencedProfile", nullptr, nullptr, nullptr, nullptr)),
              ElementsAre("root/interop:CIM_RegisteredProfile.InstanceID=\"CompositeIPConfig:Part:1.1\""));
  EXPECT_THAT(pathsOf(CBReferenceNames(manager_.broker(), scope_.context(),
                                       path("CIM_RegisteredProfile", "CompositeIPConfig:Part:1.1"),
                                       "CIM_ReferencedProfile", nullptr, nullptr)),
              ElementsAre(references.front()));
}

TEST_F(InteropProviderTest, AssociatorsAndReferencesReturnTheInstancesOfTheirNames) {
  const CMPIObjectPath* whole = path("CIM_RegisteredProfile", "CompositeIPConfig:Whole:2.0");
  CMPIEnumeration* associators = CBAssociators(manager_.broker(), scope_.context(), whole, "CIM_ReferencedProfile",
                                               nullptr, nullptr, nullptr, nullptr, nullptr);
  ASSERT_TRUE(associators && CMHasNext(associators, nullptr));
  const CMPIInstance* part = next(associators).inst;
  EXPECT_EQ(textOf(CMGetProperty(part, "RegisteredName", nullptr).value.string), "Part");
  CMPIEnumeration* references =
      CBReferences(manager_.broker(), scope_.context(), whole, "CIM_ReferencedProfile", nullptr, nullptr, nullptr);
  ASSERT_TRUE(references && CMHasNext(references, nullptr));
  const CMPIInstance* reference = next(references).inst;
  EXPECT_EQ(CMGetProperty(reference, "Dependent", nullptr).type, CMPI_ref);
}

TEST_F(InteropProviderTest, ACentralClassThatNobodyServesHasNothingThatConforms) {
  EXPECT_THAT(pathsOf("CIM_ElementConformsToProfile"), IsEmpty());
}

TEST_F(InteropProviderTest, AnObjectThatIsNotThereIsNotFound) {
  CMPIStatus status{CMPI_RC_OK, nullptr};
  EXPECT_FALSE(
      CBGetInstance(manager_.broker(), scope_.context(), path("CIM_RegisteredProfile", "none"), nullptr, &status));
  EXPECT_EQ(status.rc, CMPI_RC_ERR_NOT_FOUND);
  const CMPIInstance* found = CBGetInstance(manager_.broker(), scope_.context(), managerPath(), nullptr, &status);
  EXPECT_TRUE(found) << status.rc;
}

TEST_F(InteropProviderTest, NothingCanBeWritten) {
  EXPECT_EQ(CBDeleteInstance(manager_.broker(), scope_.context(), managerPath()).rc, CMPI_RC_ERR_NOT_SUPPORTED);
}

TEST(InteropClassesTest, ASchemaWithoutThemHasNoInteropNamespace) {
  ObjectManager manager;
  manager.loadSchemaText("class TEST_Thing { [Key] string Name; };", "root/test");
  EXPECT_THAT(interopProvider(manager.classes(), {"here", "1", {}}).registrations, IsEmpty());
}

}  // namespace
