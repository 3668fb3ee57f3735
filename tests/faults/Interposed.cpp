// SPDX-License-Identifier: Apache-2.0
#include "tests/faults/Interposed.h"

#include <cmpimacs.h>

#include <cstddef>
#include <type_traits>
#include <utility>

#include "cimom/broker/BrokerCore.h"
#include "tests/faults/Allocations.h"
#include "tests/faults/Calls.h"

namespace Testing {

namespace {

using Call = Calls::Call;

constexpr CMPIrc injected = CMPI_RC_ERR_ACCESS_DENIED;  // a code that the library does not set itself

// The tables as the object manager has them, and those that stand in front.
template <typename Table>
Table original = {};
template <typename Table>
Table interposed = {};

void set(CMPIStatus* status, CMPIrc code) {
  if (status) {
    *status = {code, nullptr};
  }
}

template <typename Object>
using TableOf = std::remove_pointer_t<decltype(Object::ft)>;

// Objects

template <typename Object>
Object* adopted(Object* object, const Call& call) {
  if (object) {
    interpose(object);
    calls().adopt(object, call);
  }
  return object;
}

template <typename Object>
Object* objectWithoutHandle() {
  static Object object = {nullptr, &interposed<TableOf<Object>>};
  return &object;
}

void adoptValue(const CMPIData& data, const Call& call) {
  if (CMIsNullValue(data)) {
    return;
  }
  switch (data.type) {
    case CMPI_string:
      adopted(data.value.string, call);
      break;
    case CMPI_ref:
      adopted(data.value.ref, call);
      break;
    case CMPI_instance:
      adopted(data.value.inst, call);
      break;
    case CMPI_dateTime:
      adopted(data.value.dateTime, call);
      break;
    default:
      if (CMIsArray(data)) {
        adopted(data.value.array, call);
      }
      break;
  }
}

// Which faults a value can have that the call really answered.
Faults faultsOf(const CMPIData& data, bool tellsStatus) {
  Faults faults = {Fault::NullWithError, Fault::NullState, Fault::BadState,
                   Fault::NotFound,      Fault::Number,    Fault::Characters};
  if (tellsStatus) {
    faults.insert(faults.end(), {Fault::NullSilently, Fault::GoodWithError});
  }
  const bool hasObject = !CMIsNullValue(data) && (data.type == CMPI_string || data.type == CMPI_ref ||
                                                  data.type == CMPI_instance || CMIsArray(data));
  if (hasObject) {
    faults.insert(faults.end(), {Fault::WithoutHandle, Fault::NullPointer});
  }
  const std::pair<CMPIType, Fault> others[] = {
      {CMPI_string, Fault::Text}, {CMPI_ref, Fault::Reference}, {CMPI_instance, Fault::Instance}};
  for (const auto& [type, fault] : others) {
    if (data.type != type) {
      faults.push_back(fault);
    }
  }
  if (!CMIsArray(data)) {
    faults.push_back(Fault::Array);
  }
  return faults;
}

CMPIValue objectWithoutHandleFor(CMPIType type) {
  CMPIValue value = {};
  switch (type) {
    case CMPI_string:
      value.string = objectWithoutHandle<CMPIString>();
      break;
    case CMPI_ref:
      value.ref = objectWithoutHandle<CMPIObjectPath>();
      break;
    case CMPI_instance:
      value.inst = objectWithoutHandle<CMPIInstance>();
      break;
    default:
      value.array = objectWithoutHandle<CMPIArray>();
      break;
  }
  return value;
}

template <typename Model>
auto* another(Model model, const Call& call) {
  return adopted(Cimom::make(std::move(model)), call);
}

CMPIData spoiled(CMPIData data, CMPIStatus* status, const Call& call) {
  switch (call.fault) {
    case Fault::NullWithError:
      set(status, injected);
      return {CMPI_null, CMPI_nullValue, {}};
    case Fault::NullSilently:
      set(status, CMPI_RC_OK);
      return {CMPI_null, CMPI_nullValue, {}};
    case Fault::NotFound:
      set(status, CMPI_RC_ERR_NO_SUCH_PROPERTY);
      return {CMPI_null, CMPI_notFound, {}};
    case Fault::GoodWithError:
      set(status, injected);
      return data;
    case Fault::NullState:
      data.state = static_cast<CMPIValueState>(data.state | CMPI_nullValue);
      return data;
    case Fault::BadState:
      data.state = static_cast<CMPIValueState>(data.state | CMPI_badValue);
      return data;
    case Fault::WithoutHandle:
      data.value = objectWithoutHandleFor(data.type);
      return data;
    case Fault::NullPointer:
      data.value = {};
      return data;
    case Fault::Number:
      data = {CMPI_uint64, CMPI_goodValue, {}};
      data.value.uint64 = 4097;  // no address
      return data;
    case Fault::Text:
      data = {CMPI_string, CMPI_goodValue, {}};
      data.value.string = another(Cimom::Text{"BMC:text"}, call);
      return data;
    case Fault::Reference:
      data = {CMPI_ref, CMPI_goodValue, {}};
      data.value.ref = another(Cimom::ObjectPath{"", "root/yrnse", "YRNQV_IPProtocolEndpoint", {}}, call);
      return data;
    case Fault::Instance: {
      static const Cimom::ClassDefinition definition = [] {
        Cimom::ClassDefinition bare;
        bare.name = "YRNQV_Another";
        return bare;
      }();
      data = {CMPI_instance, CMPI_goodValue, {}};
      data.value.inst = another(Cimom::Instance(definition, {"", "root/yrnse", definition.name, {}}), call);
      return data;
    }
    case Fault::Characters: {
      static char characters[] = "BMC:characters";
      const bool isText = data.type == CMPI_string && !CMIsNullValue(data);
      const char* own = isText ? static_cast<const char*>(data.value.string->hdl) : characters;
      data = {CMPI_chars, CMPI_goodValue, {}};
      data.value.chars = const_cast<char*>(own);
      return data;
    }
    case Fault::Array:
      data = {CMPI_uint16A, CMPI_goodValue, {}};
      data.value.array = another(Cimom::Array{CMPI_uint16, {}}, call);
      return data;
    default:
      return data;
  }
}

// What a slot answers, by its type: the call is made unless the fault is that it is not.
template <typename Made>
CMPIData answer(const Call& call, CMPIStatus* status, Made make, const CMPIData*) {
  const CMPIData data = make();
  adoptValue(data, call);
  call.noteAndThrow(faultsOf(data, status));
  return spoiled(data, status, call);
}

template <typename Object, typename Made>
Object* answer(const Call& call, CMPIStatus* status, Made make, Object* const*) {
  Faults faults = {Fault::NullWithError, Fault::WithoutHandle};
  if (status) {
    faults.insert(faults.end(), {Fault::NullSilently, Fault::GoodWithError});
  }
  call.noteAndThrow(faults);
  switch (call.fault) {
    case Fault::NullWithError:
      set(status, injected);
      return nullptr;
    case Fault::NullSilently:
      set(status, CMPI_RC_OK);
      return nullptr;
    case Fault::WithoutHandle:
      set(status, CMPI_RC_OK);
      return objectWithoutHandle<Object>();
    default:
      break;
  }
  Object* object = adopted(make(), call);
  if (call.fault == Fault::GoodWithError) {
    set(status, injected);
  }
  return object;
}

template <typename Made>
const char* answer(const Call& call, CMPIStatus* status, Made make, const char* const*) {
  Faults faults = {Fault::NullWithError};
  if (status) {
    faults.insert(faults.end(), {Fault::NullSilently, Fault::GoodWithError});
  }
  call.noteAndThrow(faults);
  const char* characters = make();
  if (call.fault == Fault::NullWithError || call.fault == Fault::GoodWithError) {
    set(status, injected);
  }
  return call.fault == Fault::NullWithError || call.fault == Fault::NullSilently ? nullptr : characters;
}

template <typename Made>
CMPIStatus answer(const Call& call, CMPIStatus*, Made make, const CMPIStatus*) {
  call.noteAndThrow({Fault::FailsUndone, Fault::FailsDone, Fault::UndoneSilently});
  const bool done = call.fault != Fault::FailsUndone && call.fault != Fault::UndoneSilently;
  const CMPIStatus status = done ? make() : CMPIStatus{CMPI_RC_OK, nullptr};
  return call.fault == Fault::FailsUndone || call.fault == Fault::FailsDone ? CMPIStatus{injected, nullptr} : status;
}

// Numbers and yes or no: a null is 0.
template <typename Number, typename Made>
requires std::is_arithmetic_v<Number> Number answer(const Call& call, CMPIStatus* status, Made make, const Number*) {
  Faults faults = {Fault::NullWithError, Fault::OtherNumber};
  if (status) {
    faults.insert(faults.end(), {Fault::NullSilently, Fault::GoodWithError});
  }
  call.noteAndThrow(faults);
  const Number number = make();
  if (call.fault == Fault::NullWithError || call.fault == Fault::GoodWithError) {
    set(status, injected);
  }
  switch (call.fault) {
    case Fault::NullWithError:
    case Fault::NullSilently:
      return 0;
    case Fault::OtherNumber:
      return std::is_same_v<Number, CMPIBoolean> ? static_cast<Number>(!number) : static_cast<Number>(number + 1);
    default:
      return number;
  }
}

// What else a slot may answer is passed on.
template <typename Other, typename Made>
requires(!std::is_arithmetic_v<Other> && !std::is_same_v<Other, CMPIData> && !std::is_same_v<Other, CMPIStatus> &&
         !std::is_pointer_v<Other>) Other answer(const Call& call, CMPIStatus*, Made make, const Other*) {
  call.noteAndThrow({});
  return make();
}

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
  set(status, CMPI_RC_OK);
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

Filtered announceFilter = nullptr;
decltype(CMPIInstanceFT::setPropertyFilter) realFilter = nullptr;

CMPIStatus announcedFilter(CMPIInstance* instance, const char** properties, const char** keys) {
  announceFilter(instance, properties, keys);
  return realFilter(instance, properties, keys);
}

void interposeStrings() {
  takeTable<CMPIString>(Cimom::Abi<Cimom::Text>::table);
  INTERPOSE(CMPIStringFT, getCharPtr);
}

void interposePaths() {
  takeTable<CMPIObjectPath>(Cimom::Abi<Cimom::ObjectPath>::table);
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

void interposeInstances(Filtered filtered) {
  takeTable<CMPIInstance>(Cimom::Abi<Cimom::Instance>::table);
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

void interposeCollections() {
  takeTable<CMPIArray>(Cimom::Abi<Cimom::Array>::table);
  INTERPOSE(CMPIArrayFT, getSize);
  INTERPOSE(CMPIArrayFT, getSimpleType);
  INTERPOSE(CMPIArrayFT, getElementAt);
  INTERPOSE(CMPIArrayFT, setElementAt);
  takeTable<CMPIEnumeration>(Cimom::Abi<Cimom::Enumeration>::table);
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

void interposeUpCalls(EnumerateInstances enumerateInstances) {
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

const CMPIBroker* interposedBroker(const CMPIBroker* real, EnumerateInstances enumerateInstances, Filtered filtered) {
  interposeStrings();
  interposePaths();
  interposeInstances(filtered);
  interposeCollections();
  original<CMPIBrokerFT> = *real->bft;
  interposed<CMPIBrokerFT> = *real->bft;
  interposeUpCalls(enumerateInstances);
  original<CMPIBrokerEncFT> = *real->eft;
  interposed<CMPIBrokerEncFT> = *real->eft;
  interposeMakers();
  static CMPIBroker broker;
  broker = *real;
  broker.bft = &interposed<CMPIBrokerFT>;
  broker.eft = &interposed<CMPIBrokerEncFT>;
  return &broker;
}

}  // namespace Testing
