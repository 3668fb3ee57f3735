#include "cimom/broker/Guard.h"

namespace Cimom {
namespace {

CMPIUint64 getBinaryFormat(const CMPIDateTime* dateTime, CMPIStatus* status) {
  return guarded(status, CMPIUint64(0), [&] { return CMPIUint64(modelOf<DateTime>(dateTime).microseconds); });
}

CMPIString* getStringFormat(const CMPIDateTime* dateTime, CMPIStatus* status) {
  return guarded(status, static_cast<CMPIString*>(nullptr),
                 [&] { return make(Text{modelOf<DateTime>(dateTime).format()}); });
}

CMPIBoolean isInterval(const CMPIDateTime* dateTime, CMPIStatus* status) {
  return guarded(status, CMPIBoolean(false),
                 [&] { return static_cast<CMPIBoolean>(modelOf<DateTime>(dateTime).interval); });
}

}  // namespace

CMPIDateTimeFT Abi<DateTime>::table = {CMPICurrentVersion, release<DateTime>, clone<DateTime>,
                                       getBinaryFormat,    getStringFormat,   isInterval};

}  // namespace Cimom
