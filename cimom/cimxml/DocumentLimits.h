// SPDX-License-Identifier: Apache-2.0
#pragma once

#include <cstddef>
#include <string_view>

namespace Cimom::CimXml {

// What a request may consist of. No client comes near; beyond, the parser's and the reader's cost grows with the
// square.
struct DocumentLimits {
  static constexpr std::size_t elements = 65536;   // comments, instructions and sections of character data included
  static constexpr std::size_t elementNames = 64;  // different ones
  static constexpr std::size_t attributes = 32;    // of one element
};

// Refuses, in one pass over the text and before anything is parsed, a document that exceeds the limits, has an internal
// DTD subset, or is in an encoding that hides its tags from this pass: UTF-8 and its like with ASCII as their lower
// half, and UTF-16, are taken. What is not well-formed otherwise is left to the parser. Throws TransportError
// "request-not-valid" or "request-not-well-formed" with the line.
void requireWithinLimits(std::string_view xml);

}  // namespace Cimom::CimXml
