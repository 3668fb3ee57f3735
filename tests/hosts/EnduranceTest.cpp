// SPDX-License-Identifier: Apache-2.0
// Many requests over connections that are kept, each answered as the first of its kind was, in memory that stays.
#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include <chrono>
#include <iostream>
#include <numeric>
#include <optional>

#include "tests/cimom/cimxml/Messages.h"
#include "tests/hosts/HostProcesses.h"
#include "tests/hosts/HostTest.h"
#include "tests/support/client/CompositeObjects.h"
#include "tests/support/client/FactoryState.h"
#include "tests/support/client/HttpClient.h"
#include "tests/support/system/Footprint.h"

namespace {

using namespace Testing;
using testing::HasSubstr;
using testing::Not;

constexpr int warmUp = 1000;
constexpr int requests = 5000;
// An allocator grows in steps, when another thread comes to it, say: what leaks, grows in every round.
constexpr int rounds = 3;
constexpr long toleratedKib = 512;

// An intrinsic method and its parameters.
struct Call {
  std::string method;
  std::string parameters;
};

// A client that keeps its connection for as long as the object manager does.
class Client {
 public:
  explicit Client(std::uint16_t port) : port_(port) {}

  std::string answerTo(const Call& call) {
    if (!connection_) {
      connection_.emplace(port_);
    }
    const std::string body = messageOf("<IMETHODCALL NAME=\"" + call.method + "\">" + nameSpacePath("cimv2") +
                                       call.parameters + "</IMETHODCALL>");
    const auto response = connection_->post(
        "/cimom", body,
        "Content-Type: application/xml; charset=\"utf-8\"\r\nCIMOperation: MethodCall\r\nCIMMethod: " + call.method +
            "\r\nCIMObject: root%2Fcimv2\r\n");
    const std::string* connection = response.headers.find("Connection");
    if (connection && *connection == "close") {
      connection_.reset();
    }
    return response.body;
  }

 private:
  const std::uint16_t port_;
  std::optional<HttpClient> connection_;
};

std::string endpointPath(const std::string& interface) {
  return instanceName(
      "YRNx_MgmtHwIPProtocolEndPoint",
      keyBinding("SystemCreationClassName", "YRNx_MgmtHwComputerSystem") + keyBinding("SystemName", "BMC") +
          keyBinding("CreationClassName", "YRNx_MgmtHwIPProtocolEndPoint") + keyBinding("Name", interface));
}

std::vector<Call> calls() {
  std::vector<Call> all;
  std::vector<std::string> classes;
  for (const ClassCase& row : classCases()) {
    classes.push_back(row.className);
  }
  for (const Enumeration& row : enumerations()) {
    classes.emplace_back(row.association);
  }
  for (const std::string& name : classes) {
    all.push_back({"EnumerateInstances", className(name)});
    all.push_back({"EnumerateInstanceNames", className(name)});
  }
  all.push_back({"GetInstance", parameter("InstanceName", endpointPath("eth1"))});
  // Of a named association: where none is named, OpenPegasus orders the answers now so, now so.
  for (const auto& [method, filter] :
       {std::pair{"Associators", "AssocClass"}, std::pair{"AssociatorNames", "AssocClass"},
        std::pair{"References", "ResultClass"}, std::pair{"ReferenceNames", "ResultClass"}}) {
    all.push_back({method, parameter("ObjectName", endpointPath("eth1")) +
                               parameter(filter, "<CLASSNAME NAME=\"" + std::string(Classes::clientAccess) + "\"/>")});
  }
  return all;
}

Call changeOfAddress(const std::string& address) {
  return {"ModifyInstance",
          parameter("ModifiedInstance",
                    "<VALUE.NAMEDINSTANCE>" + endpointPath("eth0") +
                        "<INSTANCE CLASSNAME=\"YRNx_MgmtHwIPProtocolEndPoint\"><PROPERTY NAME=\"IPv4Address\" "
                        "TYPE=\"string\"><VALUE>" +
                        address + "</VALUE></PROPERTY></INSTANCE></VALUE.NAMEDINSTANCE>")};
}

class HostEnduranceTest : public HostTest {
 protected:
  static long residentProviders() {
    long sum = 0;
    for (const pid_t process : ObjectManager::providerProcesses()) {
      sum += residentKib(process);
    }
    return sum;
  }
};

TEST_F(HostEnduranceTest, ServesThousandsOfRequestsInTheSameMemory) {
  // Given the answers to what only reads, and a change of address that is made and taken back in every ten requests
  const std::vector<Call> reading = calls();
  const Call changes[] = {changeOfAddress("192.0.2.77"), changeOfAddress("192.0.2.10")};
  Client client(host().port());
  std::vector<std::string> expected;
  for (const Call& call : reading) {
    expected.push_back(client.answerTo(call));
    ASSERT_THAT(expected.back(), Not(HasSubstr("<ERROR"))) << call.method << call.parameters;
  }
  const auto serve = [&](int count) {
    for (int i = 0; i < count; ++i) {
      if (i % 10 >= 8) {
        ASSERT_THAT(client.answerTo(changes[i % 2]), Not(HasSubstr("<ERROR")));
      } else {
        const std::size_t which = static_cast<std::size_t>(i) % reading.size();
        ASSERT_EQ(client.answerTo(reading[which]), expected[which]) << reading[which].method;
      }
    }
  };
  serve(warmUp);
  const auto processes = ObjectManager::providerProcesses();
  for (int round = 1, grown = toleratedKib + 1; round <= rounds && grown > toleratedKib; ++round) {
    // When
    const long before = residentProviders();
    const auto begin = std::chrono::steady_clock::now();
    serve(requests);
    const std::chrono::duration<double> seconds = std::chrono::steady_clock::now() - begin;

    // Then
    grown = static_cast<int>(residentProviders() - before);
    std::cout << requests << " requests in " << seconds.count() << " s, providers resident " << before
              << " KiB before, " << before + grown << " KiB after\n";
    EXPECT_TRUE(grown <= toleratedKib || round < rounds) << "the providers grew in every round";
  }
  EXPECT_EQ(ObjectManager::providerProcesses(), processes);
}

}  // namespace
