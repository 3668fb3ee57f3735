#include "agent/backends/ipmi/lan/CompletionCode.h"

#include <array>
#include <cstdio>
#include <map>

namespace QV::Ipmi::CompletionCode {
namespace {

const std::map<std::uint8_t, const char*> meanings = {{done, "done"},
                                                      {parameterNotSupported, "parameter not supported"},
                                                      {setInProgress, "another client's change is in progress"},
                                                      {readOnly, "parameter is read-only"},
                                                      {0xC0, "the BMC is busy"},
                                                      {0xC1, "command not known"},
                                                      {0xC3, "the BMC timed out itself"},
                                                      {parameterOutOfRange, "parameter out of range"},
                                                      {notFound, "not there"},
                                                      {invalidData, "invalid value"},
                                                      {0xD4, "privilege too low: the session needs privilege = admin"},
                                                      {0xD5, "not possible in the present state"},
                                                      {0xFF, "unspecified error"}};

}  // namespace

std::string describe(std::uint8_t code) {
  std::array<char, 8> number;
  std::snprintf(number.data(), number.size(), "0x%02X", code);
  const auto meaning = meanings.find(code);
  if (meaning == meanings.end()) return std::string("completion code ") + number.data();
  return std::string(meaning->second) + " (" + number.data() + ')';
}

}  // namespace QV::Ipmi::CompletionCode
