#include "cimom/broker/Guard.h"

namespace Cimom {
namespace {

const char* getCharPtr(const CMPIString* string, CMPIStatus* status) {
  return guarded(status, static_cast<const char*>(nullptr), [&] { return textOf(string); });
}

}  // namespace

CMPIStringFT Abi<Text>::table = {CMPICurrentVersion, release<Text>, clone<Text>, getCharPtr};

}  // namespace Cimom
