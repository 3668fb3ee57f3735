#include "agent/backends/ipmi/settings/SettingValues.h"

#include <charconv>
#include <cmath>
#include <sstream>
#include <stdexcept>

namespace QV::Ipmi {
namespace {

std::string secondsText(std::chrono::milliseconds time) {
  std::ostringstream text;
  text << std::chrono::duration<double>(time).count();
  return text.str();
}

}  // namespace

void refuseValue(const std::string& key, const std::string& value, const std::string& reason) {
  throw std::runtime_error("agent.ini, [ipmi]: " + key + " = " + value + ": " + reason);
}

std::uint64_t parseNumber(const std::string& key, const std::string& value, std::uint64_t least, std::uint64_t most) {
  std::uint64_t number = 0;
  const char* end = value.data() + value.size();
  const auto [rest, error] = std::from_chars(value.data(), end, number);
  if (error != std::errc() || rest != end || number < least || number > most)
    refuseValue(key, value, "must be a number from " + std::to_string(least) + " to " + std::to_string(most));
  return number;
}

std::vector<std::string> splitList(const std::string& key, const std::string& value) {
  constexpr const char* separators = ", \t";
  std::vector<std::string> words;
  for (std::size_t start = value.find_first_not_of(separators); start != std::string::npos;) {
    const std::size_t end = value.find_first_of(separators, start);
    words.push_back(value.substr(start, end - start));
    start = value.find_first_not_of(separators, end);
  }
  if (words.empty()) refuseValue(key, value, "the list is empty");
  return words;
}

std::optional<std::string> parseHexadecimal(const std::string& digits) {
  if (digits.empty() || digits.size() % 2 != 0) return std::nullopt;
  std::string bytes;
  for (std::size_t position = 0; position < digits.size(); position += 2) {
    unsigned char byte = 0;
    const char* pair = digits.data() + position;
    const auto [rest, error] = std::from_chars(pair, pair + 2, byte, 16);
    if (error != std::errc() || rest != pair + 2) return std::nullopt;
    bytes.push_back(static_cast<char>(byte));
  }
  return bytes;
}

const std::string* SettingReader::find(const std::string& key) const {
  const auto entry = section_.find(key);
  return entry == section_.end() ? nullptr : &entry->second;
}

const std::string& SettingReader::required(const std::string& key) const {
  const std::string* value = find(key);
  if (!value || value->empty()) refuseValue(key, "", "the key is missing and has no default");
  return *value;
}

void SettingReader::text(const std::string& key, std::string& target) const {
  if (find(key)) target = required(key);
}

void SettingReader::seconds(const std::string& key, std::chrono::milliseconds& target, std::chrono::milliseconds least,
                            std::chrono::milliseconds most) const {
  const std::string* value = find(key);
  if (!value) return;
  double number = 0;
  const char* end = value->data() + value->size();
  const auto [rest, error] = std::from_chars(value->data(), end, number, std::chars_format::fixed);
  const std::chrono::duration<double> time(number);
  if (error != std::errc() || rest != end || !std::isfinite(number) || time < least || time > most)
    refuseValue(key, *value, "must be seconds from " + secondsText(least) + " to " + secondsText(most));
  target = std::chrono::round<std::chrono::milliseconds>(time);
}

}  // namespace QV::Ipmi
