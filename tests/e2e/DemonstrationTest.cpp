// The demonstration that newcomers see first, and the picture that it draws.
#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include <filesystem>

#include "Paths.h"
#include "tests/e2e/DemonstrationFixture.h"
#include "tests/support/client/CompositeStack.h"

namespace {

using namespace Testing;
using testing::ContainsRegex;
using testing::HasSubstr;
using testing::IsEmpty;
using testing::SizeIs;
using testing::StartsWith;

namespace fs = std::filesystem;

TEST_F(DemonstrationTest, ShowsTheSystemAChangeAndTheModel) {
  const Completed completed = demonstrate({});
  ASSERT_EQ(completed.status, 0) << completed.errors;
  const std::string& shown = completed.output;
  EXPECT_THAT(shown, ContainsRegex("BMC +Simulated management processor +14, 28 +1\n"));
  EXPECT_THAT(shown, HasSubstr("It is simulated: its values are made up"));
  EXPECT_THAT(shown, ContainsRegex("before:\n.*\n  eth0 +192.0.2.10 +255.255.255.0 +static\n"));
  EXPECT_THAT(shown, ContainsRegex("after:\n.*\n  eth0 +192.0.2.77 +255.255.255.128 +static\n"));
  EXPECT_THAT(shown,
              ContainsRegex("\nBMC\n.* IPHostedAccessPoint\n.* eth0\n.* ClientAccess: Gateway:eth0, DNS:1, DNS:2\n"));
  EXPECT_THAT(contentOf(build() / "model.dot"), StartsWith("digraph model {"));
  expectNothingLeft();
}

TEST_F(DemonstrationTest, LeavesNothingBehindWhereItFails) {
  fs::remove(build() / "share");
  const Completed completed = demonstrate({});
  EXPECT_NE(completed.status, 0);
  EXPECT_THAT(completed.errors, HasSubstr("share/cimomd"));
  expectNothingLeft();
}

class ModelGraphTest : public testing::Test {
 protected:
  Completed draw(const std::string& form, const std::string& nameSpace = "root/cimv2") const {
    std::string url = stack_.url("", nameSpace);
    url.pop_back();
    return run({SOURCE_DIR "/tools/model-graph", form, url});
  }

  TemporaryDirectory directory_;
  CompositeStack stack_{simulatedProcessor(directory_.path() / "processor.json")};
};

TEST_F(ModelGraphTest, HasEveryInstanceAsANodeAndEveryAssociationAsAnEdge) {
  const Completed graph = draw("dot");
  ASSERT_EQ(graph.status, 0) << graph.errors;
  std::vector<std::string> nodes;
  std::vector<std::string> edges;
  for (const std::string& line : linesOf(graph.output)) {
    if (line.find("root/cimv2:") == std::string::npos) continue;
    (line.find(" -> ") == std::string::npos ? nodes : edges).push_back(line);
  }
  // A system, 2 endpoints, 3 access points, 4 sequences, 2 static and 2 DHCP settings; 2 and 3 hosted, 6 by client
  // access, 8 sequences of endpoints, and each of the 4 settings in the sequence of its kind.
  EXPECT_THAT(nodes, SizeIs(14));
  EXPECT_THAT(edges, SizeIs(23));
}

TEST_F(ModelGraphTest, IsAGraphThatGraphvizTakes) {
  if (run({"sh", "-c", "command -v dot"}).status != 0) GTEST_SKIP() << "dot (graphviz) is not there";
  const auto file = directory_.write("model.dot", draw("dot").output);
  const Completed drawn = run({"dot", "-Tplain", file.string()});
  ASSERT_EQ(drawn.status, 0) << drawn.errors;
  std::size_t nodes = 0;
  std::size_t edges = 0;
  for (const std::string& line : linesOf(drawn.output)) {
    nodes += line.starts_with("node ") ? 1 : 0;
    edges += line.starts_with("edge ") ? 1 : 0;
  }
  EXPECT_EQ(nodes, 14U);
  EXPECT_EQ(edges, 23U);
}

TEST_F(ModelGraphTest, FailsWhereNothingIsFound) {
  const Completed completed = draw("tree", "root/nowhere");
  EXPECT_NE(completed.status, 0);
  EXPECT_THAT(completed.output, IsEmpty());
  EXPECT_EQ(draw("picture").status, 2);
}

}  // namespace
