// SPDX-License-Identifier: Apache-2.0
#include "Paths.h"
#include "tests/support/broker/ManagedElements.h"
#include "tests/support/broker/RecordingProvider.h"
#include "tests/support/system/Build.h"
#include "tests/support/system/TemporaryDirectory.h"

namespace {

using namespace Cimom;
using namespace Testing;
using testing::AllOf;
using testing::ElementsAre;
using testing::HasSubstr;

class ProviderLoadingTest : public testing::Test {
 protected:
  ProviderLoadingTest() {
    manager.loadSchemaText(testSchema, testNamespace);
    directory.write("libgarbage.so", "not a library\n");
    manager.addProviderDirectory(directory.path());
    manager.addProviderDirectory(built("lib"));
  }

  void registerProvider(const std::string& provider, const std::string& location,
                        const std::string& className = "TST_Processor", const std::string& type = "instance") {
    manager.loadRegistration(directory.write("providers.reg", "[" + className + "]\nprovider: " + provider +
                                                                  "\nlocation: " + location + "\ntype: " + type +
                                                                  "\nnamespace: root/test\n"));
  }

  // The message with which an enumeration fails and, the same in substance, the one of the check.
  std::vector<std::string> complaints() {
    const RequestScope scope(manager.broker());
    CMPIStatus status = ok;
    const auto* path = CMNewObjectPath(manager.broker(), testNamespace, "TST_Processor", nullptr);
    EXPECT_EQ(CBEnumInstances(manager.broker(), RequestScope::current()->context(), path, nullptr, &status), nullptr);
    EXPECT_EQ(status.rc, CMPI_RC_ERR_FAILED);
    std::vector<std::string> result = {shownText(status.msg)};
    try {
      manager.checkProviders();
    } catch (const ConfigurationError& error) {
      result.emplace_back(error.what());
    }
    return result;
  }

  TemporaryDirectory directory;
  ObjectManager manager;
};

TEST_F(ProviderLoadingTest, ASharedObjectServesItsClass) {
  manager.loadSchema(SOURCE_DIR "/tests/support/probe/Probe.mof");
  registerProvider("ProbeProvider", "cimomprobe", "TEST_Thing");
  manager.checkProviders();
  const RequestScope scope(manager.broker());
  const auto* path = CMNewObjectPath(manager.broker(), testNamespace, "TEST_Thing", nullptr);
  CMPIContext* context = RequestScope::current()->context();
  const auto things = ElementsAre(HasSubstr("TEST_Thing.Name="), HasSubstr("TEST_Thing.Name="));
  EXPECT_THAT(pathsOf(CBEnumInstances(manager.broker(), context, path, nullptr, nullptr)), things);
  EXPECT_THAT(pathsOf(CBEnumInstanceNames(manager.broker(), context, path, nullptr)), things);
}

TEST_F(ProviderLoadingTest, AMissingLibraryIsNamedWithWhereItWasLookedFor) {
  registerProvider("ProbeSystem", "missing");
  EXPECT_THAT(complaints(),
              ElementsAre(AllOf(HasSubstr("libmissing.so"), HasSubstr(directory.path().string())),
                          AllOf(HasSubstr("providers.reg:1: provider ProbeSystem"), HasSubstr("libmissing.so"))));
}

TEST_F(ProviderLoadingTest, AFileThatIsNotALibraryIsNamedWithTheLoadersReason) {
  registerProvider("ProbeSystem", "garbage");
  EXPECT_THAT(complaints(),
              ElementsAre(AllOf(HasSubstr("cannot load "), HasSubstr("libgarbage.so: ")), HasSubstr("libgarbage.so")));
}

TEST_F(ProviderLoadingTest, AMissingFactoryIsNamed) {
  registerProvider("ProbeSystem", "instanceonly");
  EXPECT_THAT(complaints(), ElementsAre(HasSubstr("libinstanceonly.so has no function ProbeSystem_Create_InstanceMI"),
                                        HasSubstr("ProbeSystem_Create_InstanceMI")));
}

TEST_F(ProviderLoadingTest, AFactoryOfTheOtherTypeDoesNotDo) {
  registerProvider("InstanceOnly", "instanceonly", "TST_Hosted", "association");
  EXPECT_THROW(manager.checkProviders(), ConfigurationError);
}

TEST_F(ProviderLoadingTest, AProviderInCServesInstancesAssociationsAndMethods) {
  registerProvider("ForeignProvider", "foreignprovider", "TST_Processor", "instance association method");
  manager.checkProviders();
  RequestScope scope(manager.broker());
  const auto* path = CMNewObjectPath(manager.broker(), testNamespace, "TST_Processor", nullptr);
  EXPECT_THAT(pathsOf(CBEnumInstances(manager.broker(), scope.context(), path, nullptr, nullptr)),
              ElementsAre("root/test:TST_Processor"));
  CMPIStatus status = ok;
  CMPIArgs* in = CMNewArgs(manager.broker(), nullptr);
  const CMPIBoolean yes = 1;
  CMAddArg(in, "Force", &yes, CMPI_boolean);
  const CMPIData returned = CBInvokeMethod(manager.broker(), scope.context(), path, "Reset", in, nullptr, &status);
  EXPECT_EQ(status.rc, CMPI_RC_OK) << shownText(status.msg);
  EXPECT_EQ(returned.value.uint32, 1u);
  EXPECT_EQ(CBDeleteInstance(manager.broker(), scope.context(), path).rc, CMPI_RC_ERR_NOT_SUPPORTED);
}

TEST_F(ProviderLoadingTest, ALibraryThatDoesNotLoadLeavesTheOthersServed) {
  std::vector<std::string> log;
  manager.setLog([&](int, std::string_view, std::string_view text) { log.emplace_back(text); });
  manager.loadSchema(SOURCE_DIR "/tests/support/probe/Probe.mof");
  manager.loadRegistration(directory.write(
      "two.reg",
      "[TST_Processor]\nprovider: Broken\nlocation: garbage\ntype: instance association\nnamespace: root/test\n"
      "[TEST_Thing]\nprovider: ProbeProvider\nlocation: cimomprobe\ntype: instance\nnamespace: root/test\n"));
  manager.checkProviders();
  EXPECT_THAT(log, ElementsAre(AllOf(HasSubstr("two.reg:1: provider Broken: cannot load "),
                                     HasSubstr("libgarbage.so: "), HasSubstr("; its classes fail until"))))
      << "once, whatever it is registered for";
  const RequestScope scope(manager.broker());
  CMPIContext* context = RequestScope::current()->context();
  CMPIStatus status = ok;
  EXPECT_THAT(pathsOf(CBEnumInstances(manager.broker(), context,
                                      CMNewObjectPath(manager.broker(), testNamespace, "TEST_Thing", nullptr), nullptr,
                                      nullptr)),
              testing::SizeIs(2));
  CBEnumInstances(manager.broker(), context, CMNewObjectPath(manager.broker(), testNamespace, "TST_Processor", nullptr),
                  nullptr, &status);
  EXPECT_EQ(status.rc, CMPI_RC_ERR_FAILED);
  EXPECT_THAT(shownText(status.msg), HasSubstr("libgarbage.so"));
}

TEST_F(ProviderLoadingTest, AClassThatTheSchemaLacksIsFoundByTheCheck) {
  registerProvider("InstanceOnly", "instanceonly", "TST_Nothing");
  try {
    manager.checkProviders();
    FAIL();
  } catch (const ConfigurationError& error) {
    EXPECT_THAT(error.what(), HasSubstr("providers.reg:1: class TST_Nothing is not in the schema"));
  }
}

TEST_F(ProviderLoadingTest, ALinkedProviderWithoutTheFactoryIsNamed) {
  manager.addProvider({"TST_Processor", "Linked", "", true, false, {testNamespace}, ""}, nullptr, nullptr);
  EXPECT_THAT(complaints(), ElementsAre(HasSubstr("Linked_Create_InstanceMI"), HasSubstr("provider Linked")));
}

}  // namespace
