// SPDX-License-Identifier: Apache-2.0
#include "tests/support/system/Pattern.h"

#include <regex>

namespace Testing {
namespace {

Pattern::Match groupsOf(const std::smatch& match) {
  Pattern::Match groups;
  for (const std::ssub_match& group : match) {
    groups.push_back(group.str());
  }
  return groups;
}

}  // namespace

struct Pattern::Expression {
  std::regex regex;
};

Pattern::Pattern(const std::string& expression)
    : expression_(new Expression{std::regex(expression, std::regex::ECMAScript | std::regex::multiline)}) {}

Pattern::~Pattern() = default;

Pattern::Match Pattern::whole(const std::string& text) const {
  std::smatch match;
  return std::regex_match(text, match, expression_->regex) ? groupsOf(match) : Match();
}

Pattern::Match Pattern::first(const std::string& text) const {
  std::smatch match;
  return std::regex_search(text, match, expression_->regex) ? groupsOf(match) : Match();
}

std::vector<Pattern::Match> Pattern::all(const std::string& text) const {
  std::vector<Match> matches;
  for (std::sregex_iterator match(text.begin(), text.end(), expression_->regex), end; match != end; ++match) {
    matches.push_back(groupsOf(*match));
  }
  return matches;
}

std::string Pattern::replaced(const std::string& text, const std::string& by) const {
  return std::regex_replace(text, expression_->regex, by);
}

std::string Pattern::replaced(const std::string& text, const std::function<std::string(const std::string&)>& by) const {
  std::string result;
  auto rest = text.cbegin();
  for (std::sregex_iterator match(text.begin(), text.end(), expression_->regex), end; match != end; ++match) {
    result.append(rest, (*match)[0].first).append(by(match->str()));
    rest = (*match)[0].second;
  }
  return result.append(rest, text.cend());
}

}  // namespace Testing
