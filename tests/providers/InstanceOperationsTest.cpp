// SPDX-License-Identifier: Apache-2.0
// GetInstance, EnumInstances and EnumInstanceNames of the six composite classes: what reaches the result object, the
// agent's log and trace, and the broker's trace.
#include <stdexcept>

#include "tests/support/composite/Samples.h"

namespace {

using namespace Testing;

class InstanceOperationsTest : public CompositeTest, public ::testing::WithParamInterface<Unit> {
 protected:
  InstanceOperationsTest() : mi_(GetParam().createInstanceMI(broker(), context(), nullptr)) {}

  const Sample& sample() const { return sampleOf(GetParam().className); }
  CMPIInstance* add(int n) { return addUnderlying(sample().underlying, acceptable(sample(), n)); }
  UpCallScript& script() { return faults.upCallScripts[sample().underlying]; }

  CMPIStatus enumInstances(const CMPIObjectPath* path, const char** properties = nullptr) {
    return mi_->ft->enumerateInstances(mi_, context(), result.result(), path, properties);
  }
  CMPIStatus enumInstanceNames(const CMPIObjectPath* path) {
    return mi_->ft->enumerateInstanceNames(mi_, context(), result.result(), path);
  }
  CMPIStatus getInstance(const CMPIObjectPath* path, const char** properties = nullptr) {
    return mi_->ft->getInstance(mi_, context(), result.result(), path, properties);
  }
  CMPIObjectPath* classPath() { return makePath(GetParam().className); }
  CMPIObjectPath* instancePath(int n) { return makePath(GetParam().className, keysOf(sample(), n)); }

  // The frame's lines of an operation, and that each of them reached both channels at 4000 from the unit's component.
  std::string entering(const std::string& operation, int line) { return marker("ENTERING: ", operation, line); }
  std::string exiting(const std::string& operation, int line) { return marker("EXITING: ", operation, line); }

  void expectOpened(const std::string& operation, int line) {
    ASSERT_GE(logLines().size(), 4u);
    EXPECT_EQ(logLines()[0].message, std::string(78, '='));
    EXPECT_EQ(logLines()[2].message, entering(operation, line));
    for (int i = 0; i < 4; ++i) {
      EXPECT_EQ(logLines()[i].component, GetParam().component);
      EXPECT_EQ(logLines()[i].level, 4000);
      EXPECT_EQ(logLines()[i].channel, i % 2 == 0 ? Channel::Log : Channel::Trace);
    }
  }

  void expectClosed(const std::string& operation, int line) {
    const std::vector<LogLine>& lines = logLines();
    ASSERT_GE(lines.size(), 4u);
    EXPECT_EQ(lines[lines.size() - 4].message, exiting(operation, line));
    EXPECT_EQ(lines[lines.size() - 1].message, std::string(78, '='));
    EXPECT_EQ(lines[lines.size() - 1].component, GetParam().component);
  }

  void expectNotClosed(const std::string& operation) {
    EXPECT_TRUE(messagesWith("EXITING: " + GetParam().prefix + operation).empty());
  }

  RecordingResult result;

 private:
  std::string marker(const char* kind, const std::string& operation, int line) {
    return kind + GetParam().prefix + operation + "() in " + GetParam().file + " [Line: " + std::to_string(line) + "]";
  }

  CMPIInstanceMI* mi_;
};

INSTANTIATE_TEST_SUITE_P(Six, InstanceOperationsTest, ::testing::ValuesIn(instanceUnits()), nameOf);

TEST_P(InstanceOperationsTest, EnumInstancesAnswersEveryInstanceThenDone) {
  add(1);
  add(2);
  add(3);
  const CMPIStatus answer = enumInstances(classPath());
  EXPECT_EQ(answer.rc, CMPI_RC_OK);
  EXPECT_EQ(result.order, (std::vector<std::string>{"instance", "instance", "instance", "done"}));
  for (int n = 1; n <= 3; ++n) {
    for (const auto& [name, value] : keysOf(sample(), n)) {
      EXPECT_EQ(text(result.instances[n - 1], name), value);
      EXPECT_EQ(key(pathOf(result.instances[n - 1]), name), value);
    }
  }
  expectOpened("EnumInstances", 75);
  expectClosed("EnumInstances", 114);
}

TEST_P(InstanceOperationsTest, EnumInstancesOfNothingIsDoneAndOk) {
  EXPECT_EQ(enumInstances(classPath()).rc, CMPI_RC_OK);
  EXPECT_EQ(result.order, std::vector<std::string>{"done"});
  expectClosed("EnumInstances", 114);
}

TEST_P(InstanceOperationsTest, EachOperationMakesOneUpCallForAllPropertiesOfTheUnderlyingClass) {
  add(1);
  const char* properties[] = {"Name", nullptr};
  enumInstances(classPath(), properties);
  getInstance(instancePath(1), properties);
  enumInstanceNames(classPath());
  EXPECT_EQ(faults.upCalls, std::vector<UpCall>(3, UpCall{"root/yrnse", sample().underlying, false}));
}

TEST_P(InstanceOperationsTest, AnUnderlyingFailureIsTheClientsStatus) {
  add(1);
  script().status = {CMPI_RC_ERR_ACCESS_DENIED, CMNewString(faults.real(), "not for you", nullptr)};
  for (const CMPIStatus& answer : {enumInstances(classPath()), enumInstanceNames(classPath())}) {
    EXPECT_EQ(answer.rc, CMPI_RC_ERR_ACCESS_DENIED);
    EXPECT_EQ(text(answer.msg), "not for you");
  }
  EXPECT_EQ(getInstance(instancePath(1)).rc, CMPI_RC_ERR_ACCESS_DENIED);
  EXPECT_TRUE(result.instances.empty());
  EXPECT_TRUE(result.paths.empty());
  EXPECT_EQ(result.done, 3) << "the enumeration ran, so each operation ends in the ordinary way";
}

TEST_P(InstanceOperationsTest, ANullEnumerationWithStatusOkCountsAsEmpty) {
  script().nullEnumeration = true;
  EXPECT_EQ(enumInstances(classPath()).rc, CMPI_RC_OK);
  EXPECT_EQ(result.order, std::vector<std::string>{"done"});
}

TEST_P(InstanceOperationsTest, AnotherClassEndsEnumInstancesWithTheExitMarkerAndWithoutDone) {
  add(1);
  const CMPIStatus answer = enumInstances(makePath("CIM_ManagedElement"));
  EXPECT_EQ(answer.rc, CMPI_RC_OK);
  EXPECT_TRUE(result.order.empty());
  EXPECT_EQ(faults.traces,
            (std::vector<BrokerTrace>{{CMPI_LEV_WARNING, "CompositeIPConfigProvider", "***No instance found***"}}));
  expectClosed("EnumInstances", 98);
}

TEST_P(InstanceOperationsTest, AnotherClassEndsTheOtherTwoWithNeither) {
  EXPECT_EQ(enumInstanceNames(makePath("CIM_ManagedElement")).rc, CMPI_RC_OK);
  expectOpened("EnumInstanceNames", 137);
  expectNotClosed("EnumInstanceNames");
  EXPECT_EQ(getInstance(makePath("CIM_ManagedElement", {{"InstanceID", "BMC:eth1"}})).rc, CMPI_RC_OK);
  expectNotClosed("GetInstance");
  EXPECT_TRUE(result.order.empty());
  EXPECT_TRUE(faults.upCalls.empty());
}

TEST_P(InstanceOperationsTest, AClassNameInAnotherLetterCaseWorks) {
  add(1);
  std::string shouting = GetParam().className;
  for (char& letter : shouting) {
    letter = static_cast<char>(std::toupper(letter));
  }
  enumInstances(makePath(shouting));
  EXPECT_EQ(result.instances.size(), 1u);
  getInstance(makePath(shouting, keysOf(sample(), 1)));
  EXPECT_EQ(result.instances.size(), 2u);
}

TEST_P(InstanceOperationsTest, EnumInstanceNamesAnswersThePathsOfTheRequestsNameSpaceAndTheSystemsHost) {
  add(1);
  add(2);
  const CMPIStatus answer = enumInstanceNames(classPath());
  EXPECT_EQ(answer.rc, CMPI_RC_OK);
  EXPECT_EQ(result.order, (std::vector<std::string>{"path", "path", "done"}));
  for (int n = 1; n <= 2; ++n) {
    const CMPIObjectPath* path = result.paths[n - 1];
    EXPECT_EQ(classOf(path), GetParam().className);
    EXPECT_EQ(nameSpaceOf(path), requestNameSpace);
    EXPECT_EQ(hostOf(path), systemName());
    EXPECT_EQ(CMGetKeyCount(path, nullptr), sample().keys.size());
    for (const auto& [name, value] : keysOf(sample(), n)) {
      EXPECT_EQ(key(path, name), value);
    }
  }
  expectOpened("EnumInstanceNames", 137);
  expectClosed("EnumInstanceNames", 184);
}

TEST_P(InstanceOperationsTest, GetInstanceAnswersTheOneThatMatches) {
  add(1);
  add(2);
  add(3);
  const CMPIStatus answer = getInstance(instancePath(2));
  EXPECT_EQ(answer.rc, CMPI_RC_OK);
  ASSERT_EQ(result.order, (std::vector<std::string>{"instance", "done"}));
  for (const auto& [name, value] : keysOf(sample(), 2)) {
    EXPECT_EQ(text(result.instances[0], name), value);
  }
  expectOpened("GetInstance", 207);
  expectClosed("GetInstance", 265);
}

TEST_P(InstanceOperationsTest, GetInstanceAnswersTheFirstOfTwoThatMatch) {
  add(1);
  add(1);
  getInstance(instancePath(1));
  EXPECT_EQ(result.order, (std::vector<std::string>{"instance", "done"}));
}

TEST_P(InstanceOperationsTest, GetInstanceOfNothingKnownIsOkAndEmpty) {
  add(1);
  const CMPIStatus answer = getInstance(instancePath(9));
  EXPECT_EQ(answer.rc, CMPI_RC_OK);
  EXPECT_EQ(result.order, std::vector<std::string>{"done"});
  expectClosed("GetInstance", 265);
}

TEST_P(InstanceOperationsTest, GetInstanceWithoutKeysIsRefusedBeforeAnythingIsRead) {
  add(1);
  const CMPIStatus answer = getInstance(countingNoKeys(classPath()));
  EXPECT_EQ(answer.rc, CMPI_RC_ERR_FAILED);
  EXPECT_EQ(text(answer.msg), "At least one key should be passed");
  EXPECT_EQ(result.order, std::vector<std::string>{"done"});
  EXPECT_EQ(
      faults.traces,
      (std::vector<BrokerTrace>{{CMPI_LEV_INFO, "CompositeIPConfigProvider", "At least one key should be passed"}}));
  EXPECT_TRUE(faults.upCalls.empty());
  expectOpened("GetInstance", 207);
  expectClosed("GetInstance", 265);
}

TEST_P(InstanceOperationsTest, GetInstanceWithoutKeysAndBrokerHasNoMessage) {
  CMPIInstanceMI* mi = GetParam().createInstanceMI(nullptr, nullptr, nullptr);
  const CMPIStatus answer = mi->ft->getInstance(mi, context(), result.result(), countingNoKeys(classPath()), nullptr);
  EXPECT_EQ(answer.rc, CMPI_RC_ERR_FAILED);
  EXPECT_EQ(answer.msg, nullptr);
  EXPECT_EQ(result.done, 1);
}

// Of each class two properties that are copied from the underlying instance and are no keys.
// The first has a default in the DMTF's class where one of the two has: a default shows also when nothing was set.
const std::map<std::string, std::pair<std::string, std::string>> copiedBesideTheKeys = {
    {Classes::computerSystem, {"Description", "NameFormat"}},
    {Classes::endpoint, {"IPv4Address", "SubnetMask"}},
    {Classes::sequence, {"AddressOrigin", "ElementName"}},
    {Classes::staticSetting, {"AddressOrigin", "ElementName"}},
    {Classes::dhcpSetting, {"AddressOrigin", "ElementName"}},
    {Classes::remoteAccessPoint, {"AccessInfo", "OtherAccessContext"}},
};

TEST_P(InstanceOperationsTest, APropertyListShowsWhatItNamesAndTheKeys) {
  const auto& [listed, other] = copiedBesideTheKeys.at(GetParam().className);
  CMPIInstance* underlying = add(1);
  if (sample().keys.size() == 4) {
    CMSetProperty(underlying, listed.c_str(), "listed", CMPI_chars);
    CMSetProperty(underlying, other.c_str(), "other", CMPI_chars);
  }
  const char* properties[] = {listed.c_str(), nullptr};
  enumInstances(classPath(), properties);
  getInstance(instancePath(1), properties);
  ASSERT_EQ(result.instances.size(), 2u);
  for (const CMPIInstance* instance : result.instances) {
    for (const auto& [name, value] : keysOf(sample(), 1)) {
      EXPECT_EQ(key(pathOf(instance), name), value);
    }
    EXPECT_TRUE(hasProperty(instance, listed));
    // OpenPegasus filters what it sends instead of what is set.
    EXPECT_EQ(hasProperty(instance, other), !personality().filterDropsOthers);
  }
}

TEST_P(InstanceOperationsTest, AnInstanceThatCannotBeMadeIsAnsweredByEnumInstancesAndSkippedByTheOthers) {
  add(1);
  add(2);
  faults.failNewInstance = [](const std::string&, int call) { return call % 2 == 1; };
  enumInstances(classPath());
  ASSERT_EQ(result.instances.size(), 2u);
  EXPECT_EQ(result.instances[0], nullptr);
  EXPECT_NE(result.instances[1], nullptr);

  enumInstanceNames(classPath());
  ASSERT_EQ(result.paths.size(), 1u);
  EXPECT_EQ(key(result.paths[0], keysOf(sample(), 2).back().first), keysOf(sample(), 2).back().second);

  getInstance(instancePath(2));
  EXPECT_EQ(result.instances.size(), 3u);
  EXPECT_EQ(result.done, 3);
}

TEST_P(InstanceOperationsTest, APathThatCannotBeMadeYieldsANullInstance) {
  add(1);
  faults.failNewObjectPath = [&](const std::string& className, int) { return className == GetParam().className; };
  EXPECT_EQ(enumInstances(classPath()).rc, CMPI_RC_OK);
  EXPECT_EQ(result.instances, std::vector<const CMPIInstance*>{nullptr});
  enumInstanceNames(classPath());
  EXPECT_TRUE(result.paths.empty());
}

TEST_P(InstanceOperationsTest, AnUnderlyingPathThatCannotBeMadeIsAskedForAllTheSameAndTheBrokersAnswerIsTheClients) {
  add(1);
  faults.failNewObjectPath = [&](const std::string& className, int) { return className == sample().underlying; };
  faults.upCallScripts[""].status = {CMPI_RC_ERR_INVALID_PARAMETER, CMNewString(faults.real(), "no path", nullptr)};
  const CMPIStatus answer = enumInstances(classPath());
  EXPECT_EQ(answer.rc, CMPI_RC_ERR_INVALID_PARAMETER);
  EXPECT_EQ(text(answer.msg), "no path");
  EXPECT_TRUE(result.instances.empty());
  EXPECT_EQ(faults.upCalls, (std::vector<UpCall>{{"", "", false}}));
}

TEST_P(InstanceOperationsTest, AnItemIsItsInstanceWhateverItsStateSays) {
  CMPIInstance* underlying = makeInstance("root/yrnse", sample().underlying, acceptable(sample(), 1));
  for (const CMPIValueState state : {CMPI_goodValue, CMPI_nullValue, CMPI_keyValue, CMPI_notFound, CMPI_badValue}) {
    CMPIData item = {CMPI_instance, state, {}};
    item.value.inst = underlying;
    script().items = {item};
    result.instances.clear();
    EXPECT_EQ(enumInstances(classPath()).rc, CMPI_RC_OK);
    ASSERT_EQ(result.instances.size(), 1u) << state;
    for (const auto& [name, value] : keysOf(sample(), 1)) {
      EXPECT_EQ(text(result.instances.front(), name), value) << state;
    }
  }
}

TEST_P(InstanceOperationsTest, AnItemThatIsNoInstanceIsNeverFollowed) {
  constexpr CMPIType types[] = {CMPI_null, CMPI_boolean, CMPI_uint8,  CMPI_uint64,    CMPI_real64,   CMPI_ref,
                                CMPI_args, CMPI_filter,  CMPI_chars,  CMPI_string,    CMPI_booleanA, CMPI_dateTime,
                                CMPI_ptr,  CMPI_class,   CMPI_uint8A, CMPI_instanceA, CMPI_stringA};
  for (const CMPIType type : types) {
    // Whoever follows this pointer as an instance dies of it.
    CMPIData item = {type, CMPI_goodValue, {}};
    item.value.uint64 = 8;
    script().items.push_back(item);
  }
  EXPECT_EQ(enumInstances(classPath()).rc, CMPI_RC_OK);
  // Only the computer systems are taken without a look at a property.
  const bool takesEvery = GetParam().className == Classes::computerSystem;
  ASSERT_EQ(result.instances.size(), takesEvery ? std::size(types) : 0u);
  for (const CMPIInstance* instance : result.instances) {
    EXPECT_FALSE(hasProperty(instance, "Name"));
    EXPECT_FALSE(hasProperty(instance, "Dedicated"));
    EXPECT_TRUE(hasProperty(instance, "Index"));
  }
}

TEST_P(InstanceOperationsTest, NullUnderlyingInstancesDoNoHarm) {
  add(1);
  script().instances.push_back(nullptr);
  script().instances.push_back(withoutHandle());
  EXPECT_EQ(enumInstances(classPath()).rc, CMPI_RC_OK);
  EXPECT_EQ(enumInstanceNames(classPath()).rc, CMPI_RC_OK);
  EXPECT_EQ(getInstance(instancePath(1)).rc, CMPI_RC_OK);
}

TEST_P(InstanceOperationsTest, AnInstanceWithoutPathHasNoNameAndMatchesNothing) {
  add(1);
  const CMPIObjectPath* path = instancePath(1);
  for (CMPIObjectPath* unusable : {static_cast<CMPIObjectPath*>(nullptr), pathWithoutHandle()}) {
    faults.onNewInstance = [unusable](const std::string& className, int, CMPIInstance* instance) {
      if (className == GetParam().className) {
        withPath(instance, unusable);
      }
    };
    result.order.clear();
    EXPECT_EQ(enumInstances(classPath()).rc, CMPI_RC_OK);
    // The object manager says itself that it has no path.
    const CMPIrc code = unusable ? CMPI_RC_OK : CMPI_RC_ERR_FAILED;
    EXPECT_EQ(enumInstanceNames(classPath()).rc, code);
    EXPECT_EQ(getInstance(path).rc, code);
    EXPECT_EQ(result.order, (std::vector<std::string>{"instance", "done", "done", "done"}));
  }
}

TEST_P(InstanceOperationsTest, AnExceptionPassesThroughToTheObjectManager) {
  faults.onUpCall = [](const UpCall&) { throw std::runtime_error("thrown below"); };
  EXPECT_THROW(enumInstances(classPath()), std::runtime_error);
  EXPECT_THROW(enumInstanceNames(classPath()), std::runtime_error);
  EXPECT_THROW(getInstance(instancePath(1)), std::runtime_error);
  EXPECT_TRUE(result.order.empty());
}

}  // namespace
