// SPDX-License-Identifier: Apache-2.0
// What can go wrong with one call that the library makes.
#pragma once

#include <string>
#include <vector>

namespace Testing {

enum class Fault {
  None,
  // Of calls that answer an object or a value.
  NullWithError,
  NullSilently,   // null with the code OK
  WithoutHandle,  // an object whose handle is null
  GoodWithError,  // the right answer beside an error
  NullState,      // of a value: flagged null, whatever else it holds
  BadState,       // flagged bad
  NotFound,       // flagged as not there, with that code
  NullPointer,    // of the right type, and no object
  Number,         // of another type: each of these
  Text,
  Reference,
  Instance,
  Array,
  Characters,   // a text as bare characters
  OtherNumber,  // of calls that count or answer yes or no: too many, the opposite
  // Of calls that do something.
  FailsUndone,
  FailsDone,  // done, and an error all the same
  UndoneSilently,
  // Of calls into the agent's libraries.
  ReturnsNothing,
  StandardException,
  ForeignException,  // of a type that is no std::exception
};

using Faults = std::vector<Fault>;

inline constexpr int faultCount = static_cast<int>(Fault::ForeignException) + 1;

// As a point's name shows it.
std::string nameOf(Fault fault);

}  // namespace Testing
