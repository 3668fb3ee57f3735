// SPDX-License-Identifier: Apache-2.0
#include "tests/faults/Answers.h"

#include <utility>

namespace Testing {

namespace {

CMPIValue objectWithoutHandleFor(CMPIType type) {
  CMPIValue value = {};
  switch (type) {
    case CMPI_string:
      value.string = objectWithoutHandle<CMPIString>();
      break;
    case CMPI_ref:
      value.ref = objectWithoutHandle<CMPIObjectPath>();
      break;
    case CMPI_instance:
      value.inst = objectWithoutHandle<CMPIInstance>();
      break;
    default:
      value.array = objectWithoutHandle<CMPIArray>();
      break;
  }
  return value;
}

template <typename Model>
auto* another(Model model, const Call& call) {
  return adopted(Cimom::make(std::move(model)), call);
}

}  // namespace

// Whatever the state says: there are object managers that flag good items as null.
void adoptValue(const CMPIData& data, const Call& call) {
  switch (data.type) {
    case CMPI_string:
      adopted(data.value.string, call);
      break;
    case CMPI_ref:
      adopted(data.value.ref, call);
      break;
    case CMPI_instance:
      adopted(data.value.inst, call);
      break;
    case CMPI_dateTime:
      adopted(data.value.dateTime, call);
      break;
    default:
      if (CMIsArray(data)) {
        adopted(data.value.array, call);
      }
      break;
  }
}

Faults faultsOf(const CMPIData& data, bool tellsStatus) {
  Faults faults = {Fault::NullWithError, Fault::NullState, Fault::BadState,
                   Fault::NotFound,      Fault::Number,    Fault::Characters};
  if (tellsStatus) {
    faults.insert(faults.end(), {Fault::NullSilently, Fault::GoodWithError});
  }
  const bool isObject =
      data.type == CMPI_string || data.type == CMPI_ref || data.type == CMPI_instance || CMIsArray(data);
  const bool hasObject = isObject && data.value.dataPtr.ptr;
  if (hasObject) {
    faults.insert(faults.end(), {Fault::WithoutHandle, Fault::NullPointer});
  }
  const std::pair<CMPIType, Fault> others[] = {
      {CMPI_string, Fault::Text}, {CMPI_ref, Fault::Reference}, {CMPI_instance, Fault::Instance}};
  for (const auto& [type, fault] : others) {
    if (data.type != type) {
      faults.push_back(fault);
    }
  }
  if (!CMIsArray(data)) {
    faults.push_back(Fault::Array);
  }
  return faults;
}

CMPIData spoiled(CMPIData data, CMPIStatus* status, const Call& call) {
  switch (call.fault) {
    case Fault::NullWithError:
      setCode(status, injected);
      return {CMPI_null, CMPI_nullValue, {}};
    case Fault::NullSilently:
      setCode(status, CMPI_RC_OK);
      return {CMPI_null, CMPI_nullValue, {}};
    case Fault::NotFound:
      setCode(status, CMPI_RC_ERR_NO_SUCH_PROPERTY);
      return {CMPI_null, CMPI_notFound, {}};
    case Fault::GoodWithError:
      setCode(status, injected);
      return data;
    case Fault::NullState:
      data.state = static_cast<CMPIValueState>(data.state | CMPI_nullValue);
      return data;
    case Fault::BadState:
      data.state = static_cast<CMPIValueState>(data.state | CMPI_badValue);
      return data;
    case Fault::WithoutHandle:
      data.value = objectWithoutHandleFor(data.type);
      return data;
    case Fault::NullPointer:
      data.value = {};
      return data;
    case Fault::Number:
      data = {CMPI_uint64, CMPI_goodValue, {}};
      data.value.uint64 = 4097;  // no address
      return data;
    case Fault::Text:
      data = {CMPI_string, CMPI_goodValue, {}};
      data.value.string = another(Cimom::Text{"BMC:text"}, call);
      return data;
    case Fault::Reference:
      data = {CMPI_ref, CMPI_goodValue, {}};
      data.value.ref = another(Cimom::ObjectPath{"", "root/yrnse", "YRNQV_IPProtocolEndpoint", {}}, call);
      return data;
    case Fault::Instance: {
      static const Cimom::ClassDefinition definition = [] {
        Cimom::ClassDefinition bare;
        bare.name = "YRNQV_Another";
        return bare;
      }();
      data = {CMPI_instance, CMPI_goodValue, {}};
      data.value.inst =
          another(Cimom::Instance(definition, Cimom::ObjectPath{"", "root/yrnse", definition.name, {}}), call);
      return data;
    }
    case Fault::Characters: {
      static char characters[] = "BMC:characters";
      const bool isText = data.type == CMPI_string && !CMIsNullValue(data);
      const char* own = isText ? static_cast<const char*>(data.value.string->hdl) : characters;
      data = {CMPI_chars, CMPI_goodValue, {}};
      data.value.chars = const_cast<char*>(own);
      return data;
    }
    case Fault::Array:
      data = {CMPI_uint16A, CMPI_goodValue, {}};
      data.value.array = another(Cimom::Array{CMPI_uint16, {}}, call);
      return data;
    default:
      return data;
  }
}

}  // namespace Testing
