#include "ground/Values.h"

#include <charconv>
#include <cmath>
#include <sstream>

namespace Ground {
namespace {

std::string secondsText(std::chrono::milliseconds time) {
  std::ostringstream text;
  text << std::chrono::duration<double>(time).count();
  return text.str();
}

// Whether the whole text is one number.
template <typename Number, typename... Format>
bool readWhole(const std::string& text, Number& number, Format... format) {
  const char* end = text.data() + text.size();
  const auto [rest, error] = std::from_chars(text.data(), end, number, format...);
  return error == std::errc() && rest == end;
}

}  // namespace

std::uint64_t parseNumber(const std::string& text, std::uint64_t least, std::uint64_t most) {
  std::uint64_t number = 0;
  if (!readWhole(text, number) || number < least || number > most) {
    throw std::invalid_argument("must be a number from " + std::to_string(least) + " to " + std::to_string(most));
  }
  return number;
}

std::chrono::milliseconds parseSeconds(const std::string& text, std::chrono::milliseconds least,
                                       std::chrono::milliseconds most) {
  double number = 0;
  const bool whole = readWhole(text, number, std::chars_format::fixed) && std::isfinite(number);
  const std::chrono::duration<double> time(number);
  if (!whole || time < least || time > most) {
    throw std::invalid_argument("must be seconds from " + secondsText(least) + " to " + secondsText(most));
  }
  return std::chrono::round<std::chrono::milliseconds>(time);
}

std::vector<std::string> parseList(const std::string& text) {
  constexpr const char* separators = ", \t";
  std::vector<std::string> words;
  for (std::size_t start = text.find_first_not_of(separators); start != std::string::npos;) {
    const std::size_t end = text.find_first_of(separators, start);
    words.push_back(text.substr(start, end - start));
    start = text.find_first_not_of(separators, end);
  }
  if (words.empty()) {
    throw std::invalid_argument("must not be an empty list");
  }
  return words;
}

bool parseBoolean(const std::string& text) { return parseChoice<bool>(text, {{"yes", true}, {"no", false}}); }

std::string parseText(const std::string& text) {
  if (text.empty()) {
    throw std::invalid_argument("must not be empty");
  }
  return text;
}

std::string parseAbsolutePath(const std::string& text) {
  if (!text.starts_with('/')) {
    throw std::invalid_argument("must be an absolute path");
  }
  return text;
}

std::string mustBeOneOf(const std::vector<std::string>& words) {
  std::string text;
  for (const std::string& word : words) {
    text += (text.empty() ? "must be one of " : ", ") + word;
  }
  return text;
}

}  // namespace Ground
