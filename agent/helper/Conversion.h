// CMPI data as ordinary values. A datum that is null, or whose pointer is, has no value of any kind.
#pragma once

#include <cmpidt.h>

#include <cstdint>
#include <limits>
#include <optional>
#include <string>

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

std::optional<Integer> integerOf(const CMPIData& data);

// The characters of a string or chars datum.
std::optional<std::string> textOf(const CMPIData& data);

// The characters of a broker's string: empty where the string, its handle or its characters are null.
std::string charactersOf(const CMPIString* string);

}  // namespace QV
