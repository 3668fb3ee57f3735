// SPDX-License-Identifier: Apache-2.0
#include "tests/support/broker/ManagedElements.h"
#include "tests/support/broker/RecordingProvider.h"

namespace {

using namespace Cimom;
using namespace Testing;
using testing::ElementsAre;
using testing::HasSubstr;
using testing::IsEmpty;
using testing::SizeIs;

class InstanceOperationsTest : public ManagedElementsFixture {
 protected:
  InstanceOperationsTest() { probe->serve(manager, "TST_Processor", testNamespace); }

  // A provider that returns systems of these names, of the class that it is asked for.
  RecordingProvider::Answer returning(std::vector<std::string> names) {
    return
        [this, names](const CMPIContext*, const CMPIResult* result, const CMPIObjectPath* asked, const CMPIInstance*) {
          const std::string className = shownText(CMGetClassName(asked, nullptr));
          for (const std::string& name : names) {
            CMReturnInstance(result, system(name.c_str(), className.c_str()));
          }
          return ok;
        };
  }

  // Finds the system of that name, and answers everything else as given.
  RecordingProvider::Answer finding(const char* name, RecordingProvider::Answer otherwise = {}) {
    return [this, name, otherwise](const CMPIContext* given, const CMPIResult* result, const CMPIObjectPath* asked,
                                   const CMPIInstance* instance) {
      if (probe->calls.back().operation == "getInstance") {
        CMReturnInstance(result, system(name));
        return ok;
      }
      return otherwise ? otherwise(given, result, asked, instance) : ok;
    };
  }

  std::vector<std::string> operations() const {
    std::vector<std::string> names;
    for (const Call& call : probe->calls) {
      names.push_back(call.operation);
    }
    return names;
  }

  CMPIContext* context() { return request.context(); }

  std::shared_ptr<RecordingProvider> probe = std::make_shared<RecordingProvider>();
};

TEST_F(InstanceOperationsTest, AnUnknownNamespaceIsRefused) {
  EXPECT_EQ(CBEnumInstances(broker, context(), path("TST_Processor", "root/nowhere"), nullptr, &status), nullptr);
  EXPECT_EQ(status.rc, CMPI_RC_ERR_INVALID_NAMESPACE);
  EXPECT_THAT(shownText(status.msg), HasSubstr("root/nowhere"));
}

TEST_F(InstanceOperationsTest, AnUnknownClassIsRefused) {
  EXPECT_EQ(CBEnumInstanceNames(broker, context(), path("TST_Nothing"), &status), nullptr);
  EXPECT_EQ(status.rc, CMPI_RC_ERR_INVALID_CLASS);
  EXPECT_THAT(shownText(status.msg), HasSubstr("TST_Nothing"));
}

TEST_F(InstanceOperationsTest, AClassWithoutAProviderHasNoInstances) {
  CMPIEnumeration* found = CBEnumInstances(broker, context(), path("CIM_Point"), nullptr, &status);

  ASSERT_NE(found, nullptr);
  EXPECT_EQ(status.rc, CMPI_RC_OK);
  EXPECT_FALSE(CMHasNext(found, nullptr));
}

TEST_F(InstanceOperationsTest, AClassHasAProviderInItsRegisteredNamespacesOnly) {
  std::shared_ptr<RecordingProvider> other = std::make_shared<RecordingProvider>();
  ObjectManager second;
  second.loadSchemaText(testSchema, "root/a");
  other->serve(second, "TST_Processor", "root/b");
  const RequestScope scope(second.broker());
  CMPIContext* here = RequestScope::current()->context();
  const auto* inA = CMNewObjectPath(second.broker(), "root/a", "TST_Processor", nullptr);
  const auto* inB = CMNewObjectPath(second.broker(), "/ROOT/B/", "TST_Processor", nullptr);

  EXPECT_NE(CBEnumInstances(second.broker(), here, inA, nullptr, &status), nullptr);
  EXPECT_THAT(other->calls, IsEmpty());
  EXPECT_NE(CBEnumInstances(second.broker(), here, inB, nullptr, &status), nullptr);
  EXPECT_THAT(other->calls, SizeIs(1));
}

TEST_F(InstanceOperationsTest, EnumerationOfASuperclassCallsEachRegisteredSubclassWithItsName) {
  std::shared_ptr<RecordingProvider> other = std::make_shared<RecordingProvider>();
  other->serve(manager, "TST_Other", testNamespace);
  probe->answer = returning({"one", "two"});
  other->answer = returning({"three"});
  const char* properties[] = {"Name", nullptr};

  CMPIEnumeration* found = CBEnumInstances(broker, context(), path("CIM_Element"), properties, &status);

  EXPECT_EQ(status.rc, CMPI_RC_OK);
  EXPECT_THAT(pathsOf(found), ElementsAre("root/test:TST_Processor.CreationClassName=\"TST_Processor\",Name=\"one\"",
                                          "root/test:TST_Processor.CreationClassName=\"TST_Processor\",Name=\"two\"",
                                          "root/test:TST_Other.CreationClassName=\"TST_Other\",Name=\"three\""));
  ASSERT_THAT(probe->calls, SizeIs(1));
  EXPECT_EQ(probe->calls[0].path, "root/test:TST_Processor");
  EXPECT_THAT(probe->calls[0].properties, ElementsAre("Name"));
  ASSERT_THAT(other->calls, SizeIs(1));
  EXPECT_EQ(other->calls[0].path, "root/test:TST_Other");
}

TEST_F(InstanceOperationsTest, NamesAreThePathsThatTheProviderReturns) {
  probe->answer = [this](const CMPIContext*, const CMPIResult* result, const CMPIObjectPath*, const CMPIInstance*) {
    CMPIObjectPath* homeless = systemPath("one");
    CMSetNameSpace(homeless, "");
    CMReturnObjectPath(result, homeless);
    return ok;
  };

  CMPIEnumeration* found = CBEnumInstanceNames(broker, context(), path("tst_processor"), &status);

  EXPECT_THAT(pathsOf(found), ElementsAre("root/test:TST_Processor.CreationClassName=\"TST_Processor\",Name=\"one\""));
}

TEST_F(InstanceOperationsTest, WhatWasReturnedDoesNotChangeWithTheProvidersObject) {
  probe->answer = [this](const CMPIContext*, const CMPIResult* result, const CMPIObjectPath*, const CMPIInstance*) {
    CMPIInstance* reused = system("one");
    CMSetProperty(reused, "Caption", "first", CMPI_chars);
    CMReturnInstance(result, reused);
    CMSetProperty(reused, "Caption", "second", CMPI_chars);
    CMReturnInstance(result, reused);
    return ok;
  };

  CMPIEnumeration* found = CBEnumInstances(broker, context(), path("TST_Processor"), nullptr, &status);

  for (const char* expected : {"first", "second"}) {
    const CMPIData item = CMGetNext(found, nullptr);
    EXPECT_EQ(shownText(CMGetProperty(item.value.inst, "Caption", nullptr).value.string), expected);
  }
}

TEST_F(InstanceOperationsTest, AFailureAfterSomeResultsIsAllThatTheCallerGets) {
  probe->answer = [this](const CMPIContext*, const CMPIResult* result, const CMPIObjectPath*,
                         const CMPIInstance*) -> CMPIStatus {
    CMReturnInstance(result, system("one"));
    CMReturnWithChars(broker, CMPI_RC_ERR_ACCESS_DENIED, "not for you");
  };

  EXPECT_EQ(CBEnumInstances(broker, context(), path("TST_Processor"), nullptr, &status), nullptr);
  EXPECT_EQ(status.rc, CMPI_RC_ERR_ACCESS_DENIED);
  EXPECT_EQ(shownText(status.msg), "not for you");
}

TEST_F(InstanceOperationsTest, AnErrorObjectThatTheProviderReturnsFailsTheOperation) {
  probe->answer = [this](const CMPIContext*, const CMPIResult* result, const CMPIObjectPath*, const CMPIInstance*) {
    CMReturnError(result, broker->eft->newCMPIError(broker, "owner", "ID1", "disk gone", CMPIErrorSeverity{},
                                                    CMPIErrorProbableCause{}, CMPI_RC_ERR_ACCESS_DENIED, nullptr));
    return ok;
  };

  EXPECT_EQ(CBEnumInstances(broker, context(), path("TST_Processor"), nullptr, &status), nullptr);
  EXPECT_EQ(status.rc, CMPI_RC_ERR_ACCESS_DENIED);
  EXPECT_EQ(shownText(status.msg), "disk gone");
}

TEST_F(InstanceOperationsTest, GetInstanceReturnsTheFirstThatIsReturned) {
  probe->answer = returning({"one", "two"});

  const CMPIInstance* found = CBGetInstance(broker, context(), systemPath("two"), nullptr, &status);

  ASSERT_NE(found, nullptr);
  EXPECT_EQ(shownText(CMGetProperty(found, "Name", nullptr).value.string), "one");
  EXPECT_EQ(probe->calls[0].path, "root/test:TST_Processor.CreationClassName=\"TST_Processor\",Name=\"two\"");
}

TEST_F(InstanceOperationsTest, GetInstanceThatReturnsNothingFindsNothing) {
  EXPECT_EQ(CBGetInstance(broker, context(), systemPath("one"), nullptr, &status), nullptr);
  EXPECT_EQ(status.rc, CMPI_RC_ERR_NOT_FOUND);
  EXPECT_THAT(shownText(status.msg), HasSubstr("Name=\"one\""));
}

TEST_F(InstanceOperationsTest, GetInstanceOfAClassWithoutAProviderFindsNothing) {
  EXPECT_EQ(CBGetInstance(broker, context(), systemPath("one", "CIM_System"), nullptr, &status), nullptr);
  EXPECT_EQ(status.rc, CMPI_RC_ERR_NOT_FOUND);
  EXPECT_THAT(probe->calls, IsEmpty());
}

TEST_F(InstanceOperationsTest, ModifyInstanceHandsOverTheWholeInstanceWithoutDefaults) {
  CMPIInstance* sent = CMNewInstance(broker, path("TST_Processor"), nullptr);
  CMSetProperty(sent, "CreationClassName", "TST_Processor", CMPI_chars);
  CMSetProperty(sent, "Name", "one", CMPI_chars);
  CMSetProperty(sent, "Caption", "new", CMPI_chars);
  const auto modify = [&](const CMPIContext*, const CMPIResult*, const CMPIObjectPath*, const CMPIInstance* instance) {
    EXPECT_EQ(shownText(CMGetProperty(instance, "Caption", nullptr).value.string), "new");
    const CMPIData unsent = CMGetProperty(instance, "EnabledState", &status);
    EXPECT_TRUE(CMIsNullValue(unsent)) << "a class default is nothing that the client sent";
    EXPECT_EQ(status.rc, CMPI_RC_OK);
    CMGetProperty(instance, "Undeclared", &status);
    EXPECT_EQ(status.rc, CMPI_RC_ERR_NO_SUCH_PROPERTY);
    EXPECT_EQ(CMGetKeyCount(CMGetObjectPath(instance, nullptr), nullptr), 2u);
    return ok;
  };
  probe->answer = finding("one", modify);

  const CMPIStatus modified = CBModifyInstance(broker, context(), path("TST_Processor"), sent, nullptr);

  EXPECT_EQ(modified.rc, CMPI_RC_OK);
  EXPECT_THAT(operations(), ElementsAre("getInstance", "modifyInstance"));
  for (const Call& call : probe->calls) {
    EXPECT_EQ(call.path, "root/test:TST_Processor.CreationClassName=\"TST_Processor\",Name=\"one\"");
    EXPECT_FALSE(call.hasProperties);
  }
}

TEST_F(InstanceOperationsTest, ModifyInstancePassesThePropertyListOnAndLeavesOutWhatItDoesNotList) {
  const char* properties[] = {"caption", "Vendor", nullptr};
  CMPIInstance* sent = system("one");
  CMSetProperty(sent, "Caption", "listed", CMPI_chars);
  const CMPIUint16 state = 3;
  CMSetProperty(sent, "EnabledState", &state, CMPI_uint16);
  probe->answer = finding("one", [&](const auto&, const auto&, const auto&, const CMPIInstance* instance) {
    EXPECT_EQ(shownText(CMGetProperty(instance, "Caption", nullptr).value.string), "listed");
    EXPECT_EQ(shownText(CMGetProperty(instance, "Name", nullptr).value.string), "one") << "keys stay";
    EXPECT_TRUE(CMIsNullValue(CMGetProperty(instance, "EnabledState", nullptr)));
    return ok;
  });
  EXPECT_EQ(CBModifyInstance(broker, context(), systemPath("one"), sent, properties).rc, CMPI_RC_OK);
  ASSERT_THAT(operations(), ElementsAre("getInstance", "modifyInstance"));
  EXPECT_THAT(probe->calls[1].properties, ElementsAre("caption", "Vendor"));
}

TEST_F(InstanceOperationsTest, ModifyInstanceRefusesAPropertyListThatTheClassDoesNotHave) {
  const char* properties[] = {"Caption", "Undeclared", nullptr};
  status = CBModifyInstance(broker, context(), systemPath("one"), system("one"), properties);
  EXPECT_EQ(status.rc, CMPI_RC_ERR_NO_SUCH_PROPERTY);
  EXPECT_EQ(shownText(status.msg), "class TST_Processor has no property Undeclared");
  EXPECT_THAT(probe->calls, IsEmpty());
}

TEST_F(InstanceOperationsTest, ModifyInstanceOfWhatIsNotThereFindsNothing) {
  status = CBModifyInstance(broker, context(), systemPath("one"), system("one"), nullptr);
  EXPECT_EQ(status.rc, CMPI_RC_ERR_NOT_FOUND);
  EXPECT_THAT(shownText(status.msg), HasSubstr("no instance root/test:TST_Processor."));
  EXPECT_THAT(operations(), ElementsAre("getInstance"));
}

TEST_F(InstanceOperationsTest, ModifyInstanceReachesAProviderThatCannotSayWhatIsThere) {
  const auto modifiedIfGetInstanceFailsWith = [&](CMPIrc code) {
    probe->calls.clear();
    probe->answer = [this, code](const auto&...) {
      return CMPIStatus{probe->calls.back().operation == "getInstance" ? code : CMPI_RC_OK, nullptr};
    };
    return CBModifyInstance(broker, context(), systemPath("one"), system("one"), nullptr).rc;
  };
  EXPECT_EQ(modifiedIfGetInstanceFailsWith(CMPI_RC_ERR_NOT_SUPPORTED), CMPI_RC_OK);
  EXPECT_THAT(operations(), ElementsAre("getInstance", "modifyInstance"));
  EXPECT_EQ(modifiedIfGetInstanceFailsWith(CMPI_RC_ERR_FAILED), CMPI_RC_ERR_FAILED);
  EXPECT_THAT(operations(), ElementsAre("getInstance"));
}

TEST_F(InstanceOperationsTest, ModifyInstanceRefusesKeysThatContradictThePath) {
  CMPIInstance* renamed = system("one");
  CMSetProperty(renamed, "Name", "two", CMPI_chars);
  for (const CMPIInstance* sent : {renamed, system("two")}) {
    status = CBModifyInstance(broker, context(), systemPath("one"), sent, nullptr);
    EXPECT_EQ(status.rc, CMPI_RC_ERR_INVALID_PARAMETER);
    EXPECT_EQ(shownText(status.msg), "key Name of the instance is \"two\", that of its path \"one\"");
  }
  EXPECT_THAT(probe->calls, IsEmpty());
}

TEST_F(InstanceOperationsTest, ModifyInstanceTakesAKeyThatIsTheSameNumber) {
  std::shared_ptr<RecordingProvider> points = std::make_shared<RecordingProvider>();
  points->serve(manager, "TST_Point", testNamespace);
  points->answer = [this](const auto&, const CMPIResult* result, const CMPIObjectPath* asked, const auto&) {
    CMReturnInstance(result, CMNewInstance(broker, asked, nullptr));
    return ok;
  };
  const auto modify = [&](CMPIUint64 inPath, CMPIUint16 inInstance) {
    CMPIObjectPath* point = path("TST_Point");
    CMAddKey(point, "Number", &inPath, CMPI_uint64);
    CMPIInstance* sent = CMNewInstance(broker, path("TST_Point"), nullptr);
    CMSetProperty(sent, "Number", &inInstance, CMPI_uint16);
    return CBModifyInstance(broker, context(), point, sent, nullptr).rc;
  };
  EXPECT_EQ(modify(4, 5), CMPI_RC_ERR_INVALID_PARAMETER);
  EXPECT_THAT(points->calls, IsEmpty());
  modify(4, 4);
  EXPECT_THAT(points->calls, testing::Not(IsEmpty()));
}

TEST_F(InstanceOperationsTest, WithoutChecksModifyInstanceHandsOverWhatCame) {
  manager.setStrictness(Strictness::Bare);
  const char* properties[] = {"Undeclared", nullptr};
  CMPIInstance* sent = system("two", "TST_Other");
  CMSetProperty(sent, "Caption", "unlisted", CMPI_chars);
  probe->answer = [&](const auto&, const auto&, const CMPIObjectPath* asked, const CMPIInstance* instance) {
    EXPECT_EQ(shownText(CMGetKey(asked, "Name", nullptr).value.string), "one");
    EXPECT_EQ(shownText(CMGetClassName(CMGetObjectPath(instance, nullptr), nullptr)), "TST_Processor");
    EXPECT_EQ(shownText(CMGetProperty(instance, "Caption", nullptr).value.string), "unlisted");
    return ok;
  };
  EXPECT_EQ(CBModifyInstance(broker, context(), systemPath("one"), sent, properties).rc, CMPI_RC_OK);
  EXPECT_THAT(operations(), ElementsAre("modifyInstance"));
}

TEST_F(InstanceOperationsTest, ModifyInstanceRefusesAnInstanceOfAnotherClass) {
  probe->serve(manager, "TST_Other", testNamespace);
  const CMPIStatus refused =
      CBModifyInstance(broker, context(), systemPath("one"), system("one", "TST_Other"), nullptr);
  EXPECT_EQ(refused.rc, CMPI_RC_ERR_INVALID_PARAMETER);
  EXPECT_THAT(probe->calls, IsEmpty());
}

TEST_F(InstanceOperationsTest, WritingToAClassWithoutAProviderIsNotSupported) {
  CMPIObjectPath* orphan = systemPath("one", "TST_Other");
  CMPIInstance* instance = system("one", "TST_Other");
  EXPECT_EQ(CBModifyInstance(broker, context(), orphan, instance, nullptr).rc, CMPI_RC_ERR_NOT_SUPPORTED);
  EXPECT_EQ(CBDeleteInstance(broker, context(), orphan).rc, CMPI_RC_ERR_NOT_SUPPORTED);
  EXPECT_EQ(CBCreateInstance(broker, context(), orphan, instance, &status), nullptr);
  EXPECT_EQ(status.rc, CMPI_RC_ERR_NOT_SUPPORTED);
}

TEST_F(InstanceOperationsTest, CreateInstanceReturnsTheProvidersPathElseTheInstances) {
  const CMPIObjectPath* own = CBCreateInstance(broker, context(), path("TST_Processor"), system("one"), &status);
  EXPECT_EQ(shownText(CMObjectPathToString(own, nullptr)),
            "root/test:TST_Processor.CreationClassName=\"TST_Processor\",Name=\"one\"");
  probe->answer = [this](const CMPIContext*, const CMPIResult* result, const CMPIObjectPath*, const CMPIInstance*) {
    CMReturnObjectPath(result, systemPath("given"));
    return ok;
  };
  const CMPIObjectPath* given = CBCreateInstance(broker, context(), path("TST_Processor"), system("one"), &status);
  EXPECT_THAT(shownText(CMObjectPathToString(given, nullptr)), HasSubstr("Name=\"given\""));
}

TEST_F(InstanceOperationsTest, DeleteInstanceReachesTheProvider) {
  EXPECT_EQ(CBDeleteInstance(broker, context(), systemPath("one")).rc, CMPI_RC_OK);
  ASSERT_THAT(probe->calls, SizeIs(1));
  EXPECT_EQ(probe->calls[0].operation, "deleteInstance");
}

TEST_F(InstanceOperationsTest, PropertyCallsAreInstanceCallsOfOneProperty) {
  probe->answer = returning({"one"});
  EXPECT_EQ(shownText(CBGetProperty(broker, context(), systemPath("one"), "name", &status).value.string), "one");
  EXPECT_THAT(probe->calls[0].properties, ElementsAre("Name"));
  CBGetProperty(broker, context(), systemPath("one"), "Undeclared", &status);
  EXPECT_EQ(status.rc, CMPI_RC_ERR_NO_SUCH_PROPERTY);

  probe->answer = finding("one", [](const auto&, const auto&, const auto&, const CMPIInstance* instance) {
    EXPECT_EQ(shownText(CMGetProperty(instance, "Caption", nullptr).value.string), "set");
    return ok;
  });
  const CMPIStatus set = broker->bft->setProperty(broker, context(), systemPath("one"), "Caption",
                                                  reinterpret_cast<const CMPIValue*>("set"), CMPI_chars);
  EXPECT_EQ(set.rc, CMPI_RC_OK);
  EXPECT_EQ(probe->calls.back().operation, "modifyInstance");
  EXPECT_THAT(probe->calls.back().properties, ElementsAre("Caption"));
}

TEST_F(InstanceOperationsTest, QueriesMethodsAndIndicationsAreHonestlyRefused) {
  EXPECT_EQ(CBExecQuery(broker, context(), path("TST_Processor"), "select * from x", "WQL", &status), nullptr);
  EXPECT_EQ(status.rc, CMPI_RC_ERR_NOT_SUPPORTED);
  CBInvokeMethod(broker, context(), systemPath("one"), "reset", nullptr, nullptr, &status);
  EXPECT_EQ(status.rc, CMPI_RC_ERR_METHOD_NOT_AVAILABLE);
  CBInvokeMethod(broker, context(), systemPath("one"), "Explode", nullptr, nullptr, &status);
  EXPECT_EQ(status.rc, CMPI_RC_ERR_METHOD_NOT_FOUND);
  EXPECT_EQ(CBDeliverIndication(broker, context(), testNamespace, system("one")).rc, CMPI_RC_ERR_NOT_SUPPORTED);
}

}  // namespace
