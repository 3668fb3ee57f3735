// SPDX-License-Identifier: Apache-2.0
// Values as they pass the binary interface.
#pragma once

#include <cmpidt.h>

#include "cimom/model/Value.h"

namespace Cimom {

// Takes what a provider passes: `value` as CMPI lays it down for `type` (for CMPI_chars the pointer is the C string
// itself). A null pointer, or a null object in it, is a null value. Characters become a CMPI_string.
// Throws StatusError CMPI_RC_ERR_INVALID_DATA_TYPE for a type that no CIM value has, CMPI_RC_ERR_TYPE_MISMATCH for an
// array of other elements than `type` says.
Value fromCmpi(const CMPIValue* value, CMPIType type);

// The value as CMPI data; objects in it are made in the current request scope.
CMPIData toCmpi(const Value& value, CMPIValueState state = CMPI_goodValue);

}  // namespace Cimom
