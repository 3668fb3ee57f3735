// SPDX-License-Identifier: Apache-2.0
// How long an enumeration takes in the object manager and in cimomd, in turns, for a client that connects anew each
// time. tools/bench reads the lines that it prints.
#include <algorithm>
#include <chrono>
#include <iostream>
#include <vector>

#include "tests/hosts/HostTest.h"
#include "tests/support/Classes.h"
#include "tests/support/client/CompositeStack.h"
#include "tests/support/client/Enumeration.h"
#include "tests/support/client/HttpClient.h"

namespace {

using namespace Testing;
using Clock = std::chrono::steady_clock;

class EnumerationTimesTest : public HostTest {
 protected:
  // The answer must have that many instances.
  static double millisecondsOf(std::uint16_t port, int instances) {
    std::string headers;
    for (const auto& [name, value] : enumerationHeaders()) {
      headers += name + ": " + value + "\r\n";
    }
    const auto begin = Clock::now();
    HttpClient client(port, "127.0.0.1", std::chrono::seconds(60));
    const auto answer =
        client.post("/cimom", enumerationOf(Classes::endpoint), "Content-Type: application/xml\r\n" + headers);
    const std::chrono::duration<double, std::milli> time = Clock::now() - begin;
    EXPECT_EQ(instancesIn(answer.body), instances) << answer.status << ' ' << answer.body.substr(0, 1000);
    return time.count();
  }

  static double median(std::vector<double> times) {
    std::ranges::sort(times);
    return times[times.size() / 2];
  }
};

TEST_F(EnumerationTimesTest, OfCimomdAreTheShorterOnes) {
  for (const int instances : {3, 34, 1000}) {
    const TemporaryDirectory directory;
    const std::string state = directory.write("state.json", stateOf(instances));
    std::filesystem::permissions(directory.path(), std::filesystem::perms::all);
    serve(simulatedProcessor(state));
    CompositeStack cimomd(simulatedProcessor(state));
    std::vector<double> ofHost;
    std::vector<double> ofCimomd;
    for (int round = 0; round < std::clamp(3000 / instances, 11, 101); ++round) {
      ofHost.push_back(millisecondsOf(host().port(), instances));
      ofCimomd.push_back(millisecondsOf(cimomd.port(), instances));
    }
    std::cout << "median of " << instances << ": " << median(ofHost) << " ms, cimomd " << median(ofCimomd) << " ms\n";
    EXPECT_LT(median(ofCimomd), median(ofHost));
  }
}

}  // namespace
