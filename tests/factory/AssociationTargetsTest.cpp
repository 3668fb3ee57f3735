// The class at the far end of an association: the table, the traces, and the path that is made of it.
#include "factory/IPConfigObjectFactory.h"
#include "support/CompositeTest.h"

namespace {

using QV::IPConfigComposite::IPConfigObjectFactory;
using Testing::messages;
using Strings = std::vector<std::string>;

struct Row {
  std::string source;
  std::string association;
  std::string target;
};

const std::string system_ = "YRNx_MgmtHwComputerSystem";
const std::string endpoint = "YRNx_MgmtHwIPProtocolEndPoint";
const std::string remoteAccessPoint = "YRNx_MgmtHwRemoteServiceAccessPoint";
const std::string sequence = "YRNx_MgmtHwIPAssignmentSettingSequence";
const std::string staticSetting = "YRNx_MgmtHwStaticIPAssignmentSettingData";
const std::string dhcpSetting = "YRNx_MgmtHwDHCPAssignmentSettingData";

const std::string hostedAccessPoint = "YRNx_MgmtHwIPHostedAccessPoint";
const std::string remoteHostedAccessPoint = "YRNx_MgmtHwIPRemoteHostedAccessPoint";
const std::string clientAccess = "YRNx_MgmtHwClientAccess";
const std::string elementSettingData = "YRNx_MgmtHwIPElementSettingData";
const std::string staticOrderedMember = "YRNx_MgmtHwStaticIPOrderedMemberOfCollection";
const std::string dhcpOrderedMember = "YRNx_MgmtHwDHCPOrderedMemberOfCollection";

const std::vector<Row> rows = {
    {endpoint, hostedAccessPoint, system_},
    {system_, hostedAccessPoint, endpoint},
    {system_, remoteHostedAccessPoint, remoteAccessPoint},
    {remoteAccessPoint, remoteHostedAccessPoint, system_},
    {endpoint, elementSettingData, sequence},
    {sequence, elementSettingData, endpoint},
    {sequence, dhcpOrderedMember, dhcpSetting},
    {dhcpSetting, dhcpOrderedMember, sequence},
    {staticSetting, staticOrderedMember, sequence},
    {sequence, staticOrderedMember, staticSetting},
    {remoteAccessPoint, clientAccess, endpoint},
    {endpoint, clientAccess, remoteAccessPoint},
};

std::string targetOf(const std::string& source, const std::string& association) {
  for (const Row& row : rows) {
    if (row.source == source && row.association == association) {
      return row.target;
    }
  }
  return "";
}

class AssociationTargetsTest : public Testing::CompositeTest {
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
Strings linesOf(Testing::Channel channel) {
  Strings lines = messages(channel);
  for (std::string& line : lines) {
    for (const char* const mark : {"Line: ", "at line "}) {
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
  const Strings sources = {system_,       endpoint,    remoteAccessPoint,   sequence,
                           staticSetting, dhcpSetting, "CIM_ManagedElement"};
  const Strings associations = {hostedAccessPoint,   remoteHostedAccessPoint, clientAccess,    elementSettingData,
                                staticOrderedMember, dhcpOrderedMember,       "CIM_Dependency"};
  int found = 0;
  for (const std::string& source : sources) {
    for (const std::string& association : associations) {
      SCOPED_TRACE(source + " over " + association);
      const std::string target = targetOf(source, association);
      found += target.empty() ? 0 : 1;
      EXPECT_EQ(name(makePath(source), association.c_str()), target);
      const CMPIObjectPath* const targetPath = path(makePath(source), association.c_str());
      ASSERT_EQ(targetPath == nullptr, target.empty());
      if (targetPath != nullptr) {
        EXPECT_EQ(Testing::classOf(targetPath), target);
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
  for (const char* const resultClass : {"YRNx_MgmtHwComputerSystem", "CIM_ManagedElement", "", "NoSuchClass"}) {
    EXPECT_EQ(name(makePath(system_), hostedAccessPoint.c_str(), resultClass), endpoint);
    EXPECT_EQ(Testing::classOf(path(makePath(system_), hostedAccessPoint.c_str(), resultClass)), endpoint);
  }
}

TEST_F(AssociationTargetsTest, ANullAssociationClassHasNoTarget) {
  EXPECT_EQ(name(makePath(system_), nullptr), "");
  EXPECT_EQ(path(makePath(system_), nullptr), nullptr);
}

TEST_F(AssociationTargetsTest, TheNameIsTracedWithTheTargetFound) {
  name(makePath(system_), hostedAccessPoint.c_str());
  EXPECT_EQ(linesOf(Testing::Channel::Log), (Strings{enteringName, message(endpoint)}));
  EXPECT_EQ(linesOf(Testing::Channel::Trace), linesOf(Testing::Channel::Log));
  for (const Testing::LogLine& line : Testing::logLines()) {
    EXPECT_EQ(line.component, "Tarnwick.IPObjectFactory");
    EXPECT_EQ(line.level, 4000);
    EXPECT_EQ(line.function, "get_assoc_targetClass_Name");
    EXPECT_EQ(line.file, "IPConfigObjectFactory");
  }
}

TEST_F(AssociationTargetsTest, APairOutsideTheTableIsTracedWithItsSource) {
  name(makePath(sequence), hostedAccessPoint.c_str());
  EXPECT_EQ(linesOf(Testing::Channel::Log),
            (Strings{enteringName, message("Target Assoc Class Not Found"), variable("sourceclass", sequence)}));
}

TEST_F(AssociationTargetsTest, ThePathIsTracedUpToItsMaking) {
  path(makePath(system_), hostedAccessPoint.c_str());
  EXPECT_EQ(linesOf(Testing::Channel::Log),
            (Strings{enteringPath, enteringName, message(endpoint), variable("targetName", endpoint),
                     message(" Creating CMNewObjectPath")}));
}

TEST_F(AssociationTargetsTest, ANullPathIsTracedUpToItsEmptyName) {
  path(makePath(sequence), hostedAccessPoint.c_str());
  EXPECT_EQ(linesOf(Testing::Channel::Log),
            (Strings{enteringPath, enteringName, message("Target Assoc Class Not Found"),
                     variable("sourceclass", sequence), variable("targetName", "")}));
}

TEST_F(AssociationTargetsTest, ThePathHasTheSourcesNamespaceTheSystemsNameAndNoKeys) {
  CMPIObjectPath* const source = makePath(system_, {{"Name", "bmc0"}});
  CMSetNameSpace(source, "root/other");
  CMSetHostname(source, "client.example");
  const CMPIObjectPath* const target = path(source, hostedAccessPoint.c_str());
  EXPECT_EQ(Testing::nameSpaceOf(target), "root/other");
  EXPECT_EQ(Testing::hostOf(target), Testing::systemName());
  EXPECT_EQ(Testing::keysWithValues(target), 0U);
  EXPECT_EQ(Testing::hostOf(source), "client.example");
}

TEST_F(AssociationTargetsTest, APathThatTheBrokerCannotMakeIsNullAndTheBrokersStatusTellsWhy) {
  faults.failNewObjectPath = [](const std::string&, int) { return true; };
  EXPECT_EQ(path(makePath(system_), hostedAccessPoint.c_str()), nullptr);
  EXPECT_EQ(status.rc, CMPI_RC_ERR_FAILED);
}

TEST_F(AssociationTargetsTest, APathWithoutHandleIsGivenAsItIs) {
  faults.failNewObjectPath = [](const std::string&, int) { return true; };
  faults.unmadePath = Testing::pathWithoutHandle();
  EXPECT_EQ(path(makePath(system_), hostedAccessPoint.c_str()), Testing::pathWithoutHandle());
}

}  // namespace
