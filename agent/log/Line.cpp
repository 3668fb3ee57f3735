// SPDX-License-Identifier: Apache-2.0
#include "agent/log/Line.h"

#include <array>
#include <charconv>
#include <cstdint>
#include <cstring>
#include <limits>
#include <string_view>

namespace TWLog {
namespace {

bool isEscaped(char character) {
  const auto byte = static_cast<unsigned char>(character);
  return byte < 0x20 || byte == 0x7f || byte == '\\';
}

// Whether one of eight bytes is escaped, or may be: in each byte of the words the high bit shows that it was less than
// what was taken from it.
bool mayBeEscaped(std::uint64_t bytes) {
  constexpr std::uint64_t each = 0x0101010101010101, highBits = 0x80 * each;
  const auto less = [](std::uint64_t word, std::uint64_t than) { return (word - than * each) & ~word; };
  const std::uint64_t found =
      less(bytes, 0x20) | less(bytes ^ 0x7f * each, 1) | less(bytes ^ std::uint64_t{'\\'} * each, 1);
  return (found & highBits) != 0;
}

// How many bytes come before the first that is escaped. Nearly every text has none.
std::size_t plainLength(std::string_view text) {
  std::size_t length = 0;
  for (std::uint64_t word; length + sizeof word <= text.size(); length += sizeof word) {
    std::memcpy(&word, text.data() + length, sizeof word);
    if (mayBeEscaped(word)) {
      break;
    }
  }
  while (length < text.size() && !isEscaped(text[length])) {
    ++length;
  }
  return length;
}

void appendEscape(std::string& line, char character) {
  constexpr std::string_view hexadecimal = "0123456789abcdef";
  const auto byte = static_cast<unsigned char>(character);
  switch (character) {
    case '\n':
      line += "\\n";
      return;
    case '\t':
      line += "\\t";
      return;
    case '\r':
      line += "\\r";
      return;
    case '\\':
      line += "\\\\";
      return;
    default:
      line += "\\x";
      line += hexadecimal[byte >> 4];
      line += hexadecimal[byte & 0xf];
  }
}

void appendEscaped(std::string& line, std::string_view text) {
  while (true) {
    const std::size_t plain = plainLength(text);
    line += text.substr(0, plain);
    if (plain == text.size()) {
      return;
    }
    appendEscape(line, text[plain]);
    text.remove_prefix(plain + 1);
  }
}

void appendNumber(std::string& line, int number) {
  std::array<char, std::numeric_limits<int>::digits10 + 3> digits;
  const auto end = std::to_chars(digits.begin(), digits.end(), number).ptr;
  line.append(digits.begin(), end);
}

std::string_view orEmpty(const char* text) { return text ? text : ""; }

void appendTimeStamp(std::string& line, std::chrono::system_clock::time_point time) {
  using namespace std::chrono;
  const auto day = floor<days>(time);
  const year_month_day date(day);
  const hh_mm_ss clock(duration_cast<microseconds>(time - day));
  std::array<char, 28> stamp = {"0000-00-00T00:00:00.000000Z"};
  const auto put = [&](auto value, std::size_t first, std::size_t end) {
    for (auto number = static_cast<unsigned>(value); end > first; number /= 10) {
      stamp[--end] = static_cast<char>('0' + number % 10);
    }
  };
  put(static_cast<int>(date.year()), 0, 4);
  put(static_cast<unsigned>(date.month()), 5, 7);
  put(static_cast<unsigned>(date.day()), 8, 10);
  put(clock.hours().count(), 11, 13);
  put(clock.minutes().count(), 14, 16);
  put(clock.seconds().count(), 17, 19);
  put(clock.subseconds().count(), 20, 26);
  line.append(stamp.data(), stamp.size() - 1);
}

void appendDescription(std::string& line, const Message& message) {
  appendNumber(line, message.level);
  line += ' ';
  appendEscaped(line, message.component);
  line += ' ';
  appendEscaped(line, orEmpty(message.function));
  line += " (";
  appendEscaped(line, orEmpty(message.file));
  line += ':';
  appendNumber(line, message.line);
  line += "): ";
  appendEscaped(line, message.text);
}

// Enough for a line of which nothing is escaped.
std::string emptyLine(const Message& message) {
  constexpr std::size_t stampNumbersAndSigns = 96;
  std::string line;
  line.reserve(stampNumbersAndSigns + message.component.size() + orEmpty(message.function).size() +
               orEmpty(message.file).size() + message.text.size());
  return line;
}

}  // namespace

std::string describe(const Message& message) {
  std::string line = emptyLine(message);
  appendDescription(line, message);
  return line;
}

std::string fileLine(std::chrono::system_clock::time_point time, int process, const Message& message) {
  std::string line = emptyLine(message);
  appendTimeStamp(line, time);
  line += " [";
  appendNumber(line, process);
  line += "] ";
  appendDescription(line, message);
  line += '\n';
  return line;
}

}  // namespace TWLog
