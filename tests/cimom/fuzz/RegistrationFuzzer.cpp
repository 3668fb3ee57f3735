// SPDX-License-Identifier: Apache-2.0
// Feeds the readers of registrations and of profiles any bytes: each returns what it read or throws a
// ConfigurationError, and nothing else.
#include <sys/mman.h>
#include <unistd.h>

#include <cstddef>
#include <cstdint>
#include <cstdlib>
#include <string>

#include "cimom/interop/Profiles.h"
#include "cimom/model/Errors.h"
#include "cimom/providers/ProviderRegistration.h"

namespace {

// A file in memory, whose content is the input.
std::string fileWith(const std::uint8_t* data, std::size_t size) {
  static const int file = memfd_create("input", 0);
  if (ftruncate(file, 0) != 0 || pwrite(file, data, size, 0) != static_cast<ssize_t>(size)) {
    std::abort();
  }
  return "/proc/self/fd/" + std::to_string(file);
}

template <typename Read>
void attempt(Read read, const std::string& file) {
  try {
    read(file);
  } catch (const Cimom::ConfigurationError& error) {
    if (!std::string(error.what()).starts_with(file)) {
      std::abort();
    }
  }
}

}  // namespace

extern "C" int LLVMFuzzerTestOneInput(const std::uint8_t* data, std::size_t size) {
  const std::string file = fileWith(data, size);
  attempt(Cimom::readRegistration, file);
  attempt(Cimom::readProfiles, file);
  return 0;
}
