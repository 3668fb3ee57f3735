// SPDX-License-Identifier: Apache-2.0
// cimomd where memory runs out.
#include <gtest/gtest.h>

#include <deque>

#include "tests/support/client/Cimomd.h"
#include "tests/support/client/HttpClient.h"
#include "tests/support/system/Build.h"
#include "tests/support/system/Poll.h"

namespace {

using namespace Testing;

class MemoryTest : public testing::Test {
 protected:
  static std::vector<std::string> options() {
    std::vector<std::string> all = Cimomd::probeOptions();
    all.insert(all.end(), {"--max-request-memory", "2147483647", "--max-connections-per-address", "512"});
    return all;
  }

  static bool answers(Cimomd& cimomd) { return cimomd.wbemcli({"ein"}, "TEST_Thing").status == 0; }
};

TEST_F(MemoryTest, OutlivesBodiesThatItHasNoMemoryFor) {
  if (sanitized()) {
    GTEST_SKIP() << "a sanitizer ends the program where memory runs out";
  }
  Cimomd cimomd(options());
  ASSERT_TRUE(answers(cimomd));
  const std::string id = std::to_string(cimomd.process().id());
  // What it has, and a little more.
  const std::string status = readFile("/proc/" + id + "/status");
  const auto kilobytes = std::stoul(status.substr(status.find("VmSize:") + 7));
  ASSERT_EQ(run({"prlimit", "--pid", id, "--as=" + std::to_string((kilobytes + 48 * 1024) * 1024)}).status, 0);
  const std::string head = "POST /cimom HTTP/1.1\r\nHost: localhost\r\nContent-Length: 4000000\r\n\r\n";
  const std::string body(3999999, ' ');
  std::deque<HttpClient> clients;
  for (int i = 0; i < 40; ++i) {
    HttpClient& client = clients.emplace_back(cimomd.port());
    client.send(head);
    client.send(body);
  }
  ASSERT_TRUE(cimomd.process().isRunning()) << cimomd.process().errors();
  // Some have been cut off; the others are answered.
  int cut = 0;
  for (HttpClient& client : clients) {
    try {
      client.send("x");
      client.receive();
    } catch (const std::runtime_error&) {
      ++cut;
    }
  }
  EXPECT_GT(cut, 0);
  clients.clear();
  EXPECT_TRUE(poll([&] { return answers(cimomd); }));
  EXPECT_EQ(cimomd.stop(), 0) << cimomd.process().errors();
}

}  // namespace
