// SPDX-License-Identifier: Apache-2.0
#include <cstdlib>
#include <cstring>

#include "cimom/broker/BrokerCore.h"
#include "cimom/broker/Guard.h"

namespace Cimom {
namespace {

CMPIGcStat* mark(const CMPIBroker* broker, CMPIStatus* status) {
  return guarded(status, static_cast<CMPIGcStat*>(nullptr), [&]() -> CMPIGcStat* {
    coreOf(broker);
    return RequestScope::open(broker);
  });
}

CMPIStatus releaseMark(const CMPIBroker* broker, const CMPIGcStat* marked) {
  return guarded([&] {
    coreOf(broker);
    if (!marked || !RequestScope::close(static_cast<const RequestScope*>(marked))) {
      throw StatusError(CMPI_RC_ERR_INVALID_HANDLE, "not a mark of this thread");
    }
  });
}

void* cmpiMalloc(const CMPIBroker*, size_t size) { return std::malloc(size); }

void* cmpiCalloc(const CMPIBroker*, size_t count, size_t size) { return std::calloc(count, size); }

void* cmpiRealloc(const CMPIBroker*, void* memory, size_t size) { return std::realloc(memory, size); }

char* cmpiStrDup(const CMPIBroker*, const char* text) { return text ? ::strdup(text) : nullptr; }

void cmpiFree(const CMPIBroker*, void* memory) { std::free(memory); }

template <typename Model>
void freeObject(const CMPIBroker*, typename Abi<Model>::Type* object) {
  release<Model>(object);
}

// There is nothing to free: this broker makes no select expressions.
void freeSelectExp(const CMPIBroker*, CMPISelectExp*) {}

}  // namespace

CMPIBrokerMemFT memoryTable = {
    .ftVersion = CMPICurrentVersion,
    .mark = mark,
    .release = releaseMark,
    .cmpiMalloc = cmpiMalloc,
    .cmpiCalloc = cmpiCalloc,
    .cmpiRealloc = cmpiRealloc,
    .cmpiStrDup = cmpiStrDup,
    .cmpiFree = cmpiFree,
    .freeInstance = freeObject<Instance>,
    .freeObjectPath = freeObject<ObjectPath>,
    .freeArgs = freeObject<Args>,
    .freeString = freeObject<Text>,
    .freeArray = freeObject<Array>,
    .freeDateTime = freeObject<DateTime>,
    .freeSelectExp = freeSelectExp,
};

}  // namespace Cimom
