// SPDX-License-Identifier: Apache-2.0
// Reads INI text: agent.ini and cimomd's configuration file. It knows nothing of what the keys mean.
#pragma once

#include <functional>
#include <istream>
#include <string>

namespace Ground {

struct IniEntry {
  std::string section;  // empty before the first [section]
  std::string key;
  std::string value;
  unsigned line;
};

// Passes every `key = value` line of the text to `take`, in order. Comments begin with ';' or '#' at the start of a
// line, or with ';' after a blank; indentation means nothing. Throws std::runtime_error "FILE:LINE: what is wrong" for
// the first line that is not INI, is too long, or for which `take` throws.
void readIni(std::istream& text, const std::string& fileName, const std::function<void(const IniEntry&)>& take);

}  // namespace Ground
