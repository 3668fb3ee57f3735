// The values of settings, from their texts. Each refusal is a std::invalid_argument with the reason alone, such as
// "must be a number from 1 to 11": who asks knows where the text stands.
#pragma once

#include <chrono>
#include <cstdint>
#include <stdexcept>
#include <string>
#include <utility>
#include <vector>

namespace Ground {

// A decimal number from least to most.
std::uint64_t parseNumber(const std::string& text, std::uint64_t least, std::uint64_t most);

// Seconds, with decimals where the text has them: "2", "0.5".
std::chrono::milliseconds parseSeconds(const std::string& text, std::chrono::milliseconds least,
                                       std::chrono::milliseconds most);

// The words of a list that commas or blanks separate; at least one.
std::vector<std::string> parseList(const std::string& text);

bool parseBoolean(const std::string& text);  // yes or no

std::string parseText(const std::string& text);  // any but the empty one

std::string parseAbsolutePath(const std::string& text);

// "must be one of simulated, ipmi"
std::string mustBeOneOf(const std::vector<std::string>& words);

// What the text stands for among the words.
template <typename Value>
Value parseChoice(const std::string& text, const std::vector<std::pair<std::string, Value>>& choices) {
  std::vector<std::string> words;
  for (const auto& [word, value] : choices) {
    if (text == word) {
      return value;
    }
    words.push_back(word);
  }
  throw std::invalid_argument(mustBeOneOf(words));
}

}  // namespace Ground
