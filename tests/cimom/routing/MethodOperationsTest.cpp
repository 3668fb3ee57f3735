// SPDX-License-Identifier: Apache-2.0
// CBInvokeMethod: which provider is called, with what, and what comes back.
#include "tests/support/broker/ManagedElements.h"
#include "tests/support/broker/RecordingProvider.h"

namespace {

using namespace Cimom;
using namespace Testing;
using testing::ElementsAre;

// A provider of methods that records who is called and answers as the test says.
struct MethodProbe {
  using Answer = std::function<CMPIStatus(const CMPIContext*, const CMPIResult*, const CMPIArgs*, CMPIArgs*)>;

  MethodProbe() : mi{this, &table} {}
  MethodProbe(const MethodProbe&) = delete;
  MethodProbe& operator=(const MethodProbe&) = delete;

  static CMPIStatus cleanup(CMPIMethodMI* mi, const CMPIContext*, CMPIBoolean) {
    ++static_cast<MethodProbe*>(mi->hdl)->cleanups;
    return ok;
  }

  static CMPIStatus invokeMethod(CMPIMethodMI* mi, const CMPIContext* context, const CMPIResult* result,
                                 const CMPIObjectPath* path, const char* method, const CMPIArgs* in, CMPIArgs* out) {
    auto& probe = *static_cast<MethodProbe*>(mi->hdl);
    probe.calls.push_back(shownText(CMObjectPathToString(path, nullptr)) + " " + method);
    return probe.answer ? probe.answer(context, result, in, out) : ok;
  }

  void serve(ObjectManager& manager, const char* className) {
    ProviderRegistration registration{className, className, "", false, false, {testNamespace}, ""};
    registration.method = true;
    manager.addProvider(registration, nullptr, nullptr,
                        [this](const CMPIBroker*, const CMPIContext*, CMPIStatus*) { return &mi; });
  }

  static inline CMPIMethodMIFT table = {CMPICurrentVersion, CMPICurrentVersion, "methodProbe", cleanup, invokeMethod};
  CMPIMethodMI mi;
  Answer answer;
  std::vector<std::string> calls;
  int cleanups = 0;
};

class MethodOperationsTest : public testing::Test {
 protected:
  MethodOperationsTest() {
    manager->loadSchemaText(testSchema, testNamespace);
    path = CMNewObjectPath(broker, testNamespace, "TST_Processor", nullptr);
  }

  CMPIData invoke(const char* method, const CMPIArgs* in = nullptr, CMPIArgs* out = nullptr) {
    return CBInvokeMethod(broker, request.context(), path, method, in, out, &status);
  }

  MethodProbe probe;  // outlives the manager, which cleans it up
  std::unique_ptr<ObjectManager> manager = std::make_unique<ObjectManager>();
  const CMPIBroker* broker = manager->broker();
  RequestScope request{broker};
  CMPIObjectPath* path = nullptr;
  CMPIStatus status = {CMPI_RC_ERROR, nullptr};
};

TEST_F(MethodOperationsTest, TheProviderGetsArgumentsAndReturnsThem) {
  probe.serve(*manager, "TST_Processor");
  probe.answer = [](const CMPIContext*, const CMPIResult* result, const CMPIArgs* in, CMPIArgs* out) {
    EXPECT_EQ(CMGetArg(in, "Force", nullptr).value.boolean, 1);
    const CMPIBoolean no = 0;
    CMAddArg(out, "force", &no, CMPI_boolean);
    const CMPIUint32 number = 3;
    CMReturnData(result, &number, CMPI_uint32);
    return CMReturnDone(result);
  };
  CMPIArgs* in = CMNewArgs(broker, nullptr);
  CMPIArgs* out = CMNewArgs(broker, nullptr);
  const CMPIBoolean yes = 1;
  CMAddArg(in, "Force", &yes, CMPI_boolean);
  const CMPIData returned = invoke("reset", in, out);
  EXPECT_EQ(status.rc, CMPI_RC_OK);
  EXPECT_EQ(returned.type, CMPI_uint32);
  EXPECT_EQ(returned.value.uint32, 3u);
  CMPIString* name = nullptr;
  EXPECT_EQ(CMGetArgAt(out, 0, &name, nullptr).type, CMPI_boolean);
  EXPECT_EQ(shownText(name), "Force") << "as it is declared";
  EXPECT_THAT(probe.calls, ElementsAre("root/test:TST_Processor Reset"));
}

TEST_F(MethodOperationsTest, TheNearestClassWithAProviderIsAsked) {
  MethodProbe general;
  general.serve(*manager, "CIM_Element");
  invoke("Reset");
  EXPECT_THAT(general.calls, ElementsAre("root/test:TST_Processor Reset")) << "with the class that was called";
  probe.serve(*manager, "CIM_System");
  EXPECT_TRUE(CMIsNullValue(invoke("Reset")));
  EXPECT_EQ(status.rc, CMPI_RC_OK);
  EXPECT_EQ(general.calls.size(), 1u);
  EXPECT_EQ(probe.calls.size(), 1u);
  manager.reset();
  EXPECT_EQ(general.cleanups, 1);
  EXPECT_EQ(probe.cleanups, 1);
}

TEST_F(MethodOperationsTest, WithoutMethodOrProviderTheCodesAreTheStandards) {
  invoke("Nothing");
  EXPECT_EQ(status.rc, CMPI_RC_ERR_METHOD_NOT_FOUND);
  invoke("Reset");
  EXPECT_EQ(status.rc, CMPI_RC_ERR_METHOD_NOT_AVAILABLE);
  EXPECT_EQ(shownText(status.msg), "TST_Processor.Reset has no provider in root/test");
}

TEST_F(MethodOperationsTest, AFailedMethodReturnsNoArguments) {
  probe.serve(*manager, "TST_Processor");
  probe.answer = [](const CMPIContext*, const CMPIResult*, const CMPIArgs*, CMPIArgs* out) {
    const CMPIBoolean no = 0;
    CMAddArg(out, "Force", &no, CMPI_boolean);
    return CMPIStatus{CMPI_RC_ERR_ACCESS_DENIED, nullptr};
  };
  CMPIArgs* out = CMNewArgs(broker, nullptr);
  EXPECT_TRUE(CMIsNullValue(invoke("Reset", nullptr, out)));
  EXPECT_EQ(status.rc, CMPI_RC_ERR_ACCESS_DENIED);
  EXPECT_EQ(CMGetArgCount(out, nullptr), 0u);
}

}  // namespace
