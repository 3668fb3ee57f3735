// SPDX-License-Identifier: Apache-2.0
#include "tests/faults/Outcome.h"

#include <algorithm>
#include <cctype>
#include <string_view>

namespace Testing {

namespace {

using Strings = std::vector<std::string>;

// Where the source line stands in the text of a line: begin and end of the digits.
std::pair<std::size_t, std::size_t> numberIn(std::string_view text) {
  const bool variable = text.starts_with("VARIABLE: ");
  constexpr std::string_view beforeNumber = "Line: ";
  constexpr std::string_view beforeVariable = " at line ";
  const std::size_t found = variable                            ? text.rfind(beforeVariable)
                            : text.starts_with("MESSAGE [File") ? text.find(beforeNumber)
                                                                : text.rfind(beforeNumber);
  if (found == std::string_view::npos) {
    return {0, 0};
  }
  const std::size_t begin = found + (variable ? beforeVariable : beforeNumber).size();
  std::size_t end = begin;
  while (end < text.size() && std::isdigit(static_cast<unsigned char>(text[end]))) {
    ++end;
  }
  return {begin, end};
}

bool sameText(const std::string& text, const std::string& expected) {
  if (text == expected) {
    return true;
  }
  const auto [begin, end] = numberIn(text);
  const auto [expectedBegin, expectedEnd] = numberIn(expected);
  return expected.substr(expectedBegin, expectedEnd - expectedBegin) == "0" &&
         text.substr(0, begin) == expected.substr(0, expectedBegin) && text.substr(end) == expected.substr(expectedEnd);
}

bool same(const Line& line, const Line& expected) {
  return line.trace == expected.trace && line.function == expected.function && line.file == expected.file &&
         (expected.number == 0 || line.number == expected.number) && line.component == expected.component &&
         line.level == expected.level && sameText(line.text, expected.text);
}
bool same(const std::string& a, const std::string& b) { return a == b; }

std::string shown(const std::string& text) { return text; }
std::string shown(const Line& line) {
  return std::string(line.trace ? "trace " : "log ") + line.component + ' ' + std::to_string(line.level) + ' ' +
         line.function + ' ' + line.file + ':' + std::to_string(line.number) + ' ' + line.text;
}

template <typename Item>
std::optional<std::string> difference(const char* what, const std::vector<Item>& items,
                                      const std::vector<Item>& expected) {
  for (std::size_t i = 0; i < std::max(items.size(), expected.size()); ++i) {
    if (i < items.size() && i < expected.size() && same(items[i], expected[i])) {
      continue;
    }
    return std::string(what) + ' ' + std::to_string(i + 1) + ":\n    is       " +
           (i < items.size() ? shown(items[i]) : "(none)") + "\n    expected " +
           (i < expected.size() ? shown(expected[i]) : "(none)");
  }
  return std::nullopt;
}

}  // namespace

std::optional<std::string> difference(const Outcome& outcome, const Outcome& expected) {
  if (outcome.status != expected.status) {
    return "status:\n    is       " + outcome.status + "\n    expected " + expected.status;
  }
  std::optional<std::string> found = difference("answer", outcome.answered, expected.answered);
  for (const auto& [what, items] :
       {std::pair{"instrumentation", &Outcome::instrumentation}, std::pair{"up-call", &Outcome::upCalls},
        std::pair{"broker trace", &Outcome::brokerTrace}}) {
    if (!found) {
      found = difference(what, outcome.*items, expected.*items);
    }
  }
  return found ? found : difference("line", outcome.lines, expected.lines);
}

}  // namespace Testing
