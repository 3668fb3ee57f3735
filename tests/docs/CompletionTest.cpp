// SPDX-License-Identifier: Apache-2.0
// What bash offers after the names of the installed programs.
#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include "Paths.h"
#include "tests/support/client/WbemClient.h"
#include "tests/support/system/Build.h"
#include "tests/support/system/Process.h"
#include "tests/support/system/TemporaryDirectory.h"

namespace {

using namespace Testing;
using testing::AllOf;
using testing::Contains;
using testing::ElementsAre;
using testing::IsEmpty;
using testing::UnorderedElementsAre;

// Directory, completion, program, words.
constexpr const char* complete = R"(
cd "$1"
source "$2"
shift 2
function=$(complete -p "${1##*/}" | sed 's/.* -F \([^ ]*\) .*/\1/')
COMPREPLY=()
$function "$1" "${@: -1}" "${@: -2:1}"
printf '%s\n' "${COMPREPLY[@]}"
)";

// What is offered for the last of the words.
std::vector<std::string> offered(const std::string& program, const std::vector<std::string>& words,
                                 const std::string& directory = SOURCE_DIR) {
  std::vector<std::string> command = {
      "bash", "-euc", complete, "bash", directory, SOURCE_DIR "/docs/completion/" + program, built("bin/") + program};
  command.insert(command.end(), words.begin(), words.end());
  const Completed completed = run(command);
  EXPECT_EQ(completed.status, 0) << completed.errors;
  EXPECT_THAT(completed.errors, IsEmpty());
  return linesOf(completed.output);
}

TEST(CompletionTest, OffersTheOptionsOfCimomd) {
  EXPECT_THAT(offered("cimomd", {""}), AllOf(Contains("-h"), Contains("--help"), Contains("--version"),
                                             Contains("--config"), Contains("--password-file")));
  EXPECT_THAT(offered("cimomd", {"--tls"}), UnorderedElementsAre("--tls-certificate", "--tls-key"));
}

TEST(CompletionTest, OffersFilesAndDirectoriesToCimomd) {
  const TemporaryDirectory directory;
  directory.write("part one.ini", "");
  directory.write("parts/file", "");
  EXPECT_THAT(offered("cimomd", {"--config", "pa"}, directory.path()), UnorderedElementsAre("part one.ini", "parts"));
  EXPECT_THAT(offered("cimomd", {"--schema", "pa"}, directory.path()), UnorderedElementsAre("part one.ini", "parts"));
  EXPECT_THAT(offered("cimomd", {"--provider-dir", "pa"}, directory.path()), ElementsAre("parts"));
  EXPECT_THAT(offered("cimomd", {"--port", ""}, directory.path()), IsEmpty());
}

TEST(CompletionTest, OffersTheCommandsAndOptionsOfBmcip) {
  const TemporaryDirectory directory;
  directory.write("hosts.txt", "");
  EXPECT_THAT(offered("bmcip", {""}), UnorderedElementsAre("show", "set", "watch", "model"));
  EXPECT_THAT(offered("bmcip", {"show", "--host"}), ElementsAre("--hosts"));
  EXPECT_THAT(offered("bmcip", {"-"}), AllOf(Contains("-h"), Contains("--json"), Contains("--dry-run")));
  EXPECT_THAT(offered("bmcip", {"show", "--hosts", "ho"}, directory.path()), ElementsAre("hosts.txt"));
  EXPECT_THAT(offered("bmcip", {"--timeout", ""}), IsEmpty());
}

TEST(CompletionTest, OffersTheOptionsAndObjectManagersOfTheRegistration) {
  const std::string program = "compositeipconfig-register";
  EXPECT_THAT(offered(program, {""}), UnorderedElementsAre("-t", "-n", "-d", "-h", "--help"));
  EXPECT_THAT(offered(program, {"-t", ""}), UnorderedElementsAre("sfcb", "pegasus", "cimomd"));
  EXPECT_THAT(offered(program, {"-t", "p"}), ElementsAre("pegasus"));
  EXPECT_THAT(offered(program, {"-n", ""}), ElementsAre("root/cimv2"));
}

}  // namespace
