// SPDX-License-Identifier: Apache-2.0
// What a running cimomd costs: the processor time of its process in turns with that of an HTTP server that returns the
// same bytes, and its memory.
#include <time.h>

#include <algorithm>
#include <chrono>
#include <memory>
#include <optional>
#include <stdexcept>
#include <thread>

#include "bench/Measurements.h"
#include "tests/cimom/cimxml/CostlyRequests.h"
#include "tests/support/client/CompositeStack.h"
#include "tests/support/client/Enumeration.h"
#include "tests/support/client/HttpClient.h"
#include "tests/support/system/Build.h"
#include "tests/support/system/Footprint.h"
#include "tests/support/system/Poll.h"

namespace Benchmark {
namespace {

using namespace Testing;
using Clock = std::chrono::steady_clock;

constexpr const char* endpointClass = "YRNx_MgmtHwIPProtocolEndPoint";

double processorSeconds(pid_t process) {
  clockid_t clock{};
  timespec time{};
  if (clock_getcpuclockid(process, &clock) != 0 || clock_gettime(clock, &time) != 0) {
    throw std::runtime_error("the processor time of process " + std::to_string(process) + " cannot be read");
  }
  return static_cast<double>(time.tv_sec) + static_cast<double>(time.tv_nsec) / 1e9;
}

double median(std::vector<double> values) {
  std::ranges::nth_element(values, values.begin() + static_cast<std::ptrdiff_t>(values.size() / 2));
  return values[values.size() / 2];
}

std::string headerLines() {
  std::string lines;
  for (const auto& [name, value] : enumerationHeaders()) {
    lines += name + ": " + value + "\r\n";
  }
  return lines;
}

// A server that is asked for one enumeration again and again, over one connection.
class Asked {
 public:
  Asked(std::uint16_t port, pid_t process) : client_(port, "127.0.0.1", std::chrono::seconds(60)), process_(process) {}

  std::string ask() {
    const auto begin = Clock::now();
    auto response = client_.post("/cimom", body_, headers_);
    milliseconds_.push_back(std::chrono::duration<double, std::milli>(Clock::now() - begin).count());
    if (response.status != 200) {
      throw std::runtime_error("a request is answered with HTTP status " + std::to_string(response.status));
    }
    return std::move(response.body);
  }

  // What was asked so far has warmed it up.
  void begin() {
    milliseconds_.clear();
    begin_ = processorSeconds(process_);
  }

  double milliseconds() const { return median(milliseconds_); }
  // Of all requests together, with what the server does after a client has its answer.
  double processor() const { return processorSeconds(process_) - begin_; }

 private:
  HttpClient client_;
  const pid_t process_;
  const std::string body_ = enumerationOf(endpointClass);
  const std::string headers_ = headerLines();
  std::vector<double> milliseconds_;
  double begin_ = 0;
};

// The product as it runs, with that many interfaces.
class Served {
 public:
  explicit Served(int interfaces)
      : cimomd_(CompositeStack::options(),
                {{"QV_AGENT_INI",
                  directory_.write("agent.ini", quietAgent(directory_.write("state.json", stateOf(interfaces))))}}),
        asked_(cimomd_.port(), cimomd_.process().id()) {}

  Asked& asked() { return asked_; }

 private:
  const TemporaryDirectory directory_;
  Cimomd cimomd_;
  Asked asked_;
};

class Echo {
 public:
  explicit Echo(const std::string& answer)
      : process_({built("bin/http_echo"), directory_.write("answer", answer)}),
        asked_(static_cast<std::uint16_t>(std::stoul(process_.readLine())), process_.id()) {}

  Asked& asked() { return asked_; }

 private:
  const TemporaryDirectory directory_;
  Process process_;
  Asked asked_;
};

// Enough rounds for a median, within seconds.
int roundsFor(int instances) { return std::clamp(20000 / instances, 7, 300); }

}  // namespace

void measureEcho(Results& results) {
  for (const int instances : {3, 10, 34, 100, 1000, 10000}) {
    Served served(instances);
    const std::string answer = served.asked().ask();
    if (instancesIn(answer) != instances) {
      throw std::runtime_error("cimomd answers " + std::to_string(instancesIn(answer)) + " instances, not " +
                               std::to_string(instances));
    }
    Echo echo(answer);
    echo.asked().ask();
    served.asked().begin();
    echo.asked().begin();
    for (int round = 0; round < roundsFor(instances); ++round) {
      served.asked().ask();
      echo.asked().ask();
    }
    results.size(instances).milliseconds = served.asked().milliseconds();
    results.size(instances).echo = echo.asked().milliseconds();
    results.figures["echo " + std::to_string(instances)] = served.asked().processor() / echo.asked().processor();
  }
}

namespace {

// One of many clients: sends the request, and takes whatever answer there is. A server that has enough says so.
void send(std::uint16_t port, const CostlyRequest& request, std::size_t bytes) {
  try {
    HttpClient client(port, "127.0.0.1", std::chrono::seconds(60));
    client.post("/cimom", request.body(bytes),
                "CIMOperation: MethodCall\r\nCIMMethod: " + request.method + "\r\nCIMObject: root%2Ftest\r\n");
  } catch (const std::runtime_error&) {
    // Refused while it was still sending.
  }
}

}  // namespace

// Of each kind of costly request, in a cimomd of its own; the worst counts.
void measureMemory(Results& results) {
  constexpr int clients = 60;
  constexpr std::size_t bytes = 3U << 20U;
  constexpr double mebibyte = 1024;
  double& peak = results.figures["peak"];
  double& kept = results.figures["kept"];
  for (const CostlyRequest& request : costlyRequests()) {
    Cimomd cimomd(Cimomd::probeOptions());
    const pid_t process = cimomd.process().id();
    {
      std::vector<std::jthread> all;
      all.reserve(clients);
      for (int client = 0; client < clients; ++client) {
        all.emplace_back([&] { send(cimomd.port(), request, bytes); });
      }
    }
    peak = std::max(peak, static_cast<double>(peakResidentKib(process)) / mebibyte);
    // What is idle goes back to the system within a moment.
    long least = residentKib(process);
    const auto deadline = Clock::now() + std::chrono::seconds(1);
    poll([&] {
      least = std::min(least, residentKib(process));
      return Clock::now() > deadline;
    });
    kept = std::max(kept, static_cast<double>(least) / mebibyte);
  }
}

}  // namespace Benchmark
