#include "cimom/broker/Guard.h"

namespace Cimom {
namespace {

void requireIndex(const Array& array, CMPICount index) {
  if (index >= array.elements.size()) {
    throw StatusError(CMPI_RC_ERR_NO_SUCH_PROPERTY, "index " + std::to_string(index) + " in an array of " +
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
  return guarded(status, kNoData, [&] {
    const Array& model = modelOf<Array>(array);
    requireIndex(model, index);
    return model.elements[index].toCmpi();
  });
}

CMPIStatus setElementAt(CMPIArray* array, CMPICount index, const CMPIValue* value, CMPIType type) {
  return guarded([&] {
    Array& model = modelOf<Array>(array);
    requireIndex(model, index);
    Value element = Value::fromCmpi(value, type);
    if (element.isNull()) {
      element = Value::null(model.elementType);
    } else if (element.type() != model.elementType) {
      throw StatusError(CMPI_RC_ERR_INVALID_DATA_TYPE,
                        "a " + typeName(element.type()) + " in an array of " + typeName(model.elementType));
    }
    model.elements[index] = std::move(element);
  });
}

}  // namespace

CMPIArrayFT Abi<Array>::table = {CMPICurrentVersion, release<Array>, clone<Array>, getSize,
                                 getSimpleType,      getElementAt,   setElementAt};

}  // namespace Cimom
