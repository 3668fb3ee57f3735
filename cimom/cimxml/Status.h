#ifndef CIMOM_CIMXML_STATUS_H_
#define CIMOM_CIMXML_STATUS_H_

#include <cmpidt.h>
#include <cmpimacs.h>

#include "cimom/cimxml/Errors.h"

namespace Cimom::CimXml {

/// Turns a CMPI status that is not OK into an OperationError. Return codes that are CMPI's own and no CIM status
/// (CMPI_RC_ERROR_SYSTEM and the like) become CIM_ERR_FAILED.
inline void requireOk(const CMPIStatus& status) {
  if (status.rc == CMPI_RC_OK) return;
  const char* text = status.msg ? CMGetCharsPtr(status.msg, nullptr) : nullptr;
  const bool isCimStatus = status.rc <= CMPI_RC_ERR_METHOD_NOT_FOUND;
  const int code = isCimStatus ? static_cast<int>(status.rc) : static_cast<int>(CMPI_RC_ERR_FAILED);
  throw OperationError(code, text ? text : "the operation failed with return code " + std::to_string(status.rc));
}

/// The same, and the object must be there.
inline void requireOk(const CMPIStatus& status, const void* object) {
  requireOk(status);
  if (!object) throw OperationError(CMPI_RC_ERR_FAILED, "the operation succeeded and gave nothing");
}

}  // namespace Cimom::CimXml

#endif  // CIMOM_CIMXML_STATUS_H_
