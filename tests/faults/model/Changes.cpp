// SPDX-License-Identifier: Apache-2.0
// What ModifyInstance does, down to the instrumentation.
#include <QV/Instrumentation.h>
#include <cmpimacs.h>

#include <exception>

#include "tests/faults/model/Access.h"
#include "tests/faults/model/Operations.h"
#include "tests/faults/model/Steps.h"

namespace Testing::Model {

namespace {

using QV::NodeLexicon::NodeType;
using Code = QV::NodeLexicon::Properties;

constexpr auto interfaceNode = static_cast<NodeType>(29);
constexpr auto nodeNameCode = static_cast<Code>(108);
constexpr auto addressCode = static_cast<Code>(25);
constexpr auto maskCode = static_cast<Code>(26);

bool reachNode(QV::Instrumentation& instrumentation, const std::string& name, const Report& report) {
  std::string nodeName;
  while (instrumentation) {
    if (!instrumentation.getProperty(nodeNameCode, nodeName)) {
      continue;
    }
    report.variable("name", nodeName, 514);
    if (nodeName == name) {
      return true;
    }
    ++instrumentation;
  }
  return false;
}

// False where there is no node at all, or where the instrumentation throws.
bool write(const std::string& name, std::string address, std::string mask) {
  const Report report = memberReport("executeModifyInstance");
  report.entering(498);
  bool hasNodes = true;
  try {
    QV::Instrumentation instrumentation;
    instrumentation.selectNode(interfaceNode);
    hasNodes = instrumentation;
    if (hasNodes && reachNode(instrumentation, name, report)) {
      report.variable("name", name, 517);
      if (!address.empty()) {
        instrumentation.setProperty(addressCode, address);
      }
      if (!mask.empty()) {
        instrumentation.setProperty(maskCode, mask);
      }
    }
  } catch (const std::exception&) {
    report.message("Caught Exception : ", failure, 533);
    return false;
  }
  report.exiting(536);
  return hasNodes;
}

class Change : Steps {
 public:
  explicit Change(const Request& request) : Steps(request) {}

  CMPIStatus answer() {
    operation_.operationEntry();
    if (!usable(request_.instance)) {
      const char* text = "Modify instance Passed is NULL";
      CMNewString(request_.broker, text, nullptr);
      operation_.message(text, ordinary, 353);
      CMReturnDone(request_.result);
      return {CMPI_RC_ERR_FAILED, nullptr};
    }
    operation_.variable("objstring", renderingOf(request_.path), 320);
    operation_.variable("modifyobjstring", renderingOf(pathOf(request_.instance, nullptr)), 330);
    const bool carriedOut = request_.className == "YRNx_MgmtHwIPProtocolEndPoint"              ? modifyEndpoint()
                            : request_.className == "YRNx_MgmtHwStaticIPAssignmentSettingData" ? modifyStaticSetting()
                                                                                               : modifyAccessPoint();
    if (!carriedOut) {
      return status_;
    }
    CMReturnDone(request_.result);
    return {status_.rc, nullptr};
  }

 private:
  static std::string renderingOf(const CMPIObjectPath* path) {
    return usable(path) ? charactersOf(CMObjectPathToString(path, nullptr), nullptr) : "";
  }

  bool modifyEndpoint() {
    const Report report = memberReport("modifyIPProtocolendptCMPIInstance");
    report.entering(458);
    const std::string name = textIn(CMGetKey(request_.path, "Name", &status_), nullptr);
    report.variable("IpName", name, 469);
    const std::string address = textProperty(request_.instance, "IPv4Address", &status_, nullptr);
    report.variable("Ipv4Address", address, 476);
    const std::string mask = textProperty(request_.instance, "SubnetMask", &status_, nullptr);
    report.variable("Ipv4SubnetMask", mask, 483);
    const bool carriedOut = write(name, address, mask);
    report.exiting(487);
    return carriedOut;
  }

  bool modifyStaticSetting() {
    const Report report = memberReport("modifyStaticIPCMPIInstance");
    report.entering(408);
    const CMPIData identifier = CMGetKey(request_.path, "InstanceID", &status_);
    if (!flaggedNull(identifier)) {
      const auto fields = fieldsOf(textIn(identifier, nullptr));
      const std::string address = textProperty(request_.instance, "IPv4Address", &status_, nullptr);
      report.variable("Ipv4Address", address, 431);
      const std::string mask = textProperty(request_.instance, "SubnetMask", &status_, nullptr);
      report.variable("Ipv4SubnetMask", mask, 438);
      write(fields.size() == 2 ? fields[1] : "", address, mask);
    }
    report.exiting(444);
    return true;
  }

  static bool modifyAccessPoint() {
    const Report report = memberReport("modifyRemoteSAPCMPIInstance");
    report.entering(310);
    report.exiting(394);
    return true;
  }
};

}  // namespace

CMPIStatus changeInstance(const Request& request) { return Change(request).answer(); }

}  // namespace Testing::Model
