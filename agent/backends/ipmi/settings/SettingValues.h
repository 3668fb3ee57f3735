// Values of a section of agent.ini, each taken with its form and range checked. Every refusal names the key, the value
// and the reason.
#pragma once

#include <chrono>
#include <cstdint>
#include <optional>
#include <string>
#include <utility>
#include <vector>

#include "agent/processor/BackEnd.h"

namespace QV::Ipmi {

// Throws std::runtime_error: "agent.ini, [ipmi]: KEY = VALUE: REASON".
[[noreturn]] void refuseValue(const std::string& key, const std::string& value, const std::string& reason);

// A decimal number from least to most.
std::uint64_t parseNumber(const std::string& key, const std::string& value, std::uint64_t least, std::uint64_t most);

// The words of a list that commas or blanks separate; at least one.
std::vector<std::string> splitList(const std::string& key, const std::string& value);

// The bytes that pairs of hexadecimal digits tell; nothing where the text is of another form or empty.
std::optional<std::string> parseHexadecimal(const std::string& digits);

// Takes values out of a section. A key that is not there leaves its target as it is.
class SettingReader {
 public:
  explicit SettingReader(const BackEndSettings& section) : section_(section) {}

  // The value, or null where the key is not there.
  const std::string* find(const std::string& key) const;

  // The value of a key that must be there and not be empty.
  const std::string& required(const std::string& key) const;

  void text(const std::string& key, std::string& target) const;

  template <typename Number>
  void number(const std::string& key, Number& target, std::uint64_t least, std::uint64_t most) const {
    if (const std::string* value = find(key)) target = static_cast<Number>(parseNumber(key, *value, least, most));
  }

  // Seconds, with decimals where the value has them: "2", "0.5".
  void seconds(const std::string& key, std::chrono::milliseconds& target, std::chrono::milliseconds least,
               std::chrono::milliseconds most) const;

  // One of the given words.
  template <typename Value>
  void choice(const std::string& key, Value& target, const std::vector<std::pair<std::string, Value>>& words) const {
    const std::string* value = find(key);
    if (!value) return;
    std::string known;
    for (const auto& [word, meaning] : words) {
      if (*value == word) {
        target = meaning;
        return;
      }
      known += (known.empty() ? "" : ", ") + word;
    }
    refuseValue(key, *value, "must be one of " + known);
  }

 private:
  const BackEndSettings& section_;
};

}  // namespace QV::Ipmi
