// SPDX-License-Identifier: Apache-2.0
#include "tests/support/client/Enumeration.h"

#include "agent/backends/simulated/StateText.h"
#include "tests/cimom/cimxml/Messages.h"

namespace Testing {

std::string interfaceName(int number) { return "eth" + std::to_string(number); }

std::string quietAgent(const std::string& stateFile) {
  return "[system]\nname = managed.example\n"
         "[log]\ndestination = stderr\nthreshold = 6000\nthreshold.Tarnwick.SimulatedProcessor = 7000\n"
         "[trace]\ndestination = stderr\nthreshold = 6000\nthreshold.Tarnwick.SimulatedProcessor = 7000\n"
         "[processor]\nbackend = simulated\n[simulated]\nstate = " +
         stateFile + '\n';
}

std::string stateOf(int interfaces) {
  QV::ManagementProcessor processor;
  processor.name = "BMC";
  processor.description = "Simulated management processor";
  for (int number = 1; number <= interfaces; ++number) {
    const std::string network = "10." + std::to_string(number / 250) + '.' + std::to_string(number % 250) + '.';
    QV::NetworkInterface interface;
    interface.name = interfaceName(number);
    interface.macAddress = QV::MacAddress::parse("02:00:00:00:00:01");
    interface.ipv4Address = QV::Ipv4Address::parse(network + "10");
    interface.ipv4SubnetMask = QV::SubnetMask::parse("255.255.255.0");
    interface.ipv4Gateway = QV::Ipv4Address::parse(network + "1");
    interface.ipv4Origin = QV::AddressOrigin::Static;
    interface.ipv6Address = QV::Ipv6Address::parse("2001:db8::10");
    interface.ipv6PrefixLength = 64;
    interface.ipv6Origin = QV::AddressOrigin::Static;
    processor.interfaces.push_back(interface);
  }
  return QV::writeState(processor);
}

std::string enumerationOf(const std::string& className) {
  return messageOf("<IMETHODCALL NAME=\"EnumerateInstances\">" + nameSpacePath("cimv2") +
                   Testing::className(className) + "</IMETHODCALL>");
}

std::vector<std::pair<std::string, std::string>> enumerationHeaders() {
  return {{"CIMOperation", "MethodCall"}, {"CIMMethod", "EnumerateInstances"}, {"CIMObject", "root%2Fcimv2"}};
}

int instancesIn(const std::string& answer) { return count(answer, "<VALUE.NAMEDINSTANCE>"); }

}  // namespace Testing
