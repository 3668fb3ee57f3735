// SPDX-License-Identifier: Apache-2.0
// The tree that `cmake --install` writes: it serves wherever it is moved to, and is taken away without a rest.
#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include <filesystem>

#include "Paths.h"
#include "tests/support/client/CompositeStack.h"
#include "tests/support/system/Build.h"

namespace {

using namespace Testing;
using testing::AllOf;
using testing::ElementsAre;
using testing::EndsWith;
using testing::HasSubstr;
using testing::IsEmpty;
using testing::Not;
using testing::SizeIs;
using testing::StartsWith;

namespace fs = std::filesystem;

// What CMake writes down of an installation from this build directory: kept, since whoever tests may have installed it.
class KeptManifest {
 public:
  KeptManifest() : content_(contentOf(file)) {}
  ~KeptManifest() {
    if (content_.empty()) {
      fs::remove(file);
    } else {
      writeFile(file, content_);
    }
  }
  KeptManifest(const KeptManifest&) = delete;
  KeptManifest& operator=(const KeptManifest&) = delete;

 private:
  inline static const std::string file = built("install_manifest.txt");
  const std::string content_;
};

class InstallationTest : public testing::Test {
 protected:
  void install(const fs::path& prefix, const Environment& environment = {}) {
    const Completed completed = run({"cmake", "--install", buildDirectory(), "--prefix", prefix}, environment);
    ASSERT_EQ(completed.status, 0) << completed.errors;
  }

  // Every file and link below the directory, relative to it.
  static std::vector<std::string> filesBelow(const fs::path& directory) {
    std::vector<std::string> files;
    for (const auto& entry : fs::recursive_directory_iterator(directory)) {
      if (entry.is_symlink() || !entry.is_directory()) {
        files.push_back(entry.path().lexically_relative(directory));
      }
    }
    return files;
  }

  static fs::path onlyFile(const fs::path& directory, const std::string& name) {
    std::vector<std::string> found;
    for (const std::string& file : filesBelow(directory)) {
      if (fs::path(file).filename() == name) {
        found.push_back(file);
      }
    }
    EXPECT_THAT(found, SizeIs(1)) << name;
    return directory / found.at(0);
  }

  // cimomd of the tree, with a configuration that says nothing but how the processor is reached.
  Cimomd serve(const fs::path& tree, const std::string& processor) {
    const auto ini =
        directory_.write("agent.ini", "[system]\nname = managed.example\n[log]\ndestination = off\n" + processor);
    return Cimomd({}, {{"QV_AGENT_INI", ini}}, tree / "sbin/cimomd");
  }

  static Completed uninstall(const Environment& environment = {}) {
    return run({SOURCE_DIR "/tools/uninstall", buildDirectory()}, environment);
  }

  const KeptManifest manifest_;
  const TemporaryDirectory directory_;
};

class MovedInstallationTest : public InstallationTest {
 protected:
  void SetUp() override {
    if (contentOf(built("CMakeCache.txt")).find("CMAKE_SKIP_INSTALL_RPATH:BOOL=ON") != std::string::npos) {
      GTEST_SKIP() << "libraries made for a package stand where the dynamic linker looks, and nowhere else";
    }
  }

  fs::path installAndMove() {
    install(directory_.path() / "installed");
    const fs::path moved = directory_.path() / "elsewhere" / "and deeper";
    fs::create_directories(moved.parent_path());
    fs::rename(directory_.path() / "installed", moved);
    return moved;
  }
};

TEST_F(MovedInstallationTest, ServesWhereItIsMovedTo) {
  const fs::path tree = installAndMove();
  const Cimomd cimomd = serve(tree, simulatedProcessor(directory_.path() / "processor.json"));
  const Completed completed = run({"wbemcli", "ei", "-nl", cimomd.url("YRNx_MgmtHwIPProtocolEndPoint", "root/cimv2")});
  EXPECT_EQ(completed.status, 0) << completed.errors;
  EXPECT_THAT(completed.output, HasSubstr("IPv4Address=\"192.0.2.10\""));
}

TEST_F(MovedInstallationTest, FindsItsLibrariesWithinTheMovedTree) {
  const fs::path tree = installAndMove();
  for (const char* library : {"libcompositeipconfigprovider.so.1", "libunderlyingipconfigprovider.so.1"}) {
    const std::string needed = run({"ldd", onlyFile(tree, library)}).output;
    EXPECT_THAT(needed, AllOf(HasSubstr(tree.string()), Not(HasSubstr("not found")), Not(HasSubstr(buildDirectory())),
                              Not(HasSubstr("/usr/local"))))
        << library;
  }
}

TEST_F(MovedInstallationTest, LoadsABackEndOfTheMovedTree) {
  const fs::path tree = installAndMove();
  if (!fs::exists(built("lib/libqvbmc-ipmi.so"))) {
    GTEST_SKIP() << "this build has no IPMI back end";
  }
  const auto askFor = [&](const std::string& why) {
    const Cimomd cimomd = serve(tree, "[processor]\nbackend = ipmi\n[ipmi]\nconnection = nowhere\n");
    EXPECT_THAT(run({"wbemcli", "ei", cimomd.url("YRNx_MgmtHwComputerSystem", "root/cimv2")}).errors, HasSubstr(why));
  };
  // It is the back end that looks at its keys.
  askFor("connection = nowhere: must be one of inband, lan");
  fs::remove(onlyFile(tree, "libqvbmc-ipmi.so"));
  askFor("the back end ipmi cannot be loaded");
}

TEST_F(InstallationTest, HoldsTheSamplesAndTheLicences) {
  install(directory_.path());
  for (const char* name : {"agent.ini.sample", "cimomd.ini.sample", "LICENSE"}) {
    EXPECT_THAT(onlyFile(directory_.path(), name).parent_path().string(), EndsWith("/share/doc/compositeipconfig"));
  }
  // As it is, the sample changes nothing.
  for (const std::string& line : linesOf(contentOf(onlyFile(directory_.path(), "cimomd.ini.sample")))) {
    EXPECT_TRUE(line.empty() || line.starts_with(";")) << line;
  }
}

TEST_F(InstallationTest, IsTakenAwayWithoutARest) {
  const fs::path prefix = directory_.path() / "a prefix";
  install(prefix);
  directory_.write("a prefix/share/compositeipconfig/site.reg", "# of the administrator\n");
  ASSERT_EQ(run({"cmake", "--build", buildDirectory(), "--target", "uninstall"}).status, 0);
  EXPECT_THAT(filesBelow(prefix), ElementsAre("share/compositeipconfig/site.reg"));
  EXPECT_FALSE(fs::exists(prefix / "share/compositeipconfig/cimomd"));
  EXPECT_FALSE(fs::exists(prefix / "share/doc/compositeipconfig"));
  EXPECT_TRUE(fs::exists(prefix / "sbin"));

  const Completed again = uninstall();
  EXPECT_EQ(again.status, 1);
  EXPECT_THAT(again.errors,
              AllOf(StartsWith("uninstall: " + buildDirectory()), HasSubstr("nothing was installed"), EndsWith("\n")));
}

TEST_F(InstallationTest, IsTakenAwayFromBelowDestdir) {
  const Environment staged{{"DESTDIR", directory_.path() / "stage"}};
  install("/opt/product", staged);
  const Completed completed = uninstall(staged);
  EXPECT_EQ(completed.status, 0) << completed.errors;
  EXPECT_THAT(completed.output, StartsWith("Removed "));
  EXPECT_THAT(filesBelow(directory_.path() / "stage"), IsEmpty());
}

}  // namespace
