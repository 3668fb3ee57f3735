// tools/install-packages with Debian's own package manager, on a root directory of its own.
#include <fcntl.h>
#include <gmock/gmock.h>
#include <gtest/gtest.h>
#include <unistd.h>

#include <filesystem>
#include <memory>

#include "Paths.h"
#include "tests/support/system/Poll.h"
#include "tests/support/system/Process.h"
#include "tests/support/system/TemporaryDirectory.h"

namespace {

using namespace Testing;
using testing::HasSubstr;
using testing::IsEmpty;
using testing::StartsWith;

namespace fs = std::filesystem;

// A lock as package managers take them.
class HeldLock {
 public:
  explicit HeldLock(const fs::path& file) : descriptor_(open(file.c_str(), O_CREAT | O_RDWR | O_CLOEXEC, 0640)) {
    struct flock whole = {};
    whole.l_type = F_WRLCK;
    whole.l_whence = SEEK_SET;
    EXPECT_EQ(fcntl(descriptor_, F_SETLK, &whole), 0) << file;
  }
  ~HeldLock() { close(descriptor_); }
  HeldLock(const HeldLock&) = delete;
  HeldLock& operator=(const HeldLock&) = delete;

 private:
  const int descriptor_;
};

class InstallPackagesTest : public testing::Test {
 protected:
  InstallPackagesTest() {
    fs::create_directory(root_.path() / "tools");
    fs::copy_file(SOURCE_DIR "/tools/install-packages", script());
    for (const char* part :
         {"var/lib/apt/lists/partial", "var/log/apt", "var/lib/dpkg/info", "var/lib/dpkg/updates",
          "var/cache/apt/archives/partial", "etc/apt/apt.conf.d", "etc/apt/preferences.d", "etc/apt/sources.list.d"}) {
      fs::create_directories(root_.path() / part);
    }
    root_.write("tools/packages.txt", "[one]\nexample\n\n[both]\nexample\nexample:i386\n");
    root_.write("apt.conf", "Dir \"" + root() + "\";\nDir::State::status \"" + root() + "/var/lib/dpkg/status\";\n" +
                                "APT::Sandbox::User \"root\";\nDPkg::Options { \"--root=" + root() + "\"; };\n");
    installed({});
  }

  // What dpkg knows: the package example, for these architectures.
  void installed(const std::vector<std::string>& architectures) const {
    std::string status;
    for (const std::string& architecture : architectures) {
      status += "Package: example\nStatus: install ok installed\nArchitecture: " + architecture +
                (architecture == "all" ? "" : "\nMulti-Arch: same") +
                "\nVersion: 1\nMaintainer: Nobody <nobody@example.com>\nDescription: example\n\n";
    }
    root_.write("var/lib/dpkg/status", status);
  }

  // A source of packages that has the package example.
  void publish() const {
    root_.write("example/DEBIAN/control",
                "Package: example\nVersion: 1\nArchitecture: all\nMaintainer: Nobody <nobody@example.com>\n"
                "Description: example\n");
    const Completed built = run({"sh", "-euc",
                                 "mkdir repository; dpkg-deb --build example repository/example.deb; cd repository\n"
                                 "{ dpkg-deb -f example.deb; echo Filename: ./example.deb\n"
                                 "echo Size: $(stat -c %s example.deb)\n"
                                 "echo SHA256: $(sha256sum < example.deb | cut -d' ' -f1); } > Packages\n"});
    ASSERT_EQ(built.status, 0) << built.errors;
    root_.write("etc/apt/sources.list", "deb [trusted=yes] file:" + root() + "/repository ./\n");
  }

  Completed install(const std::string& group) const { return run({script(), group}); }

  Environment environment() const {
    return {{"APT_CONFIG", root_ / "apt.conf"}, {"DPKG_ADMINDIR", root_ / "var/lib/dpkg"}, {"TMPDIR", root()}};
  }

  // All commands of this test work on its root directory.
  Completed run(std::vector<std::string> command) const {
    command.insert(command.begin(), {"env", "-C", root()});
    return Testing::run(command, environment());
  }

  std::string root() const { return root_.path().string(); }
  std::string script() const { return root_ / "tools/install-packages"; }
  static std::string native() {
    const std::string said = Testing::run({"dpkg", "--print-architecture"}).output;
    return said.substr(0, said.find('\n'));
  }

  TemporaryDirectory root_;
};

void expectNothingToDo(const Completed& completed) {
  EXPECT_EQ(completed.status, 0) << completed.errors;
  EXPECT_THAT(completed.output, IsEmpty());
}

TEST_F(InstallPackagesTest, HasNothingToDoWhereThePackageIsThereForOneArchitecture) {
  installed({native()});
  expectNothingToDo(install("one"));
  installed({"all"});
  expectNothingToDo(install("one"));
}

TEST_F(InstallPackagesTest, HasNothingToDoWhereThePackageIsThereForTwoArchitectures) {
  if (native() == "i386") {
    GTEST_SKIP() << "i386 is this machine's own";
  }
  installed({native(), "i386"});
  expectNothingToDo(install("one"));
  expectNothingToDo(install("both"));
}

TEST_F(InstallPackagesTest, WantsThePackageOfTheRightArchitecture) {
  if (native() == "i386" || geteuid() != 0) {
    GTEST_SKIP() << "i386 is this machine's own, or this is not root";
  }
  installed({"i386"});
  EXPECT_THAT(install("one").output, StartsWith("Installing: example\n"));
  installed({native()});
  EXPECT_THAT(install("both").output, StartsWith("Installing: example:i386\n"));
}

TEST_F(InstallPackagesTest, RefusesAGroupThatIsNotThere) {
  const Completed completed = install("two");
  EXPECT_EQ(completed.status, 2);
  EXPECT_THAT(completed.errors, HasSubstr("no group \"two\""));
}

TEST_F(InstallPackagesTest, SaysWhichPackagesCannotBeInstalled) {
  if (geteuid() != 0) {
    GTEST_SKIP() << "this is not root";
  }
  const Completed completed = install("one");
  EXPECT_EQ(completed.status, 1);
  EXPECT_THAT(completed.errors, HasSubstr("Unable to locate package example"));
  EXPECT_THAT(completed.errors, HasSubstr("install-packages: apt-get could not install example\n"));
}

TEST_F(InstallPackagesTest, WaitsForThePackageManagerAndSaysForWhat) {
  if (geteuid() != 0) {
    GTEST_SKIP() << "this is not root";
  }
  publish();
  const std::string lists = root_ / "var/lib/apt/lists/lock";
  const std::string database = root_ / "var/lib/dpkg/lock-frontend";
  auto listsLock = std::make_unique<HeldLock>(lists);
  auto databaseLock = std::make_unique<HeldLock>(database);
  Process process({"env", "-C", root(), script(), "one"}, environment());

  const auto waitsFor = [&](const std::string& file) {
    const std::string line = "Waiting for the package manager: " + file + " is held by process ";
    return poll([&] { return process.output().find(line) != std::string::npos; });
  };
  EXPECT_TRUE(waitsFor(lists)) << process.output() << process.errors();
  listsLock.reset();
  EXPECT_TRUE(waitsFor(database)) << process.output() << process.errors();
  databaseLock.reset();

  EXPECT_EQ(process.wait(), 0) << process.errors();
  EXPECT_THAT(readFile(root_ / "var/lib/dpkg/status"), HasSubstr("Package: example\nStatus: install ok installed\n"));
  expectNothingToDo(install("one"));
}

}  // namespace
