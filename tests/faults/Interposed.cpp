// SPDX-License-Identifier: Apache-2.0
#include "tests/faults/Interposed.h"

#include <type_traits>
#include <utility>

#include "cimom/broker/RequestScope.h"
#include "tests/faults/Allocations.h"
#include "tests/faults/Answers.h"
#include "tests/support/broker/PersonalObjects.h"
#include "tests/support/broker/Personality.h"

namespace Testing {

namespace {

// The last argument, where it is a status to be set.
CMPIStatus* statusOf() { return nullptr; }
template <typename First, typename... Rest>
CMPIStatus* statusOf(First first, Rest... rest) {
  if constexpr (sizeof...(rest) > 0) {
    return statusOf(rest...);
  } else if constexpr (std::is_same_v<First, CMPIStatus*>) {
    return first;
  } else {
    return nullptr;
  }
}

void adoptNames(const Call&) {}
template <typename First, typename... Rest>
void adoptNames(const Call& call, First first, Rest... rest) {
  if constexpr (std::is_same_v<First, CMPIString**>) {
    if (first) {
      adopted(*first, call);
    }
  }
  adoptNames(call, rest...);
}

template <typename Object>
bool lacksHandle(const Object* object) {
  return !object || !object->hdl;
}

template <auto slot>
const char* slotName = "";

template <auto slot, typename Table, typename Function>
struct Slot;

template <auto slot, typename Table, typename Result, typename Self, typename... Arguments>
struct Slot<slot, Table, Result (*)(Self*, Arguments...)> {
  static Result call(Self* self, Arguments... arguments) {
    const CountedAllocations notTheLibrarys(false);
    const Call entered = calls().meet(slotName<slot>, static_cast<const Self*>(self), arguments...);
    if (lacksHandle(self)) {
      calls().violation(std::string(slotName<slot>) + " is called on an object without a handle");
    }
    return answer(
        entered, statusOf(arguments...),
        [&] {
          const Result result = (original<Table>.*slot)(self, arguments...);
          adoptNames(entered, arguments...);
          return result;
        },
        static_cast<const Result*>(nullptr));
  }
};

// Nothing that the broker made is released by the library, and nothing is cloned.
template <typename Object>
CMPIStatus released(Object*) {
  calls().violation("an object of the broker is released");
  return {CMPI_RC_OK, nullptr};
}
template <typename Object>
Object* cloned(const Object*, CMPIStatus* status) {
  calls().violation("an object of the broker is cloned, and nothing would release it");
  setCode(status, CMPI_RC_OK);
  return nullptr;
}

template <auto slot, typename Table, typename Function>
void place(const char* name, Function Table::*) {
  if (original<Table>.*slot) {
    slotName<slot> = name;
    interposed<Table>.*slot = Slot<slot, Table, Function>::call;
  }
}

#define INTERPOSE(TABLE, SLOT) place<&TABLE::SLOT, TABLE>(#SLOT, &TABLE::SLOT)

template <typename Object>
void takeTable(const TableOf<Object>& table) {
  using Table = TableOf<Object>;
  original<Table> = table;
  interposed<Table> = table;
  interposed<Table>.release = released<Object>;
  interposed<Table>.clone = cloned<Object>;
}

decltype(Behind::filtered) announceFilter = nullptr;
decltype(CMPIInstanceFT::setPropertyFilter) realFilter = nullptr;

CMPIStatus announcedFilter(CMPIInstance* instance, const char** properties, const char** keys) {
  announceFilter(instance, properties, keys);
  return realFilter(instance, properties, keys);
}

void interposeStrings() {
  takeTable<CMPIString>(*personal(Cimom::make(Cimom::Text{std::string()}))->ft);
  INTERPOSE(CMPIStringFT, getCharPtr);
}

void interposePaths() {
  takeTable<CMPIObjectPath>(*personal(Cimom::make(Cimom::ObjectPath{}))->ft);
  INTERPOSE(CMPIObjectPathFT, setNameSpace);
  INTERPOSE(CMPIObjectPathFT, getNameSpace);
  INTERPOSE(CMPIObjectPathFT, setHostname);
  INTERPOSE(CMPIObjectPathFT, getHostname);
  INTERPOSE(CMPIObjectPathFT, setClassName);
  INTERPOSE(CMPIObjectPathFT, getClassName);
  INTERPOSE(CMPIObjectPathFT, addKey);
  INTERPOSE(CMPIObjectPathFT, getKey);
  INTERPOSE(CMPIObjectPathFT, getKeyAt);
  INTERPOSE(CMPIObjectPathFT, getKeyCount);
  INTERPOSE(CMPIObjectPathFT, setNameSpaceFromObjectPath);
  INTERPOSE(CMPIObjectPathFT, setHostAndNameSpaceFromObjectPath);
  INTERPOSE(CMPIObjectPathFT, getClassQualifier);
  INTERPOSE(CMPIObjectPathFT, getPropertyQualifier);
  INTERPOSE(CMPIObjectPathFT, getMethodQualifier);
  INTERPOSE(CMPIObjectPathFT, getParameterQualifier);
  INTERPOSE(CMPIObjectPathFT, toString);
}

void interposeInstances(decltype(Behind::filtered) filtered) {
  const Cimom::ClassDefinition definition;
  takeTable<CMPIInstance>(*personal(Cimom::make(Cimom::Instance(definition, Cimom::ObjectPath{})))->ft);
  announceFilter = filtered;
  realFilter = std::exchange(original<CMPIInstanceFT>.setPropertyFilter, announcedFilter);
  INTERPOSE(CMPIInstanceFT, getProperty);
  INTERPOSE(CMPIInstanceFT, getPropertyAt);
  INTERPOSE(CMPIInstanceFT, getPropertyCount);
  INTERPOSE(CMPIInstanceFT, setProperty);
  INTERPOSE(CMPIInstanceFT, getObjectPath);
  INTERPOSE(CMPIInstanceFT, setPropertyFilter);
  INTERPOSE(CMPIInstanceFT, setObjectPath);
  INTERPOSE(CMPIInstanceFT, setPropertyWithOrigin);
}

// Some object managers leave a state on the items that says nothing.
CMPIData personalNext(const CMPIEnumeration* enumeration, CMPIStatus* status) {
  CMPIData item = Cimom::Abi<Cimom::Enumeration>::table.getNext(enumeration, status);
  if (item.type == CMPI_instance) {
    item.state = personality().itemState;
  }
  return item;
}

void interposeCollections() {
  takeTable<CMPIArray>(Cimom::Abi<Cimom::Array>::table);
  INTERPOSE(CMPIArrayFT, getSize);
  INTERPOSE(CMPIArrayFT, getSimpleType);
  INTERPOSE(CMPIArrayFT, getElementAt);
  INTERPOSE(CMPIArrayFT, setElementAt);
  takeTable<CMPIEnumeration>(Cimom::Abi<Cimom::Enumeration>::table);
  original<CMPIEnumerationFT>.getNext = personalNext;
  INTERPOSE(CMPIEnumerationFT, getNext);
  INTERPOSE(CMPIEnumerationFT, hasNext);
  INTERPOSE(CMPIEnumerationFT, toArray);
  takeTable<CMPIArgs>(Cimom::Abi<Cimom::Args>::table);
  INTERPOSE(CMPIArgsFT, addArg);
  INTERPOSE(CMPIArgsFT, getArg);
  INTERPOSE(CMPIArgsFT, getArgAt);
  INTERPOSE(CMPIArgsFT, getArgCount);
  takeTable<CMPIContext>(Cimom::Abi<Cimom::Context>::table);
  INTERPOSE(CMPIContextFT, getEntry);
  INTERPOSE(CMPIContextFT, getEntryAt);
  INTERPOSE(CMPIContextFT, getEntryCount);
  INTERPOSE(CMPIContextFT, addEntry);
  takeTable<CMPIDateTime>(Cimom::Abi<Cimom::DateTime>::table);
  INTERPOSE(CMPIDateTimeFT, getBinaryFormat);
  INTERPOSE(CMPIDateTimeFT, getStringFormat);
  INTERPOSE(CMPIDateTimeFT, isInterval);
}

void interposeUpCalls(decltype(Behind::enumerateInstances) enumerateInstances) {
  original<CMPIBrokerFT>.enumerateInstances = enumerateInstances;
  INTERPOSE(CMPIBrokerFT, enumerateInstanceNames);
  INTERPOSE(CMPIBrokerFT, getInstance);
  INTERPOSE(CMPIBrokerFT, createInstance);
  INTERPOSE(CMPIBrokerFT, modifyInstance);
  INTERPOSE(CMPIBrokerFT, deleteInstance);
  INTERPOSE(CMPIBrokerFT, execQuery);
  INTERPOSE(CMPIBrokerFT, enumerateInstances);
  INTERPOSE(CMPIBrokerFT, associators);
  INTERPOSE(CMPIBrokerFT, associatorNames);
  INTERPOSE(CMPIBrokerFT, references);
  INTERPOSE(CMPIBrokerFT, referenceNames);
  INTERPOSE(CMPIBrokerFT, invokeMethod);
  INTERPOSE(CMPIBrokerFT, setProperty);
  INTERPOSE(CMPIBrokerFT, getProperty);
  INTERPOSE(CMPIBrokerFT, prepareAttachThread);
  INTERPOSE(CMPIBrokerFT, attachThread);
  INTERPOSE(CMPIBrokerFT, detachThread);
}

void interposeMakers() {
  INTERPOSE(CMPIBrokerEncFT, newInstance);
  INTERPOSE(CMPIBrokerEncFT, newObjectPath);
  INTERPOSE(CMPIBrokerEncFT, newArgs);
  INTERPOSE(CMPIBrokerEncFT, newString);
  INTERPOSE(CMPIBrokerEncFT, newArray);
  INTERPOSE(CMPIBrokerEncFT, newDateTime);
  INTERPOSE(CMPIBrokerEncFT, newDateTimeFromBinary);
  INTERPOSE(CMPIBrokerEncFT, newDateTimeFromChars);
  INTERPOSE(CMPIBrokerEncFT, classPathIsA);
  INTERPOSE(CMPIBrokerEncFT, toString);
  INTERPOSE(CMPIBrokerEncFT, isOfType);
  INTERPOSE(CMPIBrokerEncFT, getType);
  INTERPOSE(CMPIBrokerEncFT, logMessage);
  INTERPOSE(CMPIBrokerEncFT, trace);
}

}  // namespace

#define INTERPOSE_OBJECTS(OBJECT)           \
  void interpose(OBJECT* object) {          \
    if (object) {                           \
      object->ft = &interposed<OBJECT##FT>; \
    }                                       \
  }
INTERPOSE_OBJECTS(CMPIString)
INTERPOSE_OBJECTS(CMPIObjectPath)
INTERPOSE_OBJECTS(CMPIInstance)
INTERPOSE_OBJECTS(CMPIArray)
INTERPOSE_OBJECTS(CMPIEnumeration)
INTERPOSE_OBJECTS(CMPIArgs)
INTERPOSE_OBJECTS(CMPIDateTime)
INTERPOSE_OBJECTS(CMPIContext)

void interpose(CMPIResult* object) {
  takeTable<CMPIResult>(*object->ft);
  INTERPOSE(CMPIResultFT, returnData);
  INTERPOSE(CMPIResultFT, returnInstance);
  INTERPOSE(CMPIResultFT, returnObjectPath);
  INTERPOSE(CMPIResultFT, returnDone);
  INTERPOSE(CMPIResultFT, returnError);
  object->ft = &interposed<CMPIResultFT>;
}

void interpose(CMPIError*) {}

const CMPIBroker* interposedBroker(const CMPIBroker* real, const Behind& behind) {
  const Cimom::RequestScope scope(real);
  interposeStrings();
  interposePaths();
  interposeInstances(behind.filtered);
  interposeCollections();
  original<CMPIBrokerFT> = *real->bft;
  interposed<CMPIBrokerFT> = *real->bft;
  interposeUpCalls(behind.enumerateInstances);
  original<CMPIBrokerEncFT> = *real->eft;
  original<CMPIBrokerEncFT>.trace = behind.trace;
  interposed<CMPIBrokerEncFT> = *real->eft;
  interposeMakers();
  static CMPIBroker broker;
  broker = *real;
  broker.bft = &interposed<CMPIBrokerFT>;
  broker.eft = &interposed<CMPIBrokerEncFT>;
  return &broker;
}

}  // namespace Testing
