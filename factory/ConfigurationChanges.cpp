// SPDX-License-Identifier: Apache-2.0
// The write members. The source lines in the trace are fixed (compatibility 3).
#include <QV/Instrumentation.h>

#include <exception>

#include "factory/CmpiAccess.h"
#include "factory/FactoryFrame.h"
#include "factory/IPConfigObjectFactory.h"

namespace QV::IPConfigComposite {

namespace {

// Moves the cursor to the node of that name; false if no node bears it.
bool findNode(Instrumentation& nodes, const std::string& name, const Frame& frame) {
  std::string nodeName;
  while (nodes) {
    // compatibility 25: a node whose name cannot be read is passed over by the instrumentation itself.
    if (!nodes.getProperty(NodeLexicon::NodeName, nodeName)) {
      continue;
    }
    frame.variable("name", nodeName.c_str(), 514);
    if (nodeName == name) {
      frame.variable("name", nodeName.c_str(), 517);
      return true;
    }
    ++nodes;
  }
  return false;
}

int writeToNode(const std::string& name, std::string& ipv4Address, std::string& subnetMask, const Frame& frame) {
  Instrumentation nodes;
  nodes.selectNode(NodeLexicon::IpInterfaceNode);
  if (!nodes) {
    return 1;
  }
  if (findNode(nodes, name, frame)) {
    if (!ipv4Address.empty()) {
      nodes.setProperty(NodeLexicon::Ipv4Address, ipv4Address);
    }
    if (!subnetMask.empty()) {
      nodes.setProperty(NodeLexicon::Ipv4SubnetMask, subnetMask);
    }
  }
  return 0;
}

}  // namespace

// NOLINTNEXTLINE(performance-unnecessary-value-param): the signature is fixed.
int IPConfigObjectFactory::executeModifyInstance(std::string name, std::string ipv4Address, std::string subnetMask) {
  const Frame frame = factoryFrame(__func__);
  frame.entering(498);
  int result;
  try {
    result = writeToNode(name, ipv4Address, subnetMask, frame);
  } catch (const std::exception&) {
    // The reason stands in the log of the instrumentation, in its own words.
    frame.failure("Caught Exception : ", 533);
    return 1;
  }
  frame.exiting(536);
  return result;
}

int IPConfigObjectFactory::modifyIPProtocolendptCMPIInstance(const CMPIBroker*, const CMPIContext*,
                                                             const CMPIObjectPath* cop, const char**, bool,
                                                             const CMPIInstance* ci, CMPIStatus* status) {
  const Frame frame = factoryFrame(__func__);
  frame.entering(458);
  const std::string name = textOf(keyOf(cop, "Name", status), nullptr);
  frame.variable("IpName", name.c_str(), 469);
  const std::string ipv4Address = textOf(propertyOf(ci, "IPv4Address", status), nullptr);
  frame.variable("Ipv4Address", ipv4Address.c_str(), 476);
  const std::string subnetMask = textOf(propertyOf(ci, "SubnetMask", status), nullptr);
  frame.variable("Ipv4SubnetMask", subnetMask.c_str(), 483);
  const int result = executeModifyInstance(name, ipv4Address, subnetMask);
  frame.exiting(487);
  return result;
}

int IPConfigObjectFactory::modifyStaticIPCMPIInstance(const CMPIBroker*, const CMPIContext*, const CMPIObjectPath* cop,
                                                      const char**, bool, const CMPIInstance* ci, CMPIStatus* status) {
  const Frame frame = factoryFrame(__func__);
  frame.entering(408);
  const CMPIData identifier = keyOf(cop, "InstanceID", status);
  if (CMIsNullValue(identifier)) {
    frame.exiting(444);
    return 0;
  }
  std::vector<std::string> fields;
  Tokenize(textOf(identifier, nullptr), fields, ":");
  const std::string name = fields.size() == 2 ? fields[1] : "";
  const std::string ipv4Address = textOf(propertyOf(ci, "IPv4Address", status), nullptr);
  frame.variable("Ipv4Address", ipv4Address.c_str(), 431);
  const std::string subnetMask = textOf(propertyOf(ci, "SubnetMask", status), nullptr);
  frame.variable("Ipv4SubnetMask", subnetMask.c_str(), 438);
  // compatibility 16: whether the write went through stands in the instrumentation's log; the client is not told.
  executeModifyInstance(name, ipv4Address, subnetMask);
  frame.exiting(444);
  return 0;
}

int IPConfigObjectFactory::modifyRemoteSAPCMPIInstance(const CMPIBroker*, const CMPIContext*, const CMPIObjectPath*,
                                                       const char**, bool, const CMPIInstance*, CMPIStatus*) {
  const Frame frame = factoryFrame(__func__);
  frame.entering(310);
  frame.exiting(394);
  return 0;
}

void IPConfigObjectFactory::executeSAPModifyInstance(const CMPIBroker*, const CMPIContext*, const CMPIObjectPath*,
                                                     const CMPIInstance*, CMPIStatus*, const char**) {
  factoryFrame(__func__).entering(550);
}

}  // namespace QV::IPConfigComposite
