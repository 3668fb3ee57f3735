// SPDX-License-Identifier: Apache-2.0
// CMPI data as ordinary values. A datum that is null, bad or not found, or whose pointer is null, has no value of any
// kind: object managers hand out all of these.
#pragma once

#include <cmpidt.h>

#include <cstdint>
#include <limits>
#include <optional>

namespace QV {

// An integer of any of CMPI's eight integer types.
struct Integer {
  bool negative;
  std::uint64_t bits;  // two's complement where negative

  bool operator==(const Integer&) const = default;

  template <typename Unsigned>
  bool fits() const {
    return !negative && bits <= std::numeric_limits<Unsigned>::max();
  }
};

// Whether the state says that there is a value. Its type and its pointers are still to be looked at.
bool hasValue(const CMPIData& data);

std::optional<Integer> integerOf(const CMPIData& data);

// The characters of a string or chars datum, and of a broker's string; null if it has none. They are the broker's and
// live as long as what they were read from.
const char* textOf(const CMPIData& data);
const char* textOf(const CMPIString* string);

}  // namespace QV
