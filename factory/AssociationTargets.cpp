// Which class lies at the far end of an association, seen from either end.
#include <QV/ProviderHelper.h>

#include "ClassNames.h"
#include "CmpiAccess.h"
#include "FactoryFrame.h"
#include "IPConfigObjectFactory.h"

namespace QV::IPConfigComposite {

namespace {

struct Navigation {
  const char* source;
  const char* association;
  const char* target;
};

// Searched from the top; the first row whose source and association match gives the target.
constexpr Navigation navigations[] = {
    {ClassNames::ipProtocolEndpoint, ClassNames::hostedAccessPoint, ClassNames::computerSystem},
    {ClassNames::computerSystem, ClassNames::hostedAccessPoint, ClassNames::ipProtocolEndpoint},
    {ClassNames::computerSystem, ClassNames::remoteHostedAccessPoint, ClassNames::remoteServiceAccessPoint},
    {ClassNames::remoteServiceAccessPoint, ClassNames::remoteHostedAccessPoint, ClassNames::computerSystem},
    {ClassNames::ipProtocolEndpoint, ClassNames::elementSettingData, ClassNames::assignmentSettingSequence},
    {ClassNames::assignmentSettingSequence, ClassNames::elementSettingData, ClassNames::ipProtocolEndpoint},
    {ClassNames::assignmentSettingSequence, ClassNames::dhcpOrderedMember, ClassNames::dhcpAssignmentSetting},
    {ClassNames::dhcpAssignmentSetting, ClassNames::dhcpOrderedMember, ClassNames::assignmentSettingSequence},
    {ClassNames::staticAssignmentSetting, ClassNames::staticOrderedMember, ClassNames::assignmentSettingSequence},
    {ClassNames::assignmentSettingSequence, ClassNames::staticOrderedMember, ClassNames::staticAssignmentSetting},
    {ClassNames::remoteServiceAccessPoint, ClassNames::clientAccess, ClassNames::ipProtocolEndpoint},
    {ClassNames::ipProtocolEndpoint, ClassNames::clientAccess, ClassNames::remoteServiceAccessPoint},
};

}  // namespace

const char* IPConfigObjectFactory::get_assoc_targetClass_Name(const CMPIBroker*, const CMPIObjectPath* sourcePath,
                                                              const char* assocClass, const char*, CMPIStatus* status) {
  const Frame frame = factoryFrame(__func__);
  frame.entering();
  const char* const sourceClass = classNameOf(sourcePath, status);
  for (const Navigation& navigation : navigations) {
    if (textEqual(sourceClass, navigation.source) && textEqual(assocClass, navigation.association)) {
      frame.progress(navigation.target);
      return navigation.target;
    }
  }
  frame.progress("Target Assoc Class Not Found");
  frame.variable("sourceclass", sourceClass);
  return "";
}

CMPIObjectPath* IPConfigObjectFactory::get_assoc_targetClass_ObjectPath(const CMPIBroker* broker,
                                                                        const CMPIObjectPath* sourcePath,
                                                                        const char* assocClass, const char* resultClass,
                                                                        CMPIStatus* status) {
  const Frame frame = factoryFrame(__func__);
  frame.entering();
  const char* const targetName = get_assoc_targetClass_Name(broker, sourcePath, assocClass, resultClass, status);
  frame.variable("targetName", targetName);
  if (textEqual(targetName, "")) {
    return nullptr;
  }
  frame.progress(" Creating CMNewObjectPath");
  CMPIObjectPath* const path = CMNewObjectPath(broker, nameSpaceOf(sourcePath, status), targetName, status);
  rehome(path, sourcePath, status);
  return path;
}

}  // namespace QV::IPConfigComposite
