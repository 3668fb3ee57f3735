/// CIM's data types: their names in CIM-XML, and their values as text (DSP0201, 5.2.3: VALUE).
#ifndef CIMOM_CIMXML_TYPES_H_
#define CIMOM_CIMXML_TYPES_H_

#include <cmpidt.h>

#include <optional>
#include <string>
#include <string_view>

namespace Cimom::CimXml {

/// "uint16", "string", "reference" … of a type; an array type has the name of its elements. Types that CIM-XML does not
/// know (arguments, enumerations …) have none.
const char* typeName(CMPIType type);

/// The type of that name (exact, as in the DTD), or nothing.
std::optional<CMPIType> typeOf(std::string_view name);

/// The VALUETYPE of a key of that type: "string", "boolean" or "numeric".
const char* keyValueType(CMPIType type);

/// A boolean, character or number from its text; integers may be decimal, or hexadecimal after 0x, as DSP0201 allows.
/// Nothing when the text is none of that type or the value does not fit.
std::optional<CMPIValue> parseScalar(CMPIType type, std::string_view text);

/// The same way back, and strings and date-times too. A null string is the empty text.
std::string formatScalar(CMPIType type, const CMPIValue& value);

}  // namespace Cimom::CimXml

#endif  // CIMOM_CIMXML_TYPES_H_
