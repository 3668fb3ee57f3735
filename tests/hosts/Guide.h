// SPDX-License-Identifier: Apache-2.0
#pragma once

#include <string>

namespace Testing {

// docs/object-managers.md: the commands that an administrator is given, which are those that are run here, and the
// explanations of what an object manager answers.
class Guide {
 public:
  Guide();

  // The commands of a step, which stand in a code block that begins with "```sh STEP". Throws std::runtime_error where
  // there is no such step.
  std::string commands(const std::string& step) const;

  // Whether it explains the message, which stands there as code. A part of the message that differs from site to site
  // stands there as "…".
  bool explains(const std::string& message) const;

 private:
  std::string text_;
};

}  // namespace Testing
