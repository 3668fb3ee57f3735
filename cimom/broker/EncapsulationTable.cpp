// SPDX-License-Identifier: Apache-2.0
#include <cstdarg>
#include <vector>

#include "cimom/broker/BrokerCore.h"
#include "cimom/broker/Guard.h"
#include "cimom/model/Types.h"

namespace Cimom {
namespace {

// Makes an object for a broker's caller.
template <typename Operation>
auto made(const CMPIBroker* broker, CMPIStatus* status, Operation operation) {
  using Object = std::invoke_result_t<Operation>;
  return guarded(status, Object{}, [&] {
    coreOf(broker);
    return operation();
  });
}

CMPIInstance* newInstance(const CMPIBroker* broker, const CMPIObjectPath* path, CMPIStatus* status) {
  return made(broker, status, [&] {
    const Shared<ObjectPath>& model = argumentOf<ObjectPath>(path);
    return make(Instance(coreOf(broker).requireClass(model->nameSpace, model->className), model));
  });
}

// The class need not be known: a path may be made for what another object manager has. A null namespace is none.
CMPIObjectPath* newObjectPath(const CMPIBroker* broker, const char* nameSpace, const char* className,
                              CMPIStatus* status) {
  return made(broker, status, [&] {
    return make(ObjectPath{{}, nameSpace ? nameSpace : "", required(className, "the class's name"), {}});
  });
}

CMPIArgs* newArgs(const CMPIBroker* broker, CMPIStatus* status) {
  return made(broker, status, [] { return make(Args{}); });
}

CMPIString* newString(const CMPIBroker* broker, const char* text, CMPIStatus* status) {
  return made(broker, status, [&] { return make(Text{required(text, "the text")}); });
}

// An array of no type has room for nulls alone.
CMPIArray* newArray(const CMPIBroker* broker, CMPICount count, CMPIType type, CMPIStatus* status) {
  return made(broker, status, [&] {
    const Value element = fromCmpi(nullptr, type);
    if (isArray(type)) {
      throw StatusError(CMPI_RC_ERR_INVALID_DATA_TYPE, "array elements cannot be of CMPI type " + std::to_string(type));
    }
    return make(Array{element.type(), std::vector<Value>(count, element)});
  });
}

CMPIDateTime* newDateTime(const CMPIBroker* broker, CMPIStatus* status) {
  return made(broker, status, [] { return make(DateTime::now()); });
}

CMPIDateTime* newDateTimeFromBinary(const CMPIBroker* broker, CMPIUint64 microseconds, CMPIBoolean interval,
                                    CMPIStatus* status) {
  return made(broker, status, [&] { return make(DateTime{microseconds, interval != 0, 0}); });
}

CMPIDateTime* newDateTimeFromChars(const CMPIBroker* broker, const char* text, CMPIStatus* status) {
  return made(broker, status, [&] { return make(DateTime::parse(required(text, "the text"))); });
}

CMPISelectExp* newSelectExp(const CMPIBroker* broker, const char*, const char*, CMPIArray**, CMPIStatus* status) {
  return made(broker, status,
              []() -> CMPISelectExp* { throw StatusError(CMPI_RC_ERR_NOT_SUPPORTED, "queries are not supported"); });
}

CMPIBoolean classPathIsA(const CMPIBroker* broker, const CMPIObjectPath* path, const char* className,
                         CMPIStatus* status) {
  return made(broker, status, [&] {
    const ObjectPath& model = *argumentOf<ObjectPath>(path);
    const ClassDefinition& definition = coreOf(broker).requireClass(model.nameSpace, model.className);
    return static_cast<CMPIBoolean>(definition.isA(required(className, "the class's name")));
  });
}

// What any CMPI object begins with.
struct AnyObject {
  const void* hdl;
  const void* ft;
};

// Appends to a text that is not to grow without end. Returns whether there was room.
bool append(std::string& text, const std::string& more) {
  constexpr std::size_t most = 4096;
  const bool hasRoom = text.size() < most;
  text += hasRoom ? more : "…";
  return hasRoom;
}

// "{name=value,…}"
std::string listed(const NamedValues& values) {
  std::string list = "{";
  for (const auto& [name, value] : values) {
    if (!append(list, (list.size() > 1 ? "," : "") + name + "=" + value.toString())) {
      break;
    }
  }
  return list + "}";
}

std::string listed(const std::vector<Value>& values) {
  std::string list = "{";
  for (const Value& value : values) {
    if (!append(list, (list.size() > 1 ? "," : "") + value.toString())) {
      break;
    }
  }
  return list + "}";
}

// The path, and the properties that have a value.
std::string described(const Instance& instance) {
  NamedValues properties;
  for (std::size_t index = 0; index < instance.size(); ++index) {
    if (!instance[index].isNull()) {
      properties.set(instance.definition().properties[index].name, instance[index]);
    }
  }
  return instance.path()->toString() + " " + listed(properties);
}

struct ObjectType {
  const void* table;
  const char* name;
  std::string (*describe)(const void* object);
};

template <typename Model>
ObjectType typeRow(std::string (*describe)(const void* object)) {
  return {&Abi<Model>::table, Abi<Model>::name, describe};
}

template <typename Model>
const Model& modelBehind(const void* object) {
  return modelOf<Model>(static_cast<const typename Abi<Model>::Type*>(object));
}

// The type of an object that a provider knows by its address only. The object's function table identifies it.
const ObjectType& typeOf(const void* object) {
  static const ObjectType types[] = {
      {&upCallTable, "CMPIBroker", [](const void*) { return std::string(upCallTable.brokerName); }},
      typeRow<Text>([](const void* any) { return std::string(textOf(static_cast<const CMPIString*>(any))); }),
      typeRow<ObjectPath>([](const void* any) { return modelBehind<ObjectPath>(any).toString(); }),
      typeRow<Instance>([](const void* any) { return described(modelBehind<Instance>(any)); }),
      typeRow<Array>([](const void* any) { return Value::array(modelBehind<Array>(any)).toString(); }),
      typeRow<DateTime>([](const void* any) { return modelBehind<DateTime>(any).format(); }),
      typeRow<Enumeration>([](const void* any) { return listed(modelBehind<Enumeration>(any).items); }),
      typeRow<Args>([](const void* any) { return listed(modelBehind<Args>(any).arguments); }),
      typeRow<Context>([](const void* any) { return listed(modelBehind<Context>(any).entries); }),
      typeRow<Result>([](const void* any) { return listed(modelBehind<Result>(any).items); }),
      typeRow<Error>([](const void* any) { return modelBehind<Error>(any).message.value_or(""); }),
  };
  const auto* any = static_cast<const AnyObject*>(object);
  if (!any || !any->hdl) {
    throw StatusError(CMPI_RC_ERR_INVALID_PARAMETER, "an object must not be null");
  }
  for (const ObjectType& type : types) {
    if (any->ft == type.table) {
      return type;
    }
  }
  throw StatusError(CMPI_RC_ERR_INVALID_HANDLE, "not an object of this broker");
}

CMPIString* toString(const CMPIBroker* broker, const void* object, CMPIStatus* status) {
  return made(broker, status, [&] { return make(Text{typeOf(object).describe(object)}); });
}

CMPIBoolean isOfType(const CMPIBroker* broker, const void* object, const char* type, CMPIStatus* status) {
  return made(broker, status, [&] {
    return static_cast<CMPIBoolean>(typeOf(object).name == std::string_view(required(type, "the type")));
  });
}

CMPIString* getType(const CMPIBroker* broker, const void* object, CMPIStatus* status) {
  return made(broker, status, [&] { return make(Text{typeOf(object).name}); });
}

// The next argument; what is narrower than an int travels as one.
std::string argumentText(std::va_list* arguments) {
  // NOLINTNEXTLINE(clang-analyzer-valist.Uninitialized): the caller has started the list.
  const int type = va_arg(*arguments, int);
  switch (type) {
    case CMPI_boolean:
      return va_arg(*arguments, int) ? "true" : "false";
    case CMPI_uint8:
    case CMPI_uint16:
    case CMPI_sint8:
    case CMPI_sint16:
    case CMPI_sint32:
      return std::to_string(va_arg(*arguments, int));
    case CMPI_uint32:
      return std::to_string(va_arg(*arguments, unsigned));
    case CMPI_uint64:
      return std::to_string(va_arg(*arguments, CMPIUint64));
    case CMPI_sint64:
      return std::to_string(va_arg(*arguments, CMPISint64));
    case CMPI_real32:
    case CMPI_real64:
      return std::to_string(va_arg(*arguments, double));
    case CMPI_chars: {
      const char* text = va_arg(*arguments, const char*);
      return text ? text : "";
    }
    case CMPI_string:
      return textOf(va_arg(*arguments, const CMPIString*));
    default:
      throw StatusError(CMPI_RC_ERR_INVALID_DATA_TYPE,
                        "message arguments cannot be of CMPI type " + std::to_string(type));
  }
}

// A message with "$0" … "$9" replaced by its arguments: `count` pairs of a CMPIType and a value of it.
std::string messageText(const std::string& message, CMPICount count, std::va_list arguments) {
  std::va_list rest;
  va_copy(rest, arguments);
  std::vector<std::string> texts;
  try {
    while (texts.size() < count) {
      texts.push_back(argumentText(&rest));
    }
  } catch (...) {
    va_end(rest);
    throw;
  }
  va_end(rest);
  std::string result;
  for (std::size_t position = 0; position < message.size(); ++position) {
    const unsigned digit = position + 1 < message.size() ? static_cast<unsigned>(message[position + 1] - '0') : 10;
    if (message[position] == '$' && digit < texts.size() && digit < 10) {
      result += texts[digit];
      ++position;
    } else {
      result += message[position];
    }
  }
  return result;
}

// No message file is there: the caller's text is the message, with its arguments put in.
CMPIString* defaultMessage(const CMPIBroker* broker, const char* text, CMPIStatus* status, CMPICount count,
                           std::va_list arguments) {
  return made(broker, status,
              [&] { return make(Text{messageText(required(text, "the default message"), count, arguments)}); });
}

CMPIString* getMessage(const CMPIBroker* broker, const char*, const char* text, CMPIStatus* status, CMPICount count,
                       ...) {
  std::va_list arguments;
  va_start(arguments, count);
  CMPIString* message = defaultMessage(broker, text, status, count, arguments);
  va_end(arguments);
  return message;
}

CMPIString* getMessage2(const CMPIBroker* broker, const char*, const CMPIMsgFileHandle, const char* text,
                        CMPIStatus* status, CMPICount count, ...) {
  std::va_list arguments;
  va_start(arguments, count);
  CMPIString* message = defaultMessage(broker, text, status, count, arguments);
  va_end(arguments);
  return message;
}

// There are no message files, so that none is found; with the null handle that this leaves, a message is its default.
CMPIStatus openMessageFile(const CMPIBroker* broker, const char* name, CMPIMsgFileHandle* file) {
  return guarded([&] {
    coreOf(broker);
    if (file) {
      *file = nullptr;
    }
    throw StatusError(CMPI_RC_ERR_NOT_FOUND,
                      std::string("no message file \"") + required(name, "the file's name") + "\"");
  });
}

CMPIStatus closeMessageFile(const CMPIBroker* broker, const CMPIMsgFileHandle) {
  return guarded([&] {
    coreOf(broker);
    throw StatusError(CMPI_RC_ERR_INVALID_HANDLE, "not the handle of an open message file");
  });
}

// The text of a message comes as characters or as a string; the characters win if both are there.
CMPIStatus send(const CMPIBroker* broker, MessageSink BrokerCore::*sink, int level, const char* component,
                const char* text, const CMPIString* string) {
  return guarded([&] {
    const auto& receiver = coreOf(broker).*sink;
    const char* message = required(text || !string ? text : textOf(string), "the message");
    if (receiver) {
      receiver(level, component ? component : "", message);
    }
  });
}

CMPIStatus logMessage(const CMPIBroker* broker, Cmpi::Severity severity, const char* id, const char* text,
                      const CMPIString* string) {
  return send(broker, &BrokerCore::log, severity, id, text, string);
}

CMPIStatus trace(const CMPIBroker* broker, Cmpi::TraceLevel level, const char* component, const char* text,
                 const CMPIString* string) {
  return send(broker, &BrokerCore::trace, level, component, text, string);
}

CMPIError* newCMPIError(const CMPIBroker* broker, const char* owner, const char* id, const char* message,
                        const CMPIErrorSeverity severity, const CMPIErrorProbableCause cause, const CMPIrc code,
                        CMPIStatus* status) {
  return made(broker, status, [&] {
    Error error;
    error.owningEntity = required(owner, "the owning entity");
    error.messageId = required(id, "the message's id");
    error.message = required(message, "the message");
    error.severity = severity;
    error.probableCause = cause;
    error.statusCode = code;
    return make(std::move(error));
  });
}

}  // namespace

CMPIBrokerEncFT encapsulationTable = {
    .ftVersion = CMPICurrentVersion,
    .newInstance = newInstance,
    .newObjectPath = newObjectPath,
    .newArgs = newArgs,
    .newString = newString,
    .newArray = newArray,
    .newDateTime = newDateTime,
    .newDateTimeFromBinary = newDateTimeFromBinary,
    .newDateTimeFromChars = newDateTimeFromChars,
    .newSelectExp = newSelectExp,
    .classPathIsA = classPathIsA,
    .toString = toString,
    .isOfType = isOfType,
    .getType = getType,
    .getMessage = getMessage,
    .logMessage = logMessage,
    .trace = trace,
    .newCMPIError = newCMPIError,
    .openMessageFile = openMessageFile,
    .closeMessageFile = closeMessageFile,
    .getMessage2 = getMessage2,
};

}  // namespace Cimom
