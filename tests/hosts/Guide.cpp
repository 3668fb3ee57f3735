// SPDX-License-Identifier: Apache-2.0
#include "tests/hosts/Guide.h"

#include <algorithm>
#include <stdexcept>

#include "Paths.h"
#include "tests/support/system/Pattern.h"
#include "tests/support/system/TemporaryDirectory.h"

namespace Testing {
namespace {

constexpr const char* guide = SOURCE_DIR "/docs/object-managers.md";

// A message as the document words it, as a pattern for what is said in fact.
Pattern patternOf(const std::string& wording) {
  static const Pattern special(R"([.^$|()\[\]{}*+?\\])");
  static const Pattern variable("…");
  return Pattern(variable.replaced(special.replaced(wording, R"(\$&)"), ".+"));
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
  const std::vector<Pattern::Match> rows = Pattern("\n\\| `([^`]+)` \\|").all(text_);
  return std::ranges::any_of(rows,
                             [&](const Pattern::Match& row) { return !patternOf(row[1]).first(message).empty(); });
}

}  // namespace Testing
