// SPDX-License-Identifier: Apache-2.0
// state_writer STATE INTERFACE NETWORK CHANGES: changes the interface's address and mask that many times, 0 for ever,
// between NETWORK.1 with 255.255.255.0 and NETWORK.2 with 255.255.0.0 and so on. A line goes to standard output before
// the first change. Fails if a change that was confirmed is not there when it is read back.
#include <algorithm>
#include <exception>
#include <iostream>
#include <string>

#include "agent/backends/simulated/SimulatedBackEnd.h"

int main(int, char** arguments) {
  const std::string interfaceName = arguments[2];
  const std::string network = arguments[3];
  const int changes = std::stoi(arguments[4]);
  try {
    QV::SimulatedBackEnd processor(arguments[1]);
    std::cout << "ready" << std::endl;
    for (int count = 1; changes == 0 || count <= changes; ++count) {
      const bool odd = count % 2 != 0;
      const auto address = QV::Ipv4Address::parse(network + (odd ? ".1" : ".2"));
      processor.change(interfaceName, {address, QV::SubnetMask::parse(odd ? "255.255.255.0" : "255.255.0.0")});
      const auto interfaces = processor.read().interfaces;
      const auto own = std::find_if(interfaces.begin(), interfaces.end(),
                                    [&](const auto& candidate) { return candidate.name == interfaceName; });
      if (own == interfaces.end() || own->ipv4Address != address) {
        std::cerr << interfaceName << ": change " << count << " is lost\n";
        return 1;
      }
    }
  } catch (const std::exception& error) {
    std::cerr << error.what() << '\n';
    return 1;
  }
}
