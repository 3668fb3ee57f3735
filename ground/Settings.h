// The keys and values of one section of a configuration file, each value taken with its form and range checked.
#pragma once

#include <chrono>
#include <cstdint>
#include <functional>
#include <map>
#include <stdexcept>
#include <string>
#include <utility>
#include <vector>

#include "ground/Values.h"

namespace Ground {

// Every refusal, "PLACE: KEY = VALUE: REASON". Who knows the line on which the key stands can say it better.
class RefusedSetting : public std::runtime_error {
 public:
  RefusedSetting(const std::string& place, std::string key, const std::string& value, const std::string& reason)
      : RefusedSetting(place, std::move(key), std::string(" = ") + value + ": " + reason) {}

  const std::string& key() const { return key_; }

  // "KEY = VALUE: REASON"
  std::string withoutPlace() const { return key_ + rest_; }

 private:
  RefusedSetting(const std::string& place, std::string key, std::string rest)
      : std::runtime_error(place + ": " + key + rest), key_(std::move(key)), rest_(std::move(rest)) {}

  std::string key_;
  std::string rest_;
};

// A key that is not there leaves its target as it is.
class Settings {
 public:
  using Section = std::map<std::string, std::string>;

  // `place` is where the section stands, for the messages. The section must outlive the reader.
  Settings(std::string place, const Section& section) : place_(std::move(place)), section_(section) {}

  // The value, or null if the key is not there.
  const std::string* find(const std::string& key) const;

  // The value of a key that must be there and not be empty.
  const std::string& required(const std::string& key) const;

  void text(const std::string& key, std::string& target) const;

  void absolutePath(const std::string& key, std::string& target) const;

  void seconds(const std::string& key, std::chrono::milliseconds& target, std::chrono::milliseconds least,
               std::chrono::milliseconds most) const;

  template <typename Number>
  void number(const std::string& key, Number& target, std::uint64_t least, std::uint64_t most) const {
    take(key, [&](const std::string& value) { target = static_cast<Number>(parseNumber(value, least, most)); });
  }

  template <typename Value>
  void choice(const std::string& key, Value& target, const std::vector<std::pair<std::string, Value>>& choices) const {
    take(key, [&](const std::string& value) { target = parseChoice(value, choices); });
  }

  // Hands the value to `use`, where the key is there, and refuses it if that throws std::invalid_argument.
  void take(const std::string& key, const std::function<void(const std::string& value)>& use) const;

  [[noreturn]] void refuse(const std::string& key, const std::string& value, const std::string& reason) const;

 private:
  const std::string place_;
  const Section& section_;
};

}  // namespace Ground
