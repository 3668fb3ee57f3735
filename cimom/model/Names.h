#pragma once

#include <algorithm>
#include <memory>
#include <string_view>

namespace Cimom {

// ASCII lower case; CIM names (DSP0004) have no other letters that case would matter for.
constexpr char lowerCase(char letter) {
  return letter >= 'A' && letter <= 'Z' ? static_cast<char>(letter - 'A' + 'a') : letter;
}

// Orders CIM names, which are equal without regard to case.
struct NameLess {
  using is_transparent = void;

  bool operator()(std::string_view left, std::string_view right) const {
    return std::lexicographical_compare(left.begin(), left.end(), right.begin(), right.end(),
                                        [](char a, char b) { return lowerCase(a) < lowerCase(b); });
  }
};

// Whether two CIM names are the same name.
inline bool sameName(std::string_view left, std::string_view right) {
  return std::equal(left.begin(), left.end(), right.begin(), right.end(),
                    [](char a, char b) { return lowerCase(a) == lowerCase(b); });
}

// The first element with that name, or null.
template <typename Range>
auto* findNamed(Range& range, std::string_view name) {
  const auto found = std::ranges::find_if(range, [name](const auto& element) { return sameName(element.name, name); });
  return found == std::ranges::end(range) ? nullptr : std::to_address(found);
}

// A namespace as it is compared: without the slashes that some clients put around it.
inline std::string_view bareNamespace(std::string_view nameSpace) {
  while (nameSpace.starts_with('/')) {
    nameSpace.remove_prefix(1);
  }
  while (nameSpace.ends_with('/')) {
    nameSpace.remove_suffix(1);
  }
  return nameSpace;
}

}  // namespace Cimom
