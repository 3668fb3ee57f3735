// The demonstration that newcomers see first, and the picture that it draws.
#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include <csignal>
#include <filesystem>
#include <map>
#include <regex>

#include "Paths.h"
#include "tests/e2e/DemonstrationFixture.h"
#include "tests/support/client/CompositeStack.h"
#include "tests/support/system/Poll.h"

namespace {

using namespace Testing;
using testing::_;
using testing::AllOf;
using testing::ContainsRegex;
using testing::ElementsAre;
using testing::HasSubstr;
using testing::IsEmpty;
using testing::Not;
using testing::Pair;
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

TEST_F(DemonstrationTest, RefusesWhatItDoesNotKnow) {
  EXPECT_EQ(run({SOURCE_DIR "/tools/demonstrate", "--bcm"}).status, 2);
  EXPECT_EQ(run({SOURCE_DIR "/tools/demonstrate", "/nowhere"}).status, 2);
  const Completed help = run({SOURCE_DIR "/tools/demonstrate", "--help"});
  EXPECT_EQ(help.status, 0);
  EXPECT_THAT(help.output, StartsWith("usage: demonstrate [--bmc] [BUILD_DIR]\n"));
}

TEST_F(DemonstrationTest, IsColouredOnATerminalThatWantsIt) {
  std::string words;
  for (const std::string& word : command({})) words += "'" + word + "' ";
  Environment terminal = environment();
  terminal["TERM"] = "xterm";
  terminal["NO_COLOR"] = "";
  const std::string bold = "\033[1m";
  EXPECT_THAT(run({"script", "-qec", words, "/dev/null"}, terminal).output, HasSubstr(bold));
  terminal["NO_COLOR"] = "1";
  EXPECT_THAT(run({"script", "-qec", words, "/dev/null"}, terminal).output,
              AllOf(HasSubstr("What now"), Not(HasSubstr("\033"))));
  EXPECT_THAT(demonstrate({}).output, AllOf(HasSubstr("What now"), Not(HasSubstr("\033"))));
}

TEST_F(DemonstrationTest, EndsWithCommandsThatWork) {
  const Completed completed = demonstrate({});
  ASSERT_EQ(completed.status, 0) << completed.errors;
  const auto begin = completed.output.find("QV_AGENT_INI=");
  const auto end = completed.output.find("wbemcli ei http://localhost:5988/", begin);
  ASSERT_NE(end, std::string::npos);
  std::string server = completed.output.substr(begin, completed.output.find_last_not_of(" \n", end - 1) + 1 - begin);
  Process cimomd({"bash", "-c", server + " --port 0"});
  EXPECT_TRUE(poll([&] { return cimomd.output().starts_with("listening on "); })) << cimomd.errors();
  cimomd.signal(SIGTERM);
  EXPECT_EQ(cimomd.wait(), 0);
}

TEST_F(DemonstrationTest, LeavesNoProcessBehindWhereItIsKilled) {
  Process process(command({}), environment());
  ASSERT_TRUE(poll([&] { return process.output().find("Its IP interfaces") != std::string::npos; }));
  process.signal(SIGKILL);
  process.wait();
  expectNoProcessLeft();
}

TEST(FirstCommandsTest, ExplainThemselvesAndRefuseWhatTheyDoNotKnow) {
  for (const std::string name : {"quickstart", "check"}) {
    const std::string program = SOURCE_DIR "/" + name;
    for (const char* option : {"-h", "--help"}) {
      const Completed help = run({program, option});
      EXPECT_EQ(help.status, 0);
      EXPECT_THAT(help.output, StartsWith("usage: ./" + name));
      EXPECT_THAT(help.errors, IsEmpty());
    }
    for (const char* last : {"--bcm", "build"}) {
      const Completed refused = run({program, last});
      EXPECT_EQ(refused.status, 2);
      EXPECT_THAT(refused.errors, AllOf(HasSubstr(last), HasSubstr("usage: ./" + name)));
      EXPECT_THAT(refused.output, IsEmpty());
    }
  }
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
    if (line.find("root/cimv2:") == std::string::npos || line.find("style = invis") != std::string::npos) continue;
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
  std::map<double, std::string> endpoints;
  const std::regex endpoint(R"re(node .* [\d.]+ ([\d.]+) [\d.]+ [\d.]+ "IPProtocolEndPoint\\n(\w+)" .*)re");
  // A long name is broken into lines.
  for (const std::string& line : linesOf(std::regex_replace(drawn.output, std::regex("\\\\\n"), ""))) {
    nodes += line.starts_with("node ") ? 1 : 0;
    edges += line.starts_with("edge ") && line.find(" invis ") == std::string::npos ? 1 : 0;
    if (std::smatch found; std::regex_match(line, found, endpoint)) endpoints[std::stod(found[1])] = found[2];
  }
  EXPECT_EQ(nodes, 14U);
  EXPECT_EQ(edges, 23U);
  // The ordinate grows upwards.
  EXPECT_THAT(endpoints, ElementsAre(Pair(_, "eth1"), Pair(_, "eth0")));
}

TEST_F(ModelGraphTest, FailsWhereNothingIsFound) {
  const Completed completed = draw("tree", "root/nowhere");
  EXPECT_NE(completed.status, 0);
  EXPECT_THAT(completed.output, IsEmpty());
  EXPECT_EQ(draw("picture").status, 2);
}

}  // namespace
