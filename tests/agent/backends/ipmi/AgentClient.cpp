// SPDX-License-Identifier: Apache-2.0
// agent_client: does what standard input says with the agent's instrumentation and answers each line with one.
//   read                  "lan1 192.0.2.10/255.255.255.0", interface by interface
//   change ADDRESS MASK   changes the first interface; "done"
// A failure is answered with its reason.
#include <QV/Instrumentation.h>

#include <exception>
#include <iostream>
#include <sstream>
#include <string>

namespace {

using namespace QV::NodeLexicon;

std::string valueOf(QV::Instrumentation& instrumentation, Properties property) {
  std::string value;
  return instrumentation.getProperty(property, value) ? value : "(none)";
}

std::string read() {
  std::string text;
  QV::Instrumentation instrumentation;
  for (instrumentation.selectNode(IpInterfaceNode); instrumentation; ++instrumentation) {
    text += (text.empty() ? "" : ", ") + valueOf(instrumentation, NodeName) + ' ' +
            valueOf(instrumentation, Ipv4Address) + '/' + valueOf(instrumentation, Ipv4SubnetMask);
  }
  return text;
}

std::string change(std::string address, std::string mask) {
  QV::Instrumentation instrumentation;
  instrumentation.selectNode(IpInterfaceNode);
  instrumentation.setProperty(Ipv4Address, address);
  instrumentation.setProperty(Ipv4SubnetMask, mask);
  return "done";
}

std::string answer(const std::string& line) {
  std::istringstream words(line);
  std::string command;
  std::string address;
  std::string mask;
  words >> command >> address >> mask;
  try {
    return command == "read" ? read() : change(address, mask);
  } catch (const std::exception& error) {
    return error.what();
  }
}

}  // namespace

int main() {
  for (std::string line; std::getline(std::cin, line);) {
    std::cout << answer(line) << std::endl;
  }
}
