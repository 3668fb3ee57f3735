// SPDX-License-Identifier: Apache-2.0
#pragma once

#include <algorithm>
#include <cstddef>
#include <cstdint>
#include <cstring>
#include <memory>
#include <string>
#include <string_view>
#include <unordered_map>

#include "ground/Names.h"

namespace Cimom {

using Ground::lowerCase;
using Ground::NameLess;
using Ground::sameName;

// The first element with that name, or null.
template <typename Range>
auto* findNamed(Range& range, std::string_view name) {
  const auto found = std::ranges::find_if(range, [name](const auto& element) { return sameName(element.name, name); });
  return found == std::ranges::end(range) ? nullptr : std::to_address(found);
}

// A hash of names without regard to case. It takes the ends of names, which differ where their beginnings do not.
struct NameHash {
  using is_transparent = void;

  std::size_t operator()(std::string_view name) const {
    constexpr std::uint64_t lowerCaseBits = 0x2020202020202020;
    constexpr std::uint64_t multiplier = 0x9E3779B97F4A7C15;  // of Fibonacci hashing
    std::uint64_t end = 0;
    if (name.size() >= sizeof end) {
      std::memcpy(&end, name.data() + name.size() - sizeof end, sizeof end);
    } else {
      for (const char letter : name) {
        end = end << 8U | static_cast<unsigned char>(letter);
      }
    }
    return static_cast<std::size_t>(((end | lowerCaseBits) + name.size()) * multiplier >> 32U);
  }
};

struct SameName {
  using is_transparent = void;

  bool operator()(std::string_view left, std::string_view right) const { return sameName(left, right); }
};

// Elements by name, in no order.
template <typename Element>
using ByName = std::unordered_map<std::string, Element, NameHash, SameName>;

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
