// SPDX-License-Identifier: Apache-2.0
#include <gmock/gmock.h>

#include <regex>

#include "tests/bmcip/BmcipTest.h"

namespace {

using namespace Testing;
using testing::HasSubstr;
using testing::StartsWith;

class BmcipModelTest : public BmcipStackTest {};

std::size_t count(const std::string& text, const std::string& part) {
  std::size_t found = 0;
  for (auto place = text.find(part); place != std::string::npos; place = text.find(part, place + 1)) {
    ++found;
  }
  return found;
}

TEST_F(BmcipModelTest, GrowsATree) {
  const Completed tree = bmcip({"model"});
  EXPECT_EQ(tree.status, 0) << tree.errors;
  EXPECT_THAT(tree.output, StartsWith("BMC\n├─ IPHostedAccessPoint\n│  ├─ eth0\n│  │  ├─ ClientAccess: Gateway:eth0, "
                                      "DNS:1, DNS:2\n│  │  └─ IPElementSettingData\n│  │     ├─ BMC:eth0:static\n"
                                      "│  │     │  └─ StaticIPOrderedMemberOfCollection: BMC:eth0\n"));
  EXPECT_THAT(tree.output, HasSubstr("\n└─ IPRemoteHostedAccessPoint: Gateway:eth0, DNS:1, DNS:2\n"));
}

// A system, 2 endpoints, 3 access points, 4 sequences, 2 static and 2 DHCP settings; 2 and 3 hosted, 6 by client
// access, 8 sequences of endpoints, and each of the 4 settings in the sequence of its kind.
TEST_F(BmcipModelTest, HasEveryInstanceAndEveryAssociation) {
  const std::string json = bmcip({"model", "--json"}).output;
  EXPECT_EQ(count(json, "\"class\":"), 14U);
  EXPECT_EQ(count(json, "\"association\":"), 23U);
}

TEST_F(BmcipModelTest, DrawsAPicture) {
  if (run({"sh", "-c", "command -v dot"}).status != 0) {
    GTEST_SKIP() << "dot (graphviz) is not there";
  }
  ASSERT_EQ(bmcip({"model", "--svg", directory_ / "model.svg"}).status, 0);
  const std::string svg = readFile(directory_ / "model.svg");
  EXPECT_EQ(count(svg, "class=\"node\""), 14U);
  EXPECT_EQ(count(svg, "class=\"edge\""), 23U + 0U);
  EXPECT_EQ(bmcip({"model", "--svg", "-"}).output, svg);
  const auto ordinateOf = [&](const std::string& name) {
    std::smatch found;
    const std::regex text("y=\"(-?[0-9.]+)\"[^>]*>" + name + "</text>");
    return std::regex_search(svg, found, text) ? std::stod(found[1]) : 0;
  };
  EXPECT_LT(ordinateOf("eth0"), ordinateOf("eth1"));
}

TEST_F(BmcipModelTest, SaysWhatItNeedsToDraw) {
  environment_["PATH"] = "/nowhere";
  const Completed failed = bmcip({"model", "--svg", directory_ / "model.svg"});
  EXPECT_EQ(failed.status, 1);
  EXPECT_THAT(failed.errors, HasSubstr("graphviz"));
  EXPECT_THAT(readFile(directory_ / "model.svg"), testing::IsEmpty());
}

}  // namespace
