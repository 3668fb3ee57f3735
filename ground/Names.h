// SPDX-License-Identifier: Apache-2.0
// CIM names, which DSP0004 takes as equal without regard to case.
#pragma once

#include <algorithm>
#include <string_view>

namespace Ground {

// ASCII lower case: CIM names have no other letters that case would matter for, and a locale must not change what is
// equal.
constexpr char lowerCase(char letter) {
  return letter >= 'A' && letter <= 'Z' ? static_cast<char>(letter - 'A' + 'a') : letter;
}

struct NameLess {
  using is_transparent = void;

  bool operator()(std::string_view left, std::string_view right) const {
    return std::lexicographical_compare(left.begin(), left.end(), right.begin(), right.end(),
                                        [](char a, char b) { return lowerCase(a) < lowerCase(b); });
  }
};

// Most names come as they were declared.
inline bool sameName(std::string_view left, std::string_view right) {
  return left == right || std::equal(left.begin(), left.end(), right.begin(), right.end(),
                                     [](char a, char b) { return lowerCase(a) == lowerCase(b); });
}

}  // namespace Ground
