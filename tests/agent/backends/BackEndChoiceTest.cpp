// Which back end agent.ini chooses, and what is said if it cannot be had. A process has one back end, so each case
// runs in a child, on a copy of the instrumentation library beside which the case puts what it needs.
#include <dlfcn.h>
#include <gtest/gtest.h>

#include <cstdio>
#include <cstdlib>
#include <functional>
#include <memory>

#include "agent/processor/BackEnd.h"
#include "tests/support/system/TemporaryDirectory.h"

namespace {

using namespace QV;
using namespace Testing;
using SharedBackEnd = std::shared_ptr<BackEnd>();

class BackEndChoiceTest : public testing::Test {
 protected:
  BackEndChoiceTest() {
    std::filesystem::copy_file(INSTRUMENTATION, library_);
    ::setenv("QV_AGENT_INI", ini_.c_str(), 1);
  }
  ~BackEndChoiceTest() override { ::unsetenv("QV_AGENT_INI"); }

  void choose(const std::string& text) const { writeFile(ini_, text + "[log]\ndestination = off\n"); }

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

TEST_F(BackEndChoiceTest, IsTheSimulatedProcessorByDefault) {
  choose("[simulated]\nstate = " + (directory_ / "state.json") + '\n');
  expect(describe, "^BMC: Simulated management processor$");
}

TEST_F(BackEndChoiceTest, GivesTheProcessorItsConfiguredNames) {
  choose("[simulated]\nstate = " + (directory_ / "state.json") + "\n[processor]\nname = a\ndescription = b\n");
  expect(describe, "^a: b$");
}

TEST_F(BackEndChoiceTest, LoadsTheIpmiBackEndFromBesideTheLibraryAndPassesItItsSettings) {
  std::filesystem::copy_file(STAND_IN_BACK_END, ipmi_);
  choose("[processor]\nbackend = ipmi\n[ipmi]\nname = loaded\n");
  expect(describe, "^loaded: a stand-in$");
}

TEST_F(BackEndChoiceTest, PassesOnWhyTheIpmiBackEndRefusesItsSettings) {
  std::filesystem::copy_file(STAND_IN_BACK_END, ipmi_);
  choose("[processor]\nbackend = ipmi\n");
  expect(describe, "^.ipmi. name is missing$");
}

TEST_F(BackEndChoiceTest, TellsWhyTheIpmiBackEndCannotBeLoaded) {
  writeFile(ipmi_, "no library");
  choose("[processor]\nbackend = ipmi\n");
  expect(describe, "^the back end ipmi cannot be loaded: .*libqvbmc-ipmi.so: ");
}

TEST_F(BackEndChoiceTest, TellsThatALibraryIsNoBackEnd) {
  std::filesystem::copy_file(INSTRUMENTATION, ipmi_);
  choose("[processor]\nbackend = ipmi\n");
  expect(describe, "^the back end ipmi cannot be used: .*qvCreateBackEnd");
}

TEST_F(BackEndChoiceTest, TellsWhatIsWrongWithAgentIniAndTriesAgainOnTheNextUse) {
  choose("[processor]\nbackend = magic\n");
  expect(
      [this](SharedBackEnd* sharedBackEnd) {
        const std::string first = describe(sharedBackEnd);
        choose("[simulated]\nstate = " + (directory_ / "state.json") + '\n');
        return first + "; then " + describe(sharedBackEnd);
      },
      "^the back end magic cannot be loaded: libqvbmc-magic.so: .*; install libqvbmc-magic.so, or correct backend in "
      ".processor. of agent.ini; then BMC: Simulated");
}

TEST_F(BackEndChoiceTest, TellsWhatIsWrongWithTheSettingsOfTheSimulatedProcessor) {
  choose("[simulated]\nstate = here\n");
  expect(describe, "^agent.ini, .simulated.: state = here: must be an absolute path$");
  choose("[simulated]\nstatus = /here\n");
  expect(describe, "^agent.ini, .simulated.: status = /here: there is no such key$");
}

TEST_F(BackEndChoiceTest, IsMadeOnceAndShared) {
  choose("[simulated]\nstate = " + (directory_ / "state.json") + '\n');
  expect(
      [](SharedBackEnd* sharedBackEnd) {
        return std::string(sharedBackEnd() == sharedBackEnd() ? "the same" : "another");
      },
      "^the same$");
}

}  // namespace
