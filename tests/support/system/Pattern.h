// SPDX-License-Identifier: Apache-2.0
// Regular expressions for tests. std::regex takes a compiler seconds in each source that includes it, and so stands in
// one.
#pragma once

#include <functional>
#include <memory>
#include <string>
#include <vector>

namespace Testing {

// An expression in the grammar of ECMAScript, in which ^ and $ are those of each line too.
class Pattern {
 public:
  // What matches, and what its groups match.
  using Match = std::vector<std::string>;

  explicit Pattern(const std::string& expression);
  ~Pattern();

  // The match of the whole text, the first one in it, and all of them in their order; empty if there is none.
  Match whole(const std::string& text) const;
  Match first(const std::string& text) const;
  std::vector<Match> all(const std::string& text) const;

  // The text with each match replaced: by a text in which $1 is the first group, or by what a function makes of it.
  std::string replaced(const std::string& text, const std::string& by) const;
  std::string replaced(const std::string& text, const std::function<std::string(const std::string&)>& by) const;

 private:
  struct Expression;
  std::shared_ptr<const Expression> expression_;
};

}  // namespace Testing
