// SPDX-License-Identifier: Apache-2.0
// The manual pages are clean, and name every option of the programs and every key of the samples.
#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include <map>
#include <set>

#include "Paths.h"
#include "tests/support/client/WbemClient.h"
#include "tests/support/system/Build.h"
#include "tests/support/system/Pattern.h"
#include "tests/support/system/Process.h"
#include "tests/support/system/TemporaryDirectory.h"

namespace {

using namespace Testing;
using testing::IsEmpty;
using testing::IsSupersetOf;
using testing::Not;

using Names = std::set<std::string>;

std::string pathOf(const std::string& page) { return SOURCE_DIR "/docs/man/" + page; }

// The first groups of all matches.
Names matches(const std::string& text, const std::string& pattern) {
  Names found;
  for (const Pattern::Match& match : Pattern(pattern).all(text)) {
    found.insert(match[1]);
  }
  return found;
}

// The options that a page explains, "-t" or "--port".
Names optionsOf(const std::string& page) {
  Names options;
  for (const std::string& item : matches(readFile(pathOf(page)), "^\\.It (Fl .*)$")) {
    for (const std::string& option : matches(item, "(?:Fl |, )(-?[a-z-]+)")) {
      options.insert("-" + option);
    }
  }
  return options;
}

// What a page, or one of its sections, explains as a key.
Names keysOf(const std::string& text) { return matches(text, "^\\.It Ic ([a-z0-9_.-]+)"); }

Names namesOf(const Completed& help, const std::string& pattern) {
  EXPECT_EQ(help.status, 0) << help.errors;
  Names names = matches(help.output, pattern);
  EXPECT_THAT(names, Not(IsEmpty()));
  return names;
}

// A sample's text, or a page's, by the names of its sections.
std::map<std::string, std::string> sectionsOf(const std::string& text, const std::string& heading) {
  std::map<std::string, std::string> sections;
  std::string name;
  const Pattern pattern(heading);
  for (const std::string& line : linesOf(text)) {
    if (const Pattern::Match found = pattern.whole(line); !found.empty()) {
      name = found[1];
    }
    sections[name] += line + '\n';
  }
  return sections;
}

// The keys of a sample: "key = value", mostly behind a semicolon. One for each component stands there as an example.
Names sampleKeysOf(const std::string& text) {
  Names keys;
  for (const std::string& key : matches(text, "^(?:; *)?([a-z][A-Za-z_.-]*) =")) {
    keys.insert(key.starts_with("threshold.") ? "threshold." : key);
  }
  return keys;
}

Names programOptions(const std::string& program) {
  Names options;
  const Completed help = run({built("bin/") + program, "--help"});
  for (const std::string& line : namesOf(help, "^(?:  |    )(-[a-z-]+(?:, ?--[a-z-]+)?)")) {
    options.merge(matches(line, "(-[a-z-]+)"));
  }
  return options;
}

TEST(ManualPagesTest, AreClean) {
  if (run({"sh", "-c", "command -v mandoc"}).status != 0) {
    GTEST_SKIP() << "mandoc is not there";
  }
  for (const char* page : {"agent.ini.5", "cimomd.8", "cimomd.ini.5", "compositeipconfig-register.8", "bmcip.1"}) {
    const Completed checked = run({"mandoc", "-T", "lint", "-W", "warning", pathOf(page)});
    EXPECT_EQ(checked.status, 0);
    EXPECT_THAT(checked.output, IsEmpty()) << page;
  }
}

TEST(ManualPagesTest, ExplainTheOptionsOfTheProgramsAndNoOther) {
  for (const std::string program : {"cimomd", "compositeipconfig-register", "bmcip"}) {
    EXPECT_EQ(optionsOf(program + (program == "bmcip" ? ".1" : ".8")), programOptions(program));
  }
}

TEST(ManualPagesTest, ExplainTheKeysOfCimomdAndNoOther) {
  Names options = programOptions("cimomd");
  for (const char* other : {"-h", "--help", "--version", "--config"}) {
    options.erase(other);
  }
  const Names keys = keysOf(readFile(pathOf("cimomd.ini.5")));
  Names keysAsOptions;
  for (const std::string& key : keys) {
    keysAsOptions.insert("--" + key);
  }
  EXPECT_EQ(keysAsOptions, options);
  EXPECT_EQ(sampleKeysOf(readFile(SOURCE_DIR "/cimom/cimomd.ini.sample")), keys);
}

TEST(ManualPagesTest, ExplainTheKeysOfTheAgent) {
  const auto sample = sectionsOf(readFile(SOURCE_DIR "/agent/agent.ini.sample"), "\\[(.*)\\]");
  auto page = sectionsOf(readFile(pathOf("agent.ini.5")), "\\.Ss \\[(.*)\\]");
  std::size_t count = 0;
  for (const auto& [section, text] : sample) {
    if (!section.empty()) {
      EXPECT_THAT(keysOf(page[section]), IsSupersetOf(sampleKeysOf(text))) << section;
      count += sampleKeysOf(text).size();
    }
  }
  EXPECT_GT(count, 10U);
  EXPECT_EQ(keysOf(page["ipmi"]), matches(readFile(SOURCE_DIR "/docs/ipmi.md"), "^\\| `([a-z0-9_]+)` \\| "));
}

}  // namespace
