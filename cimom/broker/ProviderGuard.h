#ifndef CIMOM_BROKER_PROVIDERGUARD_H_
#define CIMOM_BROKER_PROVIDERGUARD_H_

#include <exception>
#include <string>

#include "cimom/broker/Handle.h"

namespace Cimom {

/// Runs a provider's function and turns both its status and what it throws into a StatusError: a provider's failure
/// ends its request, never the object manager.
template <class Call>
void runProvider(const std::string& what, Call call) {
  CMPIStatus status = {CMPI_RC_OK, nullptr};
  try {
    status = call();
  } catch (const std::exception& error) {
    throw StatusError(CMPI_RC_ERR_FAILED, what + " threw an exception: " + error.what());
  } catch (...) {
    throw StatusError(CMPI_RC_ERR_FAILED, what + " threw an exception of an unknown type");
  }
  if (status.rc != CMPI_RC_OK) {
    throw StatusError(status.rc, status.msg && status.msg->hdl ? textOf(status.msg) : "");
  }
}

}  // namespace Cimom

#endif  // CIMOM_BROKER_PROVIDERGUARD_H_
