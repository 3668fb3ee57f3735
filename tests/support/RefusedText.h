// Stands in front of the agent's textEqual, so that a test can make the factory refuse to read a class: the only way in
// which the reading of most classes fails. Programs that use it link with --wrap for that function's symbol.
#pragma once

#include <functional>
#include <string>

namespace Testing {

// Whether the comparison of a text with itself answers false: asked with the text and the number of the call for it,
// from 1. Nothing is refused where it is empty, as at the start of every fixture that resets it.
void refuseText(std::function<bool(const std::string& text, int call)> refuses);

}  // namespace Testing
