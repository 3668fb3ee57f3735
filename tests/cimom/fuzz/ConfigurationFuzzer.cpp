// SPDX-License-Identifier: Apache-2.0
// Feeds the configuration file any bytes: it is read, or refused with a UsageError that names the file, and nothing
// else.
#include <sys/mman.h>
#include <unistd.h>

#include <cstddef>
#include <cstdint>
#include <cstdlib>
#include <string>
#include <string_view>

#include "cimom/configuration/Configuration.h"

extern "C" int LLVMFuzzerTestOneInput(const std::uint8_t* data, std::size_t size) {
  static const int file = memfd_create("cimomd.ini", MFD_CLOEXEC);
  static const std::string name = "/proc/self/fd/" + std::to_string(file);
  if (ftruncate(file, 0) != 0 || pwrite(file, data, size, 0) != static_cast<ssize_t>(size)) {
    std::abort();
  }
  static const Cimom::Installation installation = {"/nowhere", "/tmp", "/tmp", "/tmp"};
  try {
    Cimom::readConfiguration(name, installation);
  } catch (const Cimom::UsageError& error) {
    const std::string_view text = error.what();
    if (!text.starts_with(name) && !text.starts_with("tls-certificate and tls-key")) {
      std::abort();
    }
  }
  return 0;
}
