// Reads the INI dialect of the agent's configuration.
#pragma once

#include <functional>
#include <istream>
#include <string>

namespace QV {

// Takes one `key = value` line of a section. A std::invalid_argument that it throws is reported with the line.
using IniLine = std::function<void(const std::string& section, const std::string& key, const std::string& value)>;

// Passes every key of the text to `take`, in order. Comments start with ';' or '#' at the start of a line, or with ';'
// after a blank; indentation means nothing. Throws std::runtime_error "FILE:LINE: what is wrong" at the first line that
// is no INI, is too long, or is refused by `take`.
void readIni(std::istream& text, const std::string& fileName, const IniLine& take);

}  // namespace QV
