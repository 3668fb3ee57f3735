// SPDX-License-Identifier: Apache-2.0
#include "tests/faults/model/Model.h"

#include "tests/faults/model/Operations.h"

namespace Testing::Model {

namespace {

constexpr const char* operationNames[] = {"EnumInstanceNames", "EnumInstances",   "GetInstance", "ModifyInstance",
                                          "CreateInstance",    "DeleteInstance",  "ExecQuery",   "Cleanup",
                                          "Associators",       "AssociatorNames", "References",  "ReferenceNames",
                                          "AssociationCleanup"};

}  // namespace

std::string nameOf(Operation operation) { return operationNames[static_cast<int>(operation)]; }

CMPIStatus answer(const Request& request) {
  constexpr CMPIStatus ok = {CMPI_RC_OK, nullptr};
  constexpr CMPIStatus notSupported = {CMPI_RC_ERR_NOT_SUPPORTED, nullptr};
  switch (request.operation) {
    case Operation::EnumInstanceNames:
    case Operation::EnumInstances:
    case Operation::GetInstance:
      return request.servesAssociation ? readAssociations(request) : readInstances(request);
    case Operation::ModifyInstance:
      return request.acceptsModify ? changeInstance(request) : notSupported;
    case Operation::Associators:
    case Operation::AssociatorNames:
    case Operation::References:
    case Operation::ReferenceNames:
      return navigate(request);
    case Operation::Cleanup:
    case Operation::AssociationCleanup:
      return ok;
    default:
      return notSupported;
  }
}

}  // namespace Testing::Model
