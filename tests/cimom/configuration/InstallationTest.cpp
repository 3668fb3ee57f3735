#include <gtest/gtest.h>

#include "cimom/configuration/Installation.h"

namespace {

TEST(InstallationTest, StandsBesideTheProgram) {
  const auto program = std::filesystem::canonical("/proc/self/exe");
  const Cimom::Installation installation = Cimom::thisInstallation();
  for (const auto& path : {installation.schema, installation.registration, installation.providerDirectory}) {
    EXPECT_TRUE(path.string().starts_with(program.parent_path().parent_path().string())) << path;
  }
  EXPECT_EQ(installation.configurationFile.filename(), "cimomd.ini");
  EXPECT_TRUE(installation.configurationFile.is_absolute());
}

}  // namespace
