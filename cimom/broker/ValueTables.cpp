// SPDX-License-Identifier: Apache-2.0
// The function tables of the objects that are no more than their contents.
#include "cimom/broker/Guard.h"
#include "cimom/model/Types.h"

namespace Cimom {
namespace {

// CMPIString.

const char* getCharPtr(const CMPIString* string, CMPIStatus* status) {
  return guarded(status, static_cast<const char*>(nullptr), [&] { return textOf(string); });
}

// CMPIDateTime.

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

// CMPIArray.

void requireIndex(const Array& array, CMPICount index) {
  if (index >= array.elements.size()) {
    throw StatusError(CMPI_RC_ERR_NO_SUCH_PROPERTY, "index " + std::to_string(index) +
                                                        " is past the end of an array of " +
                                                        std::to_string(array.elements.size()) + " elements");
  }
}

CMPICount getSize(const CMPIArray* array, CMPIStatus* status) {
  return guarded(status, CMPICount(0), [&] { return static_cast<CMPICount>(modelOf<Array>(array).elements.size()); });
}

CMPIType getSimpleType(const CMPIArray* array, CMPIStatus* status) {
  return guarded(status, CMPIType(CMPI_null), [&] { return modelOf<Array>(array).elementType; });
}

CMPIData getElementAt(const CMPIArray* array, CMPICount index, CMPIStatus* status) {
  return guarded(status, noData, [&] {
    const Array& model = modelOf<Array>(array);
    requireIndex(model, index);
    return toCmpi(model.elements[index]);
  });
}

CMPIStatus setElementAt(CMPIArray* array, CMPICount index, const CMPIValue* value, CMPIType type) {
  return guarded([&] {
    Array& model = ownModelOf<Array>(array);
    requireIndex(model, index);
    Value element = fromCmpi(value, type);
    if (element.isNull()) {
      element = Value::null(model.elementType);
    } else if (element.type() != model.elementType) {
      throw StatusError(CMPI_RC_ERR_TYPE_MISMATCH,
                        "expected " + describeType(model.elementType) + ", not " + describeType(element.type()));
    }
    model.elements[index] = std::move(element);
  });
}

// CMPIEnumeration.

// What OpenPegasus reports past the end of an enumeration; the interface's list of codes has none for it.
constexpr auto pastTheEnd = static_cast<CMPIrc>(18);

CMPIData getNext(const CMPIEnumeration* enumeration, CMPIStatus* status) {
  return guarded(status, noData, [&] {
    auto& model = ownModelOf<Enumeration>(enumeration);
    if (model.next >= model.items.size()) {
      throw StatusError(pastTheEnd, "past the end of the enumeration");
    }
    return toCmpi(model.items[model.next++]);
  });
}

CMPIBoolean hasNext(const CMPIEnumeration* enumeration, CMPIStatus* status) {
  return guarded(status, CMPIBoolean(false), [&] {
    const auto& model = modelOf<Enumeration>(enumeration);
    return static_cast<CMPIBoolean>(model.next < model.items.size());
  });
}

// All items, those already passed included: the position of the walk stays.
CMPIArray* toArray(const CMPIEnumeration* enumeration, CMPIStatus* status) {
  return guarded(status, static_cast<CMPIArray*>(nullptr), [&] {
    const auto& items = modelOf<Enumeration>(enumeration).items;
    return make(Array{items.empty() ? CMPIType(CMPI_null) : items.front().type(), items});
  });
}

// CMPIArgs and CMPIContext: both are named values to the interface.

NamedValues& valuesOf(const CMPIArgs* args) { return ownModelOf<Args>(args).arguments; }
NamedValues& valuesOf(const CMPIContext* context) { return ownModelOf<Context>(context).entries; }

template <typename Type>
CMPIStatus add(const Type* object, const char* name, const CMPIValue* value, const CMPIType type) {
  return guarded([&] { valuesOf(object).set(required(name, "the name"), fromCmpi(value, type)); });
}

template <typename Type>
CMPIData get(const Type* object, const char* name, CMPIStatus* status) {
  return guarded(status, noData, [&] { return entryOf(valuesOf(object), name); });
}

template <typename Type>
CMPIData getAt(const Type* object, CMPICount index, CMPIString** name, CMPIStatus* status) {
  return guarded(status, noData, [&] { return entryAt(valuesOf(object), index, name); });
}

template <typename Type>
CMPICount getCount(const Type* object, CMPIStatus* status) {
  return guarded(status, CMPICount(0), [&] { return static_cast<CMPICount>(valuesOf(object).size()); });
}

}  // namespace

CMPIStringFT Abi<Text>::table = {CMPICurrentVersion, release<Text>, clone<Text>, getCharPtr};

CMPIDateTimeFT Abi<DateTime>::table = {CMPICurrentVersion, release<DateTime>, clone<DateTime>,
                                       getBinaryFormat,    getStringFormat,   isInterval};

CMPIArrayFT Abi<Array>::table = {CMPICurrentVersion, release<Array>, clone<Array>, getSize,
                                 getSimpleType,      getElementAt,   setElementAt};

CMPIEnumerationFT Abi<Enumeration>::table = {
    CMPICurrentVersion, release<Enumeration>, clone<Enumeration>, getNext, hasNext, toArray};

CMPIArgsFT Abi<Args>::table = {CMPICurrentVersion, release<Args>,   clone<Args>,       add<CMPIArgs>,
                               get<CMPIArgs>,      getAt<CMPIArgs>, getCount<CMPIArgs>};

CMPIContextFT Abi<Context>::table = {CMPICurrentVersion, release<Context>,      clone<Context>,  get<CMPIContext>,
                                     getAt<CMPIContext>, getCount<CMPIContext>, add<CMPIContext>};

}  // namespace Cimom
