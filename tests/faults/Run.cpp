// SPDX-License-Identifier: Apache-2.0
#include "tests/faults/Run.h"

#include <exception>

#include "cimom/broker/Handle.h"
#include "cimom/broker/RequestScope.h"
#include "tests/faults/Agent.h"
#include "tests/faults/Allocations.h"
#include "tests/faults/Interposed.h"
#include "tests/faults/Recording.h"
#include "tests/faults/World.h"
#include "tests/faults/model/Model.h"

namespace Testing {

namespace {

// The request's own objects, for the time of a run.
struct Objects {
  Cimom::RequestScope scope{world().broker()};
  CMPIObjectPath* path;
  CMPIInstance* instance = nullptr;
  CMPIContext* context = scope.context();
  std::vector<const char*> properties;

  explicit Objects(const Request& request)
      : path(Cimom::make(request.path)), properties(request.properties.value_or(std::vector<const char*>{})) {
    interpose(path);
    interpose(context);
    calls().know(path, "the request's path");
    calls().know(context, "the context");
    calls().know(world().result(), "the result");
    calls().know(world().broker(), "the broker");
    if (request.operation == Operation::ModifyInstance && request.hasInstance) {
      instance = world().change(request);
      calls().know(instance, "the client's instance");
    }
  }

  const char** list() { return properties.empty() ? nullptr : properties.data(); }
};

CMPIStatus callProduct(const Request& request, Objects& objects) {
  CMPIInstanceMI* mi = world().instanceMi(*request.unit);
  CMPIAssociationMI* ami = world().associationMi(*request.unit);
  const CMPIResult* result = world().result();
  switch (request.operation) {
    case Operation::EnumInstanceNames:
      return mi->ft->enumerateInstanceNames(mi, objects.context, result, objects.path);
    case Operation::EnumInstances:
      return mi->ft->enumerateInstances(mi, objects.context, result, objects.path, objects.list());
    case Operation::GetInstance:
      return mi->ft->getInstance(mi, objects.context, result, objects.path, objects.list());
    case Operation::ModifyInstance:
      return mi->ft->modifyInstance(mi, objects.context, result, objects.path, objects.instance, objects.list());
    case Operation::CreateInstance:
      return mi->ft->createInstance(mi, objects.context, result, objects.path, objects.instance);
    case Operation::DeleteInstance:
      return mi->ft->deleteInstance(mi, objects.context, result, objects.path);
    case Operation::ExecQuery:
      return mi->ft->execQuery(mi, objects.context, result, objects.path, "SELECT * FROM X", "WQL");
    case Operation::Cleanup:
      return mi->ft->cleanup(mi, objects.context, 1);
    case Operation::Associators:
      return ami->ft->associators(ami, objects.context, result, objects.path, request.associationClass,
                                  request.resultClass, request.role, request.resultRole, objects.list());
    case Operation::AssociatorNames:
      return ami->ft->associatorNames(ami, objects.context, result, objects.path, request.associationClass,
                                      request.resultClass, request.role, request.resultRole);
    case Operation::References:
      return ami->ft->references(ami, objects.context, result, objects.path, request.resultClass, request.role,
                                 objects.list());
    case Operation::ReferenceNames:
      return ami->ft->referenceNames(ami, objects.context, result, objects.path, request.resultClass, request.role);
    case Operation::AssociationCleanup:
      return ami->ft->cleanup(ami, objects.context, 1);
  }
  return {CMPI_RC_ERR_FAILED, nullptr};
}

CMPIStatus call(Who who, const Request& request, Objects& objects) {
  if (who == Who::Product) {
    const CountedAllocations ofTheLibrary;
    return callProduct(request, objects);
  }
  const Unit& unit = *request.unit;
  return Model::answer({unit.className, unit.component, unit.file, unit.prefix, unit.createAssociationMI != nullptr,
                        unit.acceptsModify, request.operation, world().broker(), objects.context, world().result(),
                        objects.path, objects.instance, objects.list(), request.associationClass});
}

std::string shown(const CMPIStatus& status) {
  const char* message = status.msg && status.msg->hdl ? static_cast<const char*>(status.msg->hdl) : nullptr;
  return std::to_string(status.rc) + (message ? std::string(" \"") + message + '"' : "");
}

RunResult carryOut(Who who, const Request& request) {
  RunResult result;
  recording() = {&result.outcome};
  agent() = {request.nodes, &result.outcome};
  Objects objects(request);
  const long before = libraryBlocks();
  try {
    result.outcome.status = shown(call(who, request, objects));
  } catch (const std::exception& exception) {
    result.outcome.status = std::string("throws ") + exception.what();
  } catch (int) {
    result.outcome.status = "throws an int";
  }
  result.leaked = libraryBlocks() - before;
  result.fired = calls().fired();
  result.violations = calls().violations();
  return result;
}

}  // namespace

RunResult run(Who who, const Request& request, CallKey key, Fault fault) {
  world();
  calls().begin(key, fault);
  return carryOut(who, request);
}

std::vector<RecordedCall> record(Who who, const Request& request, RunResult* result) {
  world();
  calls().beginRecording();
  RunResult made = carryOut(who, request);
  if (result) {
    *result = std::move(made);
  }
  return calls().recorded();
}

}  // namespace Testing
