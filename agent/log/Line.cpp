// SPDX-License-Identifier: Apache-2.0
#include "agent/log/Line.h"

#include <array>
#include <cstdio>
#include <ctime>
#include <string_view>

namespace TWLog {
namespace {

void appendEscaped(std::string& line, std::string_view text) {
  constexpr std::string_view hexadecimal = "0123456789abcdef";
  for (const char character : text) {
    const auto byte = static_cast<unsigned char>(character);
    if (character == '\n') {
      line += "\\n";
    } else if (character == '\t') {
      line += "\\t";
    } else if (character == '\r') {
      line += "\\r";
    } else if (character == '\\') {
      line += "\\\\";
    } else if (byte < 0x20 || byte == 0x7f) {
      line += "\\x";
      line += hexadecimal[byte >> 4];
      line += hexadecimal[byte & 0xf];
    } else {
      line += character;
    }
  }
}

std::string_view orEmpty(const char* text) { return text ? text : ""; }

std::string timeStamp(std::chrono::system_clock::time_point time) {
  using namespace std::chrono;
  const auto whole = floor<seconds>(time);
  const std::time_t calendar = system_clock::to_time_t(whole);
  const auto fraction = static_cast<long>(duration_cast<microseconds>(time - whole).count());
  std::tm utc{};
  gmtime_r(&calendar, &utc);
  std::array<char, 32> date{};
  std::array<char, 32> microsecond{};
  std::strftime(date.data(), date.size(), "%Y-%m-%dT%H:%M:%S", &utc);
  std::snprintf(microsecond.data(), microsecond.size(), ".%06ldZ", fraction);
  return std::string(date.data()) + microsecond.data();
}

}  // namespace

std::string describe(const Message& message) {
  std::string line = std::to_string(message.level) + ' ';
  appendEscaped(line, message.component);
  line += ' ';
  appendEscaped(line, orEmpty(message.function));
  line += " (";
  appendEscaped(line, orEmpty(message.file));
  line += ':' + std::to_string(message.line) + "): ";
  appendEscaped(line, message.text);
  return line;
}

std::string fileLine(std::chrono::system_clock::time_point time, int process, const Message& message) {
  return timeStamp(time) + " [" + std::to_string(process) + "] " + describe(message) + '\n';
}

}  // namespace TWLog
