// SPDX-License-Identifier: Apache-2.0
// A thousand servers asked by one bmcip, and by a loop over wbemcli that asks each the same three questions. One object
// manager with the product's providers stands behind 900 loopback addresses; of the other hundred a third each hang,
// refuse the connection and break off, which the loop is spared. Fails where bmcip loses a server, is not ten times as
// fast, or takes 64 MB.
#include <sys/resource.h>
#include <sys/wait.h>

#include <chrono>
#include <cstdlib>
#include <fstream>
#include <iostream>
#include <memory>

#include "cimom/ObjectManager.h"
#include "cimom/cimxml/Endpoint.h"
#include "cimom/http/Acceptor.h"
#include "cimom/http/Server.h"
#include "tests/bmcip/RawServer.h"
#include "tests/support/system/Build.h"
#include "tests/support/system/Process.h"
#include "tests/support/system/TemporaryDirectory.h"

namespace {

using namespace Testing;
using Clock = std::chrono::steady_clock;

constexpr int servers = 1000;
constexpr int loopServers = 100;
constexpr double leastRatio = 10;
constexpr long mostMemory = 64 * 1024;  // KiB
constexpr const char* classes[] = {"ComputerSystem", "IPProtocolEndPoint", "RemoteServiceAccessPoint"};

double secondsSince(Clock::time_point begin) { return std::chrono::duration<double>(Clock::now() - begin).count(); }

std::string addressOf(int server) {
  return "127.0." + std::to_string(1 + server / 200) + "." + std::to_string(1 + server % 200);
}

struct Answer {
  double seconds;
  long memory;  // KiB at most
  int answered = 0;
  int failed = 0;
};

Answer askFleet(const TemporaryDirectory& directory) {
  const std::string output = directory / "output";
  const auto begin = Clock::now();
  const pid_t process = fork();
  if (process == 0) {
    const std::string command = "exec " + built("bin/bmcip") + " show --json --timeout 1 --hosts " +
                                (directory / "hosts") + " >" + output + " 2>" + (directory / "errors");
    execl("/bin/sh", "sh", "-c", command.c_str(), nullptr);
    _exit(127);
  }
  int status = 0;
  rusage usage{};
  wait4(process, &status, 0, &usage);
  Answer answer{secondsSince(begin), usage.ru_maxrss};
  std::ifstream lines(output);
  for (std::string line; std::getline(lines, line);) {
    ++(line.find("\"interfaces\":[{") != std::string::npos ? answer.answered : answer.failed);
  }
  return answer;
}

// Servers a second.
double askInALoop(std::uint16_t port) {
  const auto begin = Clock::now();
  for (int server = 0; server < loopServers; ++server) {
    for (const char* name : classes) {
      const std::string url =
          "http://" + addressOf(server) + ":" + std::to_string(port) + "/root/cimv2:YRNx_MgmtHw" + name;
      if (run({"wbemcli", "ei", url}).status != 0) {
        throw std::runtime_error("wbemcli failed at " + url);
      }
    }
  }
  return loopServers / secondsSince(begin);
}

int measure() {
  const TemporaryDirectory directory;
  const std::string ini = directory.write(
      "agent.ini", "[processor]\nbackend = simulated\n[simulated]\nstate = " + (directory / "processor.json") + "\n");
  setenv("QV_AGENT_INI", ini.c_str(), 1);
  Cimom::ObjectManager manager;
  manager.loadSchema(built("share/cimomd"));
  manager.loadRegistration(built("share/cimomd/CompositeIPConfig.reg"));
  manager.loadRegistration(built("share/cimomd/UnderlyingIPConfig.reg"));
  manager.addProviderDirectory(built("lib"));
  manager.checkProviders();
  const Cimom::CimXml::Endpoint endpoint(manager.broker(), manager.classes(), "fleet.example");
  Cimom::Http::ServerOptions options;
  options.maxConnections = servers;
  options.maxConnectionsPerAddress = servers;
  Cimom::Http::Server server(options, [&](const Cimom::Http::Request& request) { return endpoint.handle(request); });

  // One server behind all the addresses, which of itself serves no more than one without TLS.
  Cimom::Http::Listener listener("0.0.0.0", 0);
  listener.listen();
  const std::uint16_t port = listener.port();
  const Cimom::Http::Acceptor acceptor(
      std::move(listener), [&](int descriptor, const sockaddr_storage&, socklen_t) { server.adopt(descriptor); });

  const RawServer hanging(RawServer::Manner::Hang);
  const RawServer breaking(RawServer::Manner::BreakOff);
  const std::string faulty[] = {hanging.url(), breaking.url(), "http://127.0.0.1:1"};
  std::ofstream hosts(directory / "hosts");
  for (int i = 0; i < servers; ++i) {
    hosts << (i % 10 == 7 ? faulty[i / 10 % 3] : "http://" + addressOf(i) + ":" + std::to_string(port)) << '\n';
  }
  hosts.close();

  const Answer answer = askFleet(directory);
  const double loop = askInALoop(server.port());
  const double fleet = servers / answer.seconds;
  std::cout << "bmcip:   " << servers << " servers in " << answer.seconds << " s, " << fleet << " a second; "
            << answer.answered << " answered, " << answer.failed << " failed; " << answer.memory / 1024.0 << " MB\n"
            << "wbemcli: " << loop << " servers a second, of those that answer\n"
            << "ratio:   " << fleet / loop << std::endl;
  const bool lost = answer.answered != servers * 9 / 10 || answer.failed != servers / 10;
  return lost || fleet < leastRatio * loop || answer.memory >= mostMemory ? EXIT_FAILURE : EXIT_SUCCESS;
}

}  // namespace

int main() {
  try {
    return measure();
  } catch (const std::exception& error) {
    std::cerr << "fleet_benchmark: " << error.what() << '\n';
    return EXIT_FAILURE;
  }
}
