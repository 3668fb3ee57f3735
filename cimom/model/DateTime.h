// SPDX-License-Identifier: Apache-2.0
#pragma once

#include <cstdint>
#include <string>
#include <string_view>

namespace Cimom {

// A CIM datetime (DSP0004, "Datetime type"): a time stamp or an interval, to the microsecond.
struct DateTime {
  std::uint64_t microseconds = 0;  // since 1970-01-01 00:00 UTC, or the interval's length
  bool interval = false;
  int utcOffset = 0;  // minutes east of UTC in which a time stamp is written

  static DateTime now();

  // Reads the 25-character form "yyyymmddhhmmss.mmmmmmsutc" or "ddddddddhhmmss.mmmmmm:000". Fields that are not
  // significant (asterisks) are not accepted.
  // Throws StatusError CMPI_RC_ERR_INVALID_PARAMETER.
  static DateTime parse(std::string_view text);

  // The 25-character form.
  std::string format() const;
};

}  // namespace Cimom
