// SPDX-License-Identifier: Apache-2.0
#pragma once

#include <algorithm>
#include <memory>
#include <string_view>

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
