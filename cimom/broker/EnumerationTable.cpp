#include "cimom/broker/Guard.h"

namespace Cimom {
namespace {

/// What OpenPegasus reports past the end of an enumeration; the interface's list of codes has none for it.
constexpr auto kPastTheEnd = static_cast<CMPIrc>(18);

CMPIData getNext(const CMPIEnumeration* enumeration, CMPIStatus* status) {
  return guarded(status, kNoData, [&] {
    auto& model = modelOf<Enumeration>(enumeration);
    if (model.next >= model.items.size()) throw StatusError(kPastTheEnd, "past the end of the enumeration");
    return model.items[model.next++].toCmpi();
  });
}

CMPIBoolean hasNext(const CMPIEnumeration* enumeration, CMPIStatus* status) {
  return guarded(status, CMPIBoolean(false), [&] {
    const auto& model = modelOf<Enumeration>(enumeration);
    return static_cast<CMPIBoolean>(model.next < model.items.size());
  });
}

/// All items, those already passed included: the position of the walk stays.
CMPIArray* toArray(const CMPIEnumeration* enumeration, CMPIStatus* status) {
  return guarded(status, static_cast<CMPIArray*>(nullptr), [&] {
    const auto& items = modelOf<Enumeration>(enumeration).items;
    return make(Array{items.empty() ? CMPIType(CMPI_null) : items.front().type(), items});
  });
}

}  // namespace

CMPIEnumerationFT Abi<Enumeration>::table = {
    CMPICurrentVersion, release<Enumeration>, clone<Enumeration>, getNext, hasNext, toArray};

}  // namespace Cimom
