// SPDX-License-Identifier: Apache-2.0
// Which back end agent.ini chooses, and what is said if it cannot be had. A process has one back end, so each case
// runs in a child, on a copy of the instrumentation library beside which the case puts what it needs.
#include <dlfcn.h>
#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include <cstdio>
#include <cstdlib>
#include <functional>
#include <memory>

#include "agent/processor/BackEnd.h"
#include "tests/support/system/Build.h"
#include "tests/support/system/TemporaryDirectory.h"

namespace {

using namespace QV;
using namespace Testing;
using SharedBackEnd = std::shared_ptr<BackEnd>();

class BackEndChoiceTest : public testing::Test {
 protected:
  BackEndChoiceTest() {
    std::filesystem::copy_file(built("lib/libqvinstrumentation.so"), library_);
    ::setenv("QV_AGENT_INI", ini_.c_str(), 1);
  }
  ~BackEndChoiceTest() override { ::unsetenv("QV_AGENT_INI"); }

  void choose(const std::string& text) const { writeFile(ini_, text + "[log]\ndestination = off\n"); }

  void chooseSimulated(const std::string& keys = {}) const {
    choose("[processor]\nbackend = simulated\n" + keys + "[simulated]\nstate = " + (directory_ / "state.json") + '\n');
  }

  // In the child: the processor's name and description, else what was thrown.
  static std::string describe(SharedBackEnd* sharedBackEnd) {
    try {
      const ManagementProcessor processor = sharedBackEnd()->read();
      return processor.name + ": " + processor.description;
    } catch (const std::exception& error) {
      return error.what();
    }
  }

  // Runs the statements in a child and expects them to end with this on standard error.
  void expect(const std::function<std::string(SharedBackEnd*)>& statements, const std::string& pattern) const {
    const auto child = [&] {
      void* handle = ::dlopen(library_.c_str(), RTLD_NOW | RTLD_LOCAL);
      auto* function = handle ? reinterpret_cast<SharedBackEnd*>(::dlsym(handle, "_ZN2QV13sharedBackEndEv")) : nullptr;
      const std::string text = function ? statements(function) : ::dlerror();
      std::fputs(text.c_str(), stderr);
      std::exit(0);
    };
    EXPECT_EXIT(child(), testing::ExitedWithCode(0), pattern);
  }

  const TemporaryDirectory directory_;
  const std::string ini_ = directory_ / "agent.ini";
  const std::string library_ = directory_ / "libqvinstrumentation.so.1";
  const std::string ipmi_ = directory_ / "libqvbmc-ipmi.so";
};

TEST_F(BackEndChoiceTest, IsTheSimulatedProcessorWhereAgentIniSaysSo) {
  chooseSimulated();
  expect(describe, "^BMC: Simulated management processor$");
}

TEST_F(BackEndChoiceTest, IsNeverMadeForTheAdministrator) {
  // Neither without the key, whatever else there is, nor without the file
  choose("[simulated]\nstate = " + (directory_ / "state.json") + '\n');
  expect(
      describe,
      "^.*/agent.ini: .processor. has no key 'backend', so that there is no management processor; set backend = ipmi "
      "for a BMC, or backend = simulated for made-up values$");
  std::filesystem::remove(ini_);
  expect(describe, "^.*/agent.ini: cannot be opened: No such file or directory; create it and choose [^\n]*$");
  EXPECT_FALSE(std::filesystem::exists(directory_ / "state.json"));
}

TEST_F(BackEndChoiceTest, IsLoggedOnceWhereItIsTheSimulatedProcessor) {
  const std::string log = directory_ / "agent.log";
  writeFile(ini_, "[processor]\nbackend = simulated\n[simulated]\nstate = " + (directory_ / "state.json") +
                      "\n[log]\ndestination = file\nfile = " + log + '\n');
  expect(
      [](SharedBackEnd* sharedBackEnd) {
        sharedBackEnd()->read();
        return describe(sharedBackEnd);
      },
      "^BMC: ");
  EXPECT_THAT(readFile(log),
              testing::MatchesRegex("[^\n]* 6000 Tarnwick.SimulatedProcessor [^\n]*: the management processor is "
                                    "simulated \\(.*/agent.ini: backend = simulated\\): its values are made up, and "
                                    "changes reach no hardware but .*/state.json\n"));
}

TEST_F(BackEndChoiceTest, GivesTheProcessorItsConfiguredNames) {
  std::filesystem::copy_file(built("lib/libstand_in_back_end.so"), ipmi_);
  choose("[processor]\nbackend = ipmi\nname = a\ndescription = b\n[ipmi]\nname = loaded\n");
  expect(describe, "^a: b$");
}

TEST_F(BackEndChoiceTest, SaysOfASimulatedProcessorWhatItIsUnderAnyDescription) {
  chooseSimulated("name = a\ndescription = b\n");
  expect(describe, "^a: b .simulated.$");
  chooseSimulated("description = SIMULATED on rack 7\n");
  expect(describe, "^BMC: SIMULATED on rack 7$");
}

TEST_F(BackEndChoiceTest, LoadsTheIpmiBackEndFromBesideTheLibraryAndPassesItItsSettings) {
  std::filesystem::copy_file(built("lib/libstand_in_back_end.so"), ipmi_);
  choose("[processor]\nbackend = ipmi\n[ipmi]\nname = loaded\n");
  expect(describe, "^loaded: a stand-in$");
}

TEST_F(BackEndChoiceTest, PassesOnWhyTheIpmiBackEndRefusesItsSettings) {
  std::filesystem::copy_file(built("lib/libstand_in_back_end.so"), ipmi_);
  choose("[processor]\nbackend = ipmi\n");
  expect(describe, "^/.*/agent.ini: .ipmi. name = : the key is missing and has no default$");
  choose("[processor]\nbackend = ipmi\n[ipmi]\nname = loaded\ncolour = red\n");
  expect(describe, "^/.*/agent.ini:5: .ipmi. colour = red: unknown$");
}

TEST_F(BackEndChoiceTest, TellsWhyTheIpmiBackEndCannotBeLoaded) {
  writeFile(ipmi_, "no library");
  choose("[processor]\nbackend = ipmi\n");
  expect(describe, "^the back end ipmi cannot be loaded: .*libqvbmc-ipmi.so: ");
}

TEST_F(BackEndChoiceTest, TellsThatALibraryIsNoBackEnd) {
  std::filesystem::copy_file(built("lib/libqvinstrumentation.so"), ipmi_);
  choose("[processor]\nbackend = ipmi\n");
  expect(describe, "^the back end ipmi cannot be used: .*qvCreateBackEnd");
}

TEST_F(BackEndChoiceTest, TellsWhatIsWrongWithAgentIniAndTriesAgainOnTheNextUse) {
  choose("[processor]\nbackend = magic\n");
  expect(
      [this](SharedBackEnd* sharedBackEnd) {
        const std::string first = describe(sharedBackEnd);
        chooseSimulated();
        return first + "; then " + describe(sharedBackEnd);
      },
      "^the back end magic cannot be loaded: libqvbmc-magic.so: .*; install libqvbmc-magic.so, or correct backend in "
      ".processor. of agent.ini; then BMC: Simulated");
}

TEST_F(BackEndChoiceTest, TellsWhatIsWrongWithTheSettingsOfTheSimulatedProcessor) {
  choose("[processor]\nbackend = simulated\n[simulated]\nstate = here\n");
  expect(describe, "^/.*/agent.ini:4: .simulated. state = here: must be an absolute path$");
  choose("[processor]\nbackend = simulated\n[simulated]\nstatus = /here\n");
  expect(describe, "^/.*/agent.ini:4: .simulated. status = /here: there is no such key: must be one of state$");
}

TEST_F(BackEndChoiceTest, TellsThatTheStateCannotBeWrittenBeforeItIsAskedForAnything) {
  choose("[processor]\nbackend = simulated\n[simulated]\nstate = /proc/none/state.json\n");
  expect(
      [](SharedBackEnd* sharedBackEnd) {
        try {
          sharedBackEnd();
          return std::string("opened");
        } catch (const std::exception& error) {
          return std::string(error.what());
        }
      },
      "^/proc/none: cannot be created: [^;]*; let the object manager's user, [0-9]+, write there, or name another file "
      "with state in .simulated. of agent.ini$");
}

TEST_F(BackEndChoiceTest, IsMadeOnceAndShared) {
  chooseSimulated();
  expect(
      [](SharedBackEnd* sharedBackEnd) {
        return std::string(sharedBackEnd() == sharedBackEnd() ? "the same" : "another");
      },
      "^the same$");
}

}  // namespace
