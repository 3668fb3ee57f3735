// SPDX-License-Identifier: Apache-2.0
// What the first request is answered where a step of the installation was forgotten or something is not as it must be:
// the document explains every message that comes up here.
#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include <filesystem>
#include <sstream>
#include <stdexcept>

#include "tests/hosts/HostTest.h"
#include "tests/support/system/Pattern.h"
#include "tests/support/system/TemporaryDirectory.h"

namespace {

using namespace Testing;
using testing::HasSubstr;

using Edit = ObjectManager::Edit;

// The commands without the lines that hold one of the texts.
Edit without(const std::vector<std::string>& texts) {
  return [texts](const std::string& commands) {
    std::istringstream lines(commands);
    std::string left;
    for (std::string line; std::getline(lines, line);) {
      bool forgotten = false;
      for (const std::string& text : texts) {
        forgotten = forgotten || line.find(text) != std::string::npos;
      }
      if (!forgotten) {
        left += line + '\n';
      }
    }
    return left.empty() ? ":\n" : left;
  };
}

// The commands with another text in the place of one.
Edit with(const std::string& part, const std::string& by) {
  return [part, by](std::string commands) {
    for (std::size_t at = 0; (at = commands.find(part, at)) != std::string::npos; at += by.size()) {
      commands.replace(at, part.size(), by);
    }
    return commands;
  };
}

// The commands that compile the classes of a set without those that register their providers.
Edit withoutRegistration(const std::string& set) {
  return [set](const std::string& commands) {
    return with(" " + set + ".peg.mof", "")(with("-r " + set + ".reg ", "")(commands));
  };
}

class HostMessagesTest : public HostTest {
 protected:
  void SetUp() override { removeWhatIsThere(); }

  static void TearDownTestSuite() {
    removeWhatIsThere();
    host().install();
    serve(ObjectManager::simulatedProcessor());
  }

  // Of what is half installed only a part can be removed.
  static void removeWhatIsThere() {
    host().remove([](const std::string& commands) { return "set +e\n" + commands + "true\n"; });
  }

  static Completed firstRequest(const std::string& className = "YRNx_MgmtHwIPProtocolEndPoint") {
    return host().wbemcli("ein", className);
  }

  static void expectExplained(const Completed& answer, const std::string& part) {
    EXPECT_NE(answer.status, 0) << answer.output;
    EXPECT_TRUE(host().guide().explains(answer.errors)) << answer.errors;
    EXPECT_THAT(answer.errors + host().diagnostics(), HasSubstr(part));
  }

  // That nothing is answered and nothing said.
  static void expectNothing(const Completed& answer) {
    EXPECT_EQ(answer.status, 0) << answer.errors;
    EXPECT_EQ(answer.output + answer.errors, "");
  }

  // Installs everything, and starts the object manager on the given sections of agent.ini.
  static void installOn(const std::string& processor, const Edit& edit = {}) {
    host().install(edit);
    host().stop();
    host().configureAgent(processor);
    host().start(edit);
  }

  // The commands with the program started by another.
  static Edit startedBy(const std::string& starter) {
    const Pattern start("(^|\n)(" + host().program() + "\\b)");
    return [starter, start](const std::string& commands) { return start.replaced(commands, "$1" + starter + " $2"); };
  }

  static std::string ipmi(const std::string& keys) { return "[processor]\nbackend = ipmi\n[ipmi]\n" + keys; }
};

TEST_F(HostMessagesTest, OfMissingUnderlyingClassesAreExplained) {
  host().install(without({"yrnse"}));
  expectExplained(firstRequest(), "(3) CIM_ERR_INVALID_NAMESPACE");
}

TEST_F(HostMessagesTest, OfMissingCompositeClassesAreExplained) {
  host().install(with(" CompositeIPConfig.mof", ""));
  expectExplained(firstRequest(), "(5) CIM_ERR_INVALID_CLASS");
}

TEST_F(HostMessagesTest, OfAMissingProviderDirectoryAreExplained) {
  host().install(without({"/usr/local/lib/cmpi"}));
  expectExplained(firstRequest(), "IPProtocolendptProvider");
}

TEST_F(HostMessagesTest, OfTheAgentsMissingLibrariesAreExplained) {
  const std::string install = "cmake --install build/default\n";
  host().install(with(install, install + "rm /usr/local/lib/libqvhelper.so.1\n"));
  expectExplained(firstRequest(), "libqvhelper.so.1: cannot open shared object file");
}

TEST_F(HostMessagesTest, AreNoneWhereARegistrationIsMissing) {
  host().install(withoutRegistration("CompositeIPConfig"));
  expectNothing(firstRequest());
}

TEST_F(HostMessagesTest, AreNoneWhereTheUnderlyingRegistrationIsMissing) {
  host().install(withoutRegistration("UnderlyingIPConfig"));
  expectNothing(firstRequest());
}

TEST_F(HostMessagesTest, OfAnObjectManagerThatDoesNotRunAreExplained) {
  host().install();
  host().stop();
  expectExplained(firstRequest(), "Couldn't connect to server");
  host().start();
}

TEST_F(HostMessagesTest, OfTheMissingSchemaAreExplained) {
  // sfcb takes what it needs of its own schema into every namespace; the compiler of OpenPegasus refuses.
  std::string refusal;
  try {
    host().install(without({"CIM_Subset.mof"}));
  } catch (const std::runtime_error& error) {
    refusal = error.what();
  }
  if (refusal.empty()) {
    EXPECT_NE(firstRequest().output, "");
  } else {
    EXPECT_TRUE(host().guide().explains(refusal)) << refusal;
  }
}

TEST_F(HostMessagesTest, OfAStateThatCannotBeWrittenAreExplained) {
  std::filesystem::create_directories("/var/lib/compositeipconfig");
  std::filesystem::permissions("/var/lib/compositeipconfig", std::filesystem::perms::owner_read);
  // Even root is held by permissions without these two capabilities.
  installOn("[processor]\nbackend = simulated\n",
            startedBy("setpriv --bounding-set=-dac_override,-dac_read_search --"));
  expectExplained(firstRequest(), "Permission denied");
  std::filesystem::remove_all("/var/lib/compositeipconfig");
}

TEST_F(HostMessagesTest, OfAMistakeInAgentIniAreExplained) {
  installOn("[processor]\nbakcend = simulated\n");
  expectExplained(firstRequest(), "agent.ini:11: ");
}

TEST_F(HostMessagesTest, OfAMissingAgentIniAreExplained) {
  installOn("[processor]\nbackend = simulated\n");
  std::filesystem::remove(CONFIGURATION_DIR "/agent.ini");
  host().restart();
  expectExplained(firstRequest(), "cannot be opened: No such file or directory; create it");
}

TEST_F(HostMessagesTest, OfAProcessorThatIsNotChosenAreExplained) {
  installOn("");
  expectExplained(firstRequest(), "[processor] has no key 'backend'");
}

TEST_F(HostMessagesTest, OfAnUnknownBackEndAreExplained) {
  installOn("[processor]\nbackend = simulatd\n");
  expectExplained(firstRequest(), "the back end simulatd cannot be loaded");
}

TEST_F(HostMessagesTest, OfABmcThatDoesNotAnswerAreExplained) {
  TemporaryDirectory directory;
  const auto password = directory.write("password", "test\n");
  std::filesystem::permissions(password, std::filesystem::perms::owner_read);
  installOn(ipmi("connection = lan\nhost = 127.0.0.1\nport = 9\nuser = admin\noperation_timeout = 1\npassword_file = " +
                 password.string() + '\n'));
  expectExplained(firstRequest(), "127.0.0.1");
}

TEST_F(HostMessagesTest, OfAMachineWithoutABmcAreExplained) {
  installOn(ipmi("connection = inband\ndevice = /dev/ipmi-none\n"));
  expectExplained(firstRequest(), "/dev/ipmi-none");
}

TEST_F(HostMessagesTest, OfAMissingBackEndAreExplained) {
  installOn(ipmi("connection = inband\n"));
  std::filesystem::remove(INSTALL_PREFIX "/lib/compositeipconfig/libqvbmc-ipmi.so");
  host().restart();
  expectExplained(firstRequest(), "libqvbmc-ipmi.so");
}

}  // namespace
