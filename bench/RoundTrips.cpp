// SPDX-License-Identifier: Apache-2.0
// What a BMC is asked, counted on the wire to OpenIPMI's simulator: over a real network the round trips are the cost.
#include <algorithm>
#include <future>
#include <stdexcept>

#include "agent/backends/ipmi/IpmiBackEnd.h"
#include "bench/Measurements.h"
#include "tests/support/agent/Addresses.h"
#include "tests/support/agent/SimulatedBmc.h"
#include "tests/support/agent/UdpRelay.h"

namespace Benchmark {
namespace {

using QV::Ipmi::IpmiBackEnd;
using QV::Ipmi::parseSettings;
using Testing::SimulatedBmc;
using Testing::UdpRelay;

// As the instrumentation does it: it asks which interfaces there are, and changes one.
void change(IpmiBackEnd& backEnd, const char* address, const char* mask) {
  if (backEnd.interfaceNames().size() != 1) {
    throw std::runtime_error("the simulated BMC has not one interface");
  }
  backEnd.change("lan1", {QV::ipv4(address), QV::mask(mask)});
}

// From cold to the end of the operation, and once more in the session that is held.
template <typename Operation>
void count(Results& results, const SimulatedBmc& bmc, const char* cold, const char* held, Operation operation) {
  UdpRelay wire(bmc.port());
  IpmiBackEnd backEnd(parseSettings(bmc.patientSettings(wire.port())));
  operation(backEnd, 1);
  results.figures[cold] = wire.requests();
  wire.reset();
  operation(backEnd, 2);
  results.figures[held] = wire.requests();
}

}  // namespace

void measureBmc(Results& results) {
  const SimulatedBmc bmc;
  bmc.ipmitool({"lan", "set", "1", "ipsrc", "static"});
  count(results, bmc, "read cold", "read held", [](IpmiBackEnd& backEnd, int) { backEnd.read(); });
  count(results, bmc, "write cold", "write held", [](IpmiBackEnd& backEnd, int time) {
    change(backEnd, time == 1 ? "192.0.2.77" : "192.0.2.78", time == 1 ? "255.255.255.128" : "255.255.255.0");
  });

  constexpr unsigned clients = 8;
  UdpRelay wire(bmc.port());
  IpmiBackEnd backEnd(parseSettings(bmc.patientSettings(wire.port())));
  std::vector<std::future<void>> requests;
  for (unsigned client = 0; client < clients; ++client) {
    requests.push_back(std::async(std::launch::async, [&] { backEnd.read(); }));
  }
  for (auto& request : requests) {
    request.get();
  }
  // All but the first find the session open.
  const double held = results.figures.at("read held");
  const double opening = results.figures.at("read cold") - held;
  results.figures["burst"] = (wire.requests() - clients * held) / opening;
}

}  // namespace Benchmark
