// SPDX-License-Identifier: Apache-2.0
#include "tests/hosts/Guide.h"

#include <regex>
#include <stdexcept>

#include "Paths.h"
#include "tests/support/system/TemporaryDirectory.h"

namespace Testing {
namespace {

constexpr const char* guide = SOURCE_DIR "/docs/object-managers.md";

// A message as the document words it, as a pattern for what is said in fact.
std::regex patternOf(const std::string& wording) {
  static const std::regex special(R"([.^$|()\[\]{}*+?\\])");
  static const std::regex variable("…");
  const std::string literal = std::regex_replace(wording, special, R"(\$&)");
  return std::regex(std::regex_replace(literal, variable, ".+"));
}

}  // namespace

Guide::Guide() : text_(readFile(guide)) {}

std::string Guide::commands(const std::string& step) const {
  const std::string opening = "\n```sh " + step + "\n";
  const auto begin = text_.find(opening);
  if (begin == std::string::npos) {
    throw std::runtime_error(std::string(guide) + " has no step \"" + step + '"');
  }
  const auto first = begin + opening.size();
  return text_.substr(first, text_.find("```", first) - first);
}

bool Guide::explains(const std::string& message) const {
  // The first column of the tables: a line "| `wording` | …".
  static const std::regex row("\n\\| `([^`]+)` \\|");
  for (std::sregex_iterator found(text_.begin(), text_.end(), row), end; found != end; ++found) {
    if (std::regex_search(message, patternOf((*found)[1]))) {
      return true;
    }
  }
  return false;
}

}  // namespace Testing
