#include "agent/config/IniFile.h"

#include <ini.h>

#include <algorithm>
#include <stdexcept>

namespace QV {
namespace {

// One pass over a file. inih tells its handler no line numbers and keeps going after an error, so the reader that feeds
// it counts the lines, and the first complaint is kept. Nothing may be thrown through inih's C frames.
class Pass {
 public:
  Pass(std::istream& text, const IniLine& take) : text_(text), take_(take) {}

  // inih's reader: the next line, null at the end of the text.
  static char* readLine(char* buffer, int size, void* pass) {
    auto& self = *static_cast<Pass*>(pass);
    std::string line;
    if (!std::getline(self.text_, line)) return nullptr;
    ++self.line_;
    // inih takes an indented line for the continuation of the value before it: a trap in a file edited by hand.
    line.erase(0, std::min(line.find_first_not_of(" \t\r"), line.size()));
    const auto room = static_cast<std::size_t>(size) - 2;
    if (line.size() > room) {
      self.complain("the line is longer than " + std::to_string(room) + " characters");
      line.resize(room);
    }
    if (line.find('\0') != std::string::npos) self.complain("the line holds a null character");
    *std::copy(line.begin(), line.end(), buffer) = '\0';
    return buffer;
  }

  // inih's handler: non-zero where the line is accepted.
  static int handle(void* pass, const char* section, const char* key, const char* value) {
    auto& self = *static_cast<Pass*>(pass);
    try {
      self.take_(section, key, value);
    } catch (const std::exception& error) {
      self.complain(error.what());
    }
    return 1;
  }

  void complain(const std::string& text, int line) {
    if (complaint_.empty() || line < complaintLine_) {
      complaint_ = text;
      complaintLine_ = line;
    }
  }

  void finish(const std::string& fileName) const {
    if (!complaint_.empty())
      throw std::runtime_error(fileName + ":" + std::to_string(complaintLine_) + ": " + complaint_);
  }

 private:
  void complain(const std::string& text) { complain(text, line_); }

  std::istream& text_;
  const IniLine& take_;
  int line_ = 0;
  int complaintLine_ = 0;
  std::string complaint_;
};

}  // namespace

void readIni(std::istream& text, const std::string& fileName, const IniLine& take) {
  Pass pass(text, take);
  const int errorLine = ini_parse_stream(&Pass::readLine, &pass, &Pass::handle, &pass);
  if (errorLine > 0) pass.complain("neither a [section] nor a key = value", errorLine);
  pass.finish(fileName);
  if (errorLine < 0 || text.bad()) throw std::runtime_error(fileName + ": cannot be read");
}

}  // namespace QV
