// SPDX-License-Identifier: Apache-2.0
#include <QV/ProviderHelper.h>
#include <cmpimacs.h>

#include "agent/helper/Conversion.h"

namespace QV {
namespace {

// The datum under the wanted type, as setProperty takes it: CMPI_chars is itself the pointer, all else is pointed at.
CMPIStatus set(CMPIInstance* target, const char* name, DataType type, const CMPIData& data) {
  if (type == String) {
    const char* text = textOf(data);
    return text ? CMSetProperty(target, name, text, CMPI_chars) : CMPIStatus{CMPI_RC_ERR_TYPE_MISMATCH, nullptr};
  }
  CMPIValue value{};
  const auto integer = integerOf(data);
  if (type == Uint16 && integer && integer->fits<CMPIUint16>()) {
    value.uint16 = static_cast<CMPIUint16>(integer->bits);
    return CMSetProperty(target, name, &value, CMPI_uint16);
  }
  if (type == Uint8 && integer && integer->fits<CMPIUint8>()) {
    value.uint8 = static_cast<CMPIUint8>(integer->bits);
    return CMSetProperty(target, name, &value, CMPI_uint8);
  }
  return {CMPI_RC_ERR_TYPE_MISMATCH, nullptr};
}

}  // namespace

void mapProperty(CMPIData source, CMPIInstance* target, const char* name, DataType type, CMPIStatus* status) {
  // The type and the pointer tell whether there is an instance. The state does not: OpenPegasus leaves it null on every
  // item of an enumeration.
  if (source.type != CMPI_instance || CMIsNullObject(source.value.inst)) {
    return;
  }
  if (CMIsNullObject(target) || !name) {
    return;
  }
  CMPIStatus outcome{CMPI_RC_OK, nullptr};
  const CMPIData data = CMGetProperty(source.value.inst, name, &outcome);
  if (outcome.rc == CMPI_RC_OK && hasValue(data)) {
    outcome = set(target, name, type, data);
  }
  if (status) {
    *status = outcome;
  }
}

}  // namespace QV
