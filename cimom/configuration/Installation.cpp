#include "cimom/configuration/Installation.h"

namespace Cimom {

Installation thisInstallation() {
  const std::filesystem::path directory = std::filesystem::read_symlink("/proc/self/exe").parent_path();
  const auto installed = [&](const char* fromProgram) { return (directory / fromProgram).lexically_normal(); };
  return {CONFIGURATION_DIR "/cimomd.ini", installed(CLASSES_FROM_PROGRAM), installed(CLASSES_FROM_PROGRAM),
          installed(PROVIDERS_FROM_PROGRAM)};
}

}  // namespace Cimom
