// SPDX-License-Identifier: Apache-2.0
// CIM values as text in CIM-XML (DSP0201, 5.2.3: VALUE).
#pragma once

#include <cmpidt.h>

#include <optional>
#include <string>
#include <string_view>

#include "cimom/model/Value.h"

namespace Cimom::CimXml {

// The VALUETYPE of a key of that type: "string", "boolean" or "numeric".
const char* keyValueType(CMPIType type);

// A boolean, character or number from its text; integers may be decimal, or hexadecimal after 0x, as DSP0201 allows.
// Nothing when the text is none of that type or the value does not fit.
std::optional<CMPIValue> parseScalar(CMPIType type, std::string_view text);

// The same way back, and date-times too; empty for a value that is none of these.
std::string formatScalar(const Cimom::Value& value);

}  // namespace Cimom::CimXml
