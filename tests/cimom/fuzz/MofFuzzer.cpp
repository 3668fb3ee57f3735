// SPDX-License-Identifier: Apache-2.0
// Feeds the MOF reader any bytes: it returns classes or throws a ConfigurationError that names the text, and nothing
// else.
#include <cstddef>
#include <cstdint>
#include <cstdlib>
#include <string_view>

#include "cimom/model/Errors.h"
#include "cimom/schema/ClassRepository.h"

extern "C" int LLVMFuzzerTestOneInput(const std::uint8_t* data, std::size_t size) {
  const std::string_view text(reinterpret_cast<const char*>(data), size);
  // What a text includes is read from the file system, which is not part of the input.
  if (text.find("include") != std::string_view::npos) {
    return -1;
  }
  try {
    Cimom::ClassRepository repository;
    repository.add(Cimom::MofReader().readText(text, "fuzz"));
    for (const auto* definition : repository.all()) {
      if (!repository.find(definition->name)) {
        std::abort();
      }
    }
  } catch (const Cimom::ConfigurationError& error) {
    if (!std::string_view(error.what()).starts_with("fuzz:")) {
      std::abort();
    }
  }
  return 0;
}
