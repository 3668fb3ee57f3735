// SPDX-License-Identifier: Apache-2.0
#include "cimom/model/DateTime.h"

#include <charconv>
#include <chrono>
#include <cstdlib>

#include "cimom/model/Errors.h"

namespace Cimom {
namespace {

constexpr std::uint64_t perSecond = 1'000'000;
constexpr std::uint64_t perMinute = 60 * perSecond;
constexpr std::uint64_t perHour = 60 * perMinute;
constexpr std::uint64_t perDay = 24 * perHour;

[[noreturn]] void malformed(std::string_view text) {
  throw StatusError(CMPI_RC_ERR_INVALID_PARAMETER, "not a CIM datetime: \"" + std::string(text) + "\"");
}

// The digits [position, position + length) of a datetime text, at most `limit`.
unsigned field(std::string_view text, std::size_t position, std::size_t length, unsigned limit) {
  unsigned value = 0;
  const char* first = text.data() + position;
  const auto [end, error] = std::from_chars(first, first + length, value);
  if (error != std::errc() || end != first + length || value > limit) {
    malformed(text);
  }
  return value;
}

std::uint64_t timeOfDay(std::string_view text) {
  return field(text, 8, 2, 23) * perHour + field(text, 10, 2, 59) * perMinute + field(text, 12, 2, 59) * perSecond +
         field(text, 15, 6, 999'999);
}

}  // namespace

DateTime DateTime::now() {
  const auto now = std::chrono::system_clock::now().time_since_epoch();
  return {static_cast<std::uint64_t>(std::chrono::duration_cast<std::chrono::microseconds>(now).count()), false, 0};
}

DateTime DateTime::parse(std::string_view text) {
  if (text.size() != 25 || text[14] != '.') {
    malformed(text);
  }
  const char kind = text[21];
  const unsigned offset = field(text, 22, 3, 999);
  if (kind == ':') {
    if (offset != 0) {
      malformed(text);
    }
    return {field(text, 0, 8, 99'999'999) * perDay + timeOfDay(text), true, 0};
  }
  if (kind != '+' && kind != '-') {
    malformed(text);
  }
  using namespace std::chrono;
  const year_month_day date(year(static_cast<int>(field(text, 0, 4, 9999))), month(field(text, 4, 2, 12)),
                            day(field(text, 6, 2, 31)));
  if (!date.ok()) {
    malformed(text);
  }
  const int minutes = kind == '+' ? static_cast<int>(offset) : -static_cast<int>(offset);
  const std::int64_t days = sys_days(date).time_since_epoch().count();
  const std::int64_t utc = days * static_cast<std::int64_t>(perDay) + static_cast<std::int64_t>(timeOfDay(text)) -
                           minutes * static_cast<std::int64_t>(perMinute);
  if (utc < 0) {
    malformed(text);
  }
  return {static_cast<std::uint64_t>(utc), false, minutes};
}

std::string DateTime::format() const {
  const std::uint64_t local =
      interval ? microseconds : microseconds + static_cast<std::uint64_t>(utcOffset) * perMinute;
  const std::uint64_t days = local / perDay;
  unsigned long date = static_cast<unsigned long>(days % 100'000'000);
  if (!interval) {
    using namespace std::chrono;
    const year_month_day civil{sys_days(std::chrono::days(static_cast<int>(days)))};
    date = static_cast<unsigned long>(static_cast<int>(civil.year())) * 10'000 +
           static_cast<unsigned long>(static_cast<unsigned>(civil.month())) * 100 + static_cast<unsigned>(civil.day());
  }
  // The years of a date beyond 9999 come before the text that all others have.
  std::string text = date < 100'000'000 ? std::string() : std::to_string(date / 100'000'000);
  const std::size_t begin = text.size();
  text += "yyyymmddhhmmss.mmmmmm+utc";
  const auto put = [&](std::size_t position, std::size_t length, std::uint64_t number) {
    for (std::size_t digit = length; digit > 0; --digit, number /= 10) {
      text[begin + position + digit - 1] = static_cast<char>('0' + number % 10);
    }
  };
  put(0, 8, date);
  put(8, 2, local % perDay / perHour);
  put(10, 2, local % perHour / perMinute);
  put(12, 2, local % perMinute / perSecond);
  put(15, 6, local % perSecond);
  text[begin + 21] = interval ? ':' : (utcOffset < 0 ? '-' : '+');
  put(22, 3, static_cast<std::uint64_t>(interval ? 0 : std::abs(utcOffset)));
  return text;
}

}  // namespace Cimom
