// SPDX-License-Identifier: Apache-2.0
// The factory's read pairs, for all six composite classes.
#include <ostream>

#include "factory/IPConfigObjectFactory.h"
#include "tests/support/composite/Samples.h"

namespace {

using namespace Testing;
using QV::IPConfigComposite::GetAll;
using QV::IPConfigComposite::IPConfigObjectFactory;
using Make = CMPIInstance* (IPConfigObjectFactory::*)(const CMPIBroker*, const CMPIObjectPath*, const char**, bool,
                                                      CMPIStatus*);

struct Pair {
  std::string className;
  GetAll getAll;
  Make make;
};

void PrintTo(const Pair& pair, std::ostream* stream) { *stream << pair.className; }

#define PAIR(className, getAll, make) \
  { className, &IPConfigObjectFactory::getAll, &IPConfigObjectFactory::make }

const Pair pairs[] = {
    PAIR(Classes::computerSystem, getAllSPComputerCMPIInstances, makeSPComputerInstance),
    PAIR(Classes::endpoint, getAllIPProtocolendptCMPIInstances, makeIPProtocolEndptInstance),
    PAIR(Classes::sequence, getAllIPAssignmentSettingCMPIInstances, makeIPAssignmentSettingInstance),
    PAIR(Classes::staticSetting, getAllStaticIPAssignmentSettingCMPIInstances, makeStaticIPAssignmentSettingInstance),
    PAIR(Classes::dhcpSetting, getAllDHCPAssignmentSettingCMPIInstances, makeDHCPAssignmentSettingInstance),
    PAIR(Classes::remoteAccessPoint, getAllIPRemoteSAPCMPIInstances, makeIPRemoteSAPInstance),
};

class CompositeInstancesTest : public CompositeTest, public ::testing::WithParamInterface<Pair> {
 protected:
  const Sample& sample() const { return sampleOf(GetParam().className); }

  int getAll(const std::string& className, const char** properties = nullptr, bool noFilter = false) {
    return (factory_.*GetParam().getAll)(broker(), context(), request_, className.c_str(), properties, noFilter, out,
                                         &status);
  }
  int getAll() { return getAll(GetParam().className); }
  CMPIInstance* make(const char** properties = nullptr, bool noFilter = false) {
    return (factory_.*GetParam().make)(broker(), request_, properties, noFilter, &status);
  }

  static std::string line(const char* form, const std::string& function) {
    return std::string(form) + function + "() in IPConfigObjectFactory";
  }

  std::vector<CMPIInstance*> out;

 private:
  IPConfigObjectFactory factory_;
  CMPIObjectPath* request_ = makePath(GetParam().className);
};

std::string nameOf(const ::testing::TestParamInfo<Pair>& info) { return info.param.className; }

INSTANTIATE_TEST_SUITE_P(Six, CompositeInstancesTest, ::testing::ValuesIn(pairs), nameOf);

TEST_P(CompositeInstancesTest, EveryAcceptedUnderlyingInstanceBecomesOneOfTheRequestsNameSpaceAndTheSystemsHost) {
  addUnderlying(sample().underlying, acceptable(sample(), 1));
  addUnderlying(sample().underlying, acceptable(sample(), 2));
  EXPECT_EQ(getAll(), 0);
  EXPECT_EQ(status.rc, CMPI_RC_OK);
  ASSERT_EQ(out.size(), 2u);
  for (int n = 1; n <= 2; ++n) {
    const CMPIObjectPath* path = pathOf(out[n - 1]);
    EXPECT_EQ(classOf(path), GetParam().className);
    EXPECT_EQ(nameSpaceOf(path), requestNameSpace);
    for (const auto& [name, value] : keysOf(sample(), n)) {
      EXPECT_EQ(text(out[n - 1], name), value);
    }
  }
}

TEST_P(CompositeInstancesTest, TheVectorIsAppendedToAndNeverCleared) {
  addUnderlying(sample().underlying, acceptable(sample(), 1));
  EXPECT_EQ(getAll(), 0);
  EXPECT_EQ(getAll(), 0);
  EXPECT_EQ(out.size(), 2u);
}

TEST_P(CompositeInstancesTest, AnotherClassIsRefusedWithoutTouchingTheStatus) {
  addUnderlying(sample().underlying, acceptable(sample(), 1));
  status.rc = CMPI_RC_ERR_INVALID_QUERY;
  EXPECT_EQ(getAll("CIM_ManagedElement"), 1);
  EXPECT_EQ(status.rc, CMPI_RC_ERR_INVALID_QUERY);
  EXPECT_TRUE(out.empty());
  EXPECT_TRUE(faults.upCalls.empty());
  EXPECT_EQ(faults.traces,
            (std::vector<BrokerTrace>{{CMPI_LEV_WARNING, "CompositeIPConfigProvider", "***No instance found***"}}));
  EXPECT_EQ(messagesWith(line("ENTERING: ", sample().getAll)).size(), 1u);
  EXPECT_TRUE(messagesWith("EXITING").empty());
}

TEST_P(CompositeInstancesTest, ANullOrEmptyClassNameIsAnotherClass) {
  EXPECT_EQ(getAll(""), 1);
  IPConfigObjectFactory factory;
  EXPECT_EQ((factory.*GetParam().getAll)(broker(), context(), makePath("CIM_ManagedElement"), nullptr, nullptr, false,
                                         out, &status),
            1);
}

TEST_P(CompositeInstancesTest, AFailedEnumerationIsToldByTheStatusAlone) {
  addUnderlying(sample().underlying, acceptable(sample(), 1));
  faults.upCallScripts[sample().underlying].status = {CMPI_RC_ERR_FAILED, CMNewString(faults.real(), "down", nullptr)};
  EXPECT_EQ(getAll(), 0);
  EXPECT_EQ(status.rc, CMPI_RC_ERR_FAILED);
  EXPECT_EQ(text(status.msg), "down");
  EXPECT_TRUE(out.empty());
  EXPECT_EQ(messagesWith(line("EXITING: ", sample().getAll)).size(), 1u);
}

TEST_P(CompositeInstancesTest, OnlyTheSequenceEndsWithTheMarkersRule) {
  EXPECT_EQ(getAll(), 0);
  const bool sequence = GetParam().className == Classes::sequence;
  EXPECT_EQ(messages().back() == std::string(78, '='), sequence);
  EXPECT_EQ(messagesWith(line("EXITING: ", sample().getAll)).size(), 1u);
}

TEST_P(CompositeInstancesTest, MakingAnInstanceTellsEachStep) {
  EXPECT_NE(make(), nullptr);
  const std::vector<std::string> expected = {line("ENTERING: ", sample().make),
                                             "Calling CMNewObjectPath",
                                             "Calling CMSetNameSpace",
                                             "'namesp' has Value 'root/cimv2'",
                                             "'systemname' has Value '" + systemName() + "'",
                                             "Calling CMSetHostname",
                                             "Calling CMNewInstance",
                                             line("EXITING: ", sample().make)};
  ASSERT_EQ(messages().size(), expected.size());
  for (std::size_t i = 0; i < expected.size(); ++i) {
    EXPECT_NE(messages()[i].find(expected[i]), std::string::npos) << messages()[i];
  }
  for (const LogLine& logged : logLines()) {
    EXPECT_EQ(logged.component, "Tarnwick.IPObjectFactory");
    EXPECT_EQ(logged.level, 4000);
    EXPECT_EQ(logged.function, sample().make);
    EXPECT_EQ(logged.file, "IPConfigObjectFactory");
  }
}

TEST_P(CompositeInstancesTest, MakingWithoutAPathEndsEarly) {
  faults.failNewObjectPath = [](const std::string&, int) { return true; };
  for (CMPIObjectPath* unusable : {static_cast<CMPIObjectPath*>(nullptr), pathWithoutHandle()}) {
    faults.unmadePath = unusable;
    EXPECT_EQ(make(), nullptr);
    EXPECT_EQ(messages().size() % 3, 0u);
    EXPECT_TRUE(messages().back().starts_with("EXITING: ")) << messages().back();
  }
}

TEST_P(CompositeInstancesTest, MakingForARequestWithoutAPathNamesNoNamespace) {
  (IPConfigObjectFactory().*GetParam().make)(broker(), nullptr, nullptr, false, &status);
  ASSERT_GT(messages().size(), 3u);
  EXPECT_NE(messages()[3].find("VARIABLE: 'namesp' has Value '' at"), std::string::npos) << messages()[3];
}

TEST_P(CompositeInstancesTest, MakingWithoutAnInstanceAnswersNull) {
  faults.failNewInstance = [](const std::string&, int) { return true; };
  EXPECT_EQ(make(), nullptr);
  EXPECT_EQ(messages().back().find("EXITING: "), 0u);
}

TEST_P(CompositeInstancesTest, ANewInstanceHasItsConstantPropertiesAndNoOthers) {
  const CMPIInstance* instance = make();
  const bool setting = sample().keys.size() == 1;
  EXPECT_EQ(hasProperty(instance, "CreationClassName"), !setting);
  if (!setting) {
    EXPECT_EQ(text(instance, "CreationClassName"), GetParam().className);
  }
  if (sample().keys.size() == 4) {
    EXPECT_EQ(text(instance, "SystemCreationClassName"), Classes::computerSystem);
  }
  EXPECT_FALSE(hasProperty(instance, "ElementName"));
}

TEST_P(CompositeInstancesTest, NoFilterLeavesEveryPropertyVisible) {
  const char* properties[] = {"Caption", nullptr};
  for (const bool noFilter : {false, true}) {
    CMPIInstance* instance = make(properties, noFilter);
    CMSetProperty(instance, "Description", "seen", CMPI_chars);
    // OpenPegasus filters what it sends instead of what is set.
    EXPECT_EQ(hasProperty(instance, "Description"), noFilter || !personality().filterDropsOthers);
  }
}

TEST_P(CompositeInstancesTest, AnInstanceThatCannotBeMadeIsAppendedAsItIs) {
  addUnderlying(sample().underlying, acceptable(sample(), 1));
  faults.failNewInstance = [](const std::string&, int) { return true; };
  for (CMPIInstance* unusable : {static_cast<CMPIInstance*>(nullptr), withoutHandle()}) {
    faults.unmadeInstance = unusable;
    out.clear();
    EXPECT_EQ(getAll(), 0);
    EXPECT_EQ(out, std::vector<CMPIInstance*>{unusable});
  }
}

TEST_P(CompositeInstancesTest, WronglyTypedUnderlyingPropertiesCountAsUnset) {
  CMPIData numbers = {CMPI_uint32, CMPI_goodValue, {}};
  numbers.value.uint32 = 7;
  CMPIInstance* underlying = addUnderlying(sample().underlying, acceptable(sample(), 1));
  for (const char* name : {"ElementName", "NameFormat", "Description", "AccessInfo"}) {
    withProperty(underlying, name, numbers);
  }
  EXPECT_EQ(getAll(), 0);
  ASSERT_EQ(out.size(), 1u);
  EXPECT_FALSE(hasProperty(out[0], "NameFormat"));
  EXPECT_FALSE(hasProperty(out[0], "Description"));
}

class ComputerSystemsTest : public CompositeTest {};

TEST_F(ComputerSystemsTest, ThoseReadBeforeTheBrokerRanOutOfMemoryStay) {
  for (const char* name : {"sp1", "sp2", "sp3"}) {
    addUnderlying("YRNQV_SPComputerSystem", {{"Name", name}});
  }
  faults.failNewInstance = [&](const std::string&, int call) {
    faults.failNewArray = call == 2;
    return false;
  };
  std::vector<CMPIInstance*> out;
  EXPECT_EQ(
      IPConfigObjectFactory().getAllSPComputerCMPIInstances(broker(), context(), makePath(Classes::computerSystem),
                                                            Classes::computerSystem, nullptr, false, out, &status),
      1);
  EXPECT_EQ(status.rc, CMPI_RC_ERR_FAILED);
  ASSERT_EQ(out.size(), 1u);
  EXPECT_EQ(text(out[0], "Name"), "sp1");
}

}  // namespace
