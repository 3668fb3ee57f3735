// SPDX-License-Identifier: Apache-2.0
// The class at the far end of an association: the table, the traces, and the path that is made of it.
#include "factory/IPConfigObjectFactory.h"
#include "tests/support/composite/AssociationModel.h"
#include "tests/support/composite/CompositeTest.h"

namespace {

using namespace Testing;
using QV::IPConfigComposite::IPConfigObjectFactory;

using namespace Classes;

// The class at the far end from a source; empty if the association does not end at it.
std::string targetOf(const std::string& source, const std::string& association) {
  for (const AssociationModel& model : associationModels()) {
    if (model.className == association && model.endA == source) {
      return model.endB;
    }
    if (model.className == association && model.endB == source) {
      return model.endA;
    }
  }
  return "";
}

class AssociationTargetsTest : public CompositeTest {
 protected:
  std::string name(const CMPIObjectPath* source, const char* association, const char* resultClass = nullptr) {
    return IPConfigObjectFactory().get_assoc_targetClass_Name(broker(), source, association, resultClass, &status);
  }
  CMPIObjectPath* path(const CMPIObjectPath* source, const char* association, const char* resultClass = nullptr) {
    return IPConfigObjectFactory().get_assoc_targetClass_ObjectPath(broker(), source, association, resultClass,
                                                                    &status);
  }
};

// The lines of the log without their numbers.
Strings linesOf(Channel channel) {
  Strings lines = messages(channel);
  for (std::string& line : lines) {
    for (const char* mark : {"Line: ", "at line "}) {
      const std::size_t start = line.find(mark);
      if (start != std::string::npos) {
        const std::size_t digits = start + std::string(mark).size();
        line.replace(digits, line.find_first_not_of("0123456789", digits) - digits, "N");
      }
    }
  }
  return lines;
}

const std::string enteringName = "ENTERING: get_assoc_targetClass_Name() in IPConfigObjectFactory [Line: N]";
const std::string enteringPath = "ENTERING: get_assoc_targetClass_ObjectPath() in IPConfigObjectFactory [Line: N]";

std::string message(const std::string& text) { return "MESSAGE [File: IPConfigObjectFactory, Line: N]: " + text; }
std::string variable(const std::string& name, const std::string& value) {
  return "VARIABLE: '" + name + "' has Value '" + value + "' at line N in IPConfigObjectFactory";
}

TEST_F(AssociationTargetsTest, EveryPairOfSourceAndAssociationHasItsTargetOrNone) {
  const Strings sources = {computerSystem, endpoint,    remoteAccessPoint,   sequence,
                           staticSetting,  dhcpSetting, "CIM_ManagedElement"};
  const Strings associations = {hostedAccessPoint,   remoteHostedAccessPoint, clientAccess,    elementSettingData,
                                staticOrderedMember, dhcpOrderedMember,       "CIM_Dependency"};
  int found = 0;
  for (const std::string& source : sources) {
    for (const std::string& association : associations) {
      SCOPED_TRACE(source + " over " + association);
      const std::string target = targetOf(source, association);
      found += target.empty() ? 0 : 1;
      EXPECT_EQ(name(makePath(source), association.c_str()), target);
      const CMPIObjectPath* targetPath = path(makePath(source), association.c_str());
      ASSERT_EQ(targetPath == nullptr, target.empty());
      if (targetPath) {
        EXPECT_EQ(classOf(targetPath), target);
      }
      EXPECT_EQ(status.rc, CMPI_RC_OK);
    }
  }
  EXPECT_EQ(found, 12);
}

TEST_F(AssociationTargetsTest, ClassNamesAreComparedWithoutRegardToCase) {
  EXPECT_EQ(name(makePath("yrnx_mgmthwcomputersystem"), "YRNX_MGMTHWIPHOSTEDACCESSPOINT"), endpoint);
}

TEST_F(AssociationTargetsTest, TheResultClassChangesNothing) {
  for (const char* resultClass : {computerSystem, "CIM_ManagedElement", "", "NoSuchClass"}) {
    EXPECT_EQ(name(makePath(computerSystem), hostedAccessPoint, resultClass), endpoint);
    EXPECT_EQ(classOf(path(makePath(computerSystem), hostedAccessPoint, resultClass)), endpoint);
  }
}

TEST_F(AssociationTargetsTest, ANullAssociationClassHasNoTarget) {
  EXPECT_EQ(name(makePath(computerSystem), nullptr), "");
  EXPECT_EQ(path(makePath(computerSystem), nullptr), nullptr);
}

TEST_F(AssociationTargetsTest, TheNameIsTracedWithTheTargetFound) {
  name(makePath(computerSystem), hostedAccessPoint);
  EXPECT_EQ(linesOf(Channel::Log), (Strings{enteringName, message(endpoint)}));
  EXPECT_EQ(linesOf(Channel::Trace), linesOf(Channel::Log));
  for (const LogLine& line : logLines()) {
    EXPECT_EQ(line.component, "Tarnwick.IPObjectFactory");
    EXPECT_EQ(line.level, 4000);
    EXPECT_EQ(line.function, "get_assoc_targetClass_Name");
    EXPECT_EQ(line.file, "IPConfigObjectFactory");
  }
}

TEST_F(AssociationTargetsTest, APairOutsideTheTableIsTracedWithItsSource) {
  name(makePath(sequence), hostedAccessPoint);
  EXPECT_EQ(linesOf(Channel::Log),
            (Strings{enteringName, message("Target Assoc Class Not Found"), variable("sourceclass", sequence)}));
}

TEST_F(AssociationTargetsTest, ThePathIsTracedUpToItsMaking) {
  path(makePath(computerSystem), hostedAccessPoint);
  EXPECT_EQ(linesOf(Channel::Log), (Strings{enteringPath, enteringName, message(endpoint),
                                            variable("targetName", endpoint), message(" Creating CMNewObjectPath")}));
}

TEST_F(AssociationTargetsTest, ANullPathIsTracedUpToItsEmptyName) {
  path(makePath(sequence), hostedAccessPoint);
  EXPECT_EQ(linesOf(Channel::Log), (Strings{enteringPath, enteringName, message("Target Assoc Class Not Found"),
                                            variable("sourceclass", sequence), variable("targetName", "")}));
}

TEST_F(AssociationTargetsTest, ThePathHasTheSourcesNamespaceTheSystemsNameAndNoKeys) {
  CMPIObjectPath* source = makePath(computerSystem, {{"Name", "bmc0"}});
  CMSetNameSpace(source, "root/other");
  CMSetHostname(source, "client.example");
  const CMPIObjectPath* target = path(source, hostedAccessPoint);
  EXPECT_EQ(nameSpaceOf(target), "root/other");
  EXPECT_EQ(hostOf(target), systemName());
  EXPECT_EQ(keysWithValues(target), 0U);
  EXPECT_EQ(hostOf(source), "client.example");
}

TEST_F(AssociationTargetsTest, APathThatTheBrokerCannotMakeIsNullAndTheBrokersStatusTellsWhy) {
  faults.failNewObjectPath = [](const std::string&, int) { return true; };
  EXPECT_EQ(path(makePath(computerSystem), hostedAccessPoint), nullptr);
  EXPECT_EQ(status.rc, CMPI_RC_ERR_FAILED);
}

TEST_F(AssociationTargetsTest, APathWithoutHandleIsGivenAsItIs) {
  faults.failNewObjectPath = [](const std::string&, int) { return true; };
  faults.unmadePath = pathWithoutHandle();
  EXPECT_EQ(path(makePath(computerSystem), hostedAccessPoint), pathWithoutHandle());
}

}  // namespace
