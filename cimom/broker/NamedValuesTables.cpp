// Method arguments and request contexts: both are named values to the interface.
#include "cimom/broker/Guard.h"

namespace Cimom {
namespace {

NamedValues& valuesOf(const CMPIArgs* args) { return modelOf<Args>(args).arguments; }
NamedValues& valuesOf(const CMPIContext* context) { return modelOf<Context>(context).entries; }

template <class Type>
CMPIStatus add(const Type* object, const char* name, const CMPIValue* value, const CMPIType type) {
  return guarded([&] { valuesOf(object).set(required(name, "the name"), Value::fromCmpi(value, type)); });
}

template <class Type>
CMPIData get(const Type* object, const char* name, CMPIStatus* status) {
  return guarded(status, kNoData, [&] { return entryOf(valuesOf(object), name); });
}

template <class Type>
CMPIData getAt(const Type* object, CMPICount index, CMPIString** name, CMPIStatus* status) {
  return guarded(status, kNoData, [&] { return entryAt(valuesOf(object), index, name); });
}

template <class Type>
CMPICount getCount(const Type* object, CMPIStatus* status) {
  return guarded(status, CMPICount(0), [&] { return static_cast<CMPICount>(valuesOf(object).size()); });
}

}  // namespace

CMPIArgsFT Abi<Args>::table = {CMPICurrentVersion, release<Args>,   clone<Args>,       add<CMPIArgs>,
                               get<CMPIArgs>,      getAt<CMPIArgs>, getCount<CMPIArgs>};

CMPIContextFT Abi<Context>::table = {CMPICurrentVersion, release<Context>,      clone<Context>,  get<CMPIContext>,
                                     getAt<CMPIContext>, getCount<CMPIContext>, add<CMPIContext>};

}  // namespace Cimom
