// SPDX-License-Identifier: Apache-2.0
#pragma once

#include <cmpift.h>

#include <string>

#include "cimom/broker/RequestScope.h"
#include "cimom/cimxml/OpenEnumerations.h"
#include "cimom/cimxml/Request.h"
#include "cimom/cimxml/XmlWriter.h"
#include "cimom/schema/ClassRepository.h"

namespace Cimom::CimXml {

// What an operation works with.
struct OperationContext {
  const CMPIBroker* broker;
  const ClassRepository& classes;
  const std::string& host;  // stands in a path that names none
  OpenEnumerations& openEnumerations;
  const std::string& user;  // who has authenticated; empty if nobody was asked
  Deadline deadline = {};   // after which up-calls of providers fail
};

// Performs a request's operation (DSP0200, 5.3), or calls the method that it names, and writes what that returns as the
// content of IMETHODRESPONSE or METHODRESPONSE. All
// instances are the broker's: only class operations are answered from the class repository. Throws OperationError;
// what was written is then of no use. An operation that is not offered is CIM_ERR_NOT_SUPPORTED.
void perform(const OperationContext& context, const Request& request, XmlWriter& xml);

}  // namespace Cimom::CimXml
