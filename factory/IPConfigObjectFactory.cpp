// The factory's members by name: each read pair stands for its row of CompositeClass.cpp.
#include "IPConfigObjectFactory.h"

#include "CompositeInstances.h"
#include "FactoryFrame.h"

namespace QV::IPConfigComposite {

const std::string loggerIPObjectFactory = "Tarnwick.IPObjectFactory";

#define COMPOSITE_CLASS_MEMBERS(getAll, make, row)                                                               \
  int IPConfigObjectFactory::getAll(const CMPIBroker* broker, const CMPIContext* ctx, const CMPIObjectPath* ref, \
                                    const char* className, const char** properties, bool noFilter,               \
                                    std::vector<CMPIInstance*>& out, CMPIStatus* status) {                       \
    return readComposites(row, {broker, ref, properties, noFilter, status}, ctx, className, out);                \
  }                                                                                                              \
  CMPIInstance* IPConfigObjectFactory::make(const CMPIBroker* broker, const CMPIObjectPath* ref,                 \
                                            const char** properties, bool noFilter, CMPIStatus* status) {        \
    return makeComposite(row, {broker, ref, properties, noFilter, status});                                      \
  }

COMPOSITE_CLASS_MEMBERS(getAllSPComputerCMPIInstances, makeSPComputerInstance, computerSystem)
COMPOSITE_CLASS_MEMBERS(getAllIPProtocolendptCMPIInstances, makeIPProtocolEndptInstance, ipProtocolEndpoint)
COMPOSITE_CLASS_MEMBERS(getAllIPAssignmentSettingCMPIInstances, makeIPAssignmentSettingInstance,
                        assignmentSettingSequence)
COMPOSITE_CLASS_MEMBERS(getAllStaticIPAssignmentSettingCMPIInstances, makeStaticIPAssignmentSettingInstance,
                        staticAssignmentSetting)
COMPOSITE_CLASS_MEMBERS(getAllDHCPAssignmentSettingCMPIInstances, makeDHCPAssignmentSettingInstance,
                        dhcpAssignmentSetting)
COMPOSITE_CLASS_MEMBERS(getAllIPRemoteSAPCMPIInstances, makeIPRemoteSAPInstance, remoteServiceAccessPoint)

#undef COMPOSITE_CLASS_MEMBERS

void IPConfigObjectFactory::Tokenize(const std::string& text, std::vector<std::string>& tokens,
                                     const std::string& delimiters) {
  std::size_t start = text.find_first_not_of(delimiters);
  while (start != std::string::npos) {
    const std::size_t end = text.find_first_of(delimiters, start);
    tokens.push_back(text.substr(start, end - start));
    start = text.find_first_not_of(delimiters, end);
  }
}

}  // namespace QV::IPConfigComposite
