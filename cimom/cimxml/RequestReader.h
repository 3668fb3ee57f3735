/// Reads a CIM-XML request message (DSP0201 2.x, CIM/MESSAGE/SIMPLEREQ).
#ifndef CIMOM_CIMXML_REQUESTREADER_H_
#define CIMOM_CIMXML_REQUESTREADER_H_

#include <string_view>

#include "cimom/cimxml/Request.h"

namespace Cimom::CimXml {

/// Takes the body as it came. Throws TransportError: request-not-well-formed, request-not-valid,
/// multiple-requests-unsupported, unsupported-cim-version, unsupported-dtd-version or unsupported-protocol-version.
Request readRequest(std::string_view xml);

}  // namespace Cimom::CimXml

#endif  // CIMOM_CIMXML_REQUESTREADER_H_
