// The CMPI instance provider of the underlying classes, one algorithm over their table. Read only: the processor is
// changed through the instrumentation.
#include <cmpimacs.h>

#include <exception>
#include <experimental/source_location>
#include <functional>
#include <stdexcept>

#include "QV/ProviderHelper.h"
#include "TWLog/TWLog.h"
#include "underlying/ClassTable.h"

namespace {

using namespace QV;

const CMPIBroker* broker = nullptr;

// What set a property or a key of an object of the broker: CMPI_chars is itself the pointer, all else is pointed at.
using Setter = std::function<void(const char* name, const CMPIValue* value, CMPIType type)>;

void setValue(const Setter& set, const char* name, const std::string& text) {
  set(name, reinterpret_cast<const CMPIValue*>(text.c_str()), CMPI_chars);
}

void setValue(const Setter& set, const char* name, std::uint16_t number) {
  CMPIValue value{};
  value.uint16 = number;
  set(name, &value, CMPI_uint16);
}

void setValue(const Setter& set, const char* name, std::uint8_t number) {
  CMPIValue value{};
  value.uint8 = number;
  set(name, &value, CMPI_uint8);
}

void setValue(const Setter& set, const char* name, const std::vector<std::uint16_t>& numbers) {
  CMPIArray* array = CMNewArray(broker, static_cast<CMPICount>(numbers.size()), CMPI_uint16, nullptr);
  if (!array) throw std::bad_alloc();
  CMPICount index = 0;
  CMPIValue value{};
  for (const std::uint16_t number : numbers) {
    value.uint16 = number;
    CMSetArrayElementAt(array, index++, &value, CMPI_uint16);
  }
  value.array = array;
  set(name, &value, CMPI_uint16A);
}

void setValue(const Setter&, const char*, std::monostate) {}

void setProperty(const Setter& set, const Property& property) {
  std::visit([&](const auto& value) { setValue(set, property.name, value); }, property.value);
}

bool isKey(const UnderlyingClass& underlyingClass, const Property& property) {
  for (const char* key : underlyingClass.keys) {
    if (textEqual(key, property.name)) return true;
  }
  return false;
}

// One request: the class that it asks for, and the namespace in which its objects are made.
class Request {
 public:
  Request(const UnderlyingClass& underlyingClass, std::string nameSpace)
      : class_(underlyingClass), namespace_(std::move(nameSpace)) {}

  Instances read() const { return readInstances(class_); }

  CMPIObjectPath* pathOf(const InstanceProperties& properties) const {
    CMPIObjectPath* path = newPath();
    const Setter addKey = [&](const char* name, const CMPIValue* value, CMPIType type) {
      CMAddKey(path, name, value, type);
    };
    for (const Property& property : properties) {
      if (isKey(class_, property)) setProperty(addKey, property);
    }
    return path;
  }

  CMPIInstance* instanceOf(const InstanceProperties& properties, const char** wanted) const {
    CMPIStatus status{CMPI_RC_OK, nullptr};
    CMPIInstance* instance = CMNewInstance(broker, pathOf(properties), &status);
    if (CMIsNullObject(instance)) throw std::runtime_error("the object manager made no instance");
    auto keys = class_.keys;
    CMSetPropertyFilter(instance, wanted, keys.data());
    const Setter set = [&](const char* name, const CMPIValue* value, CMPIType type) {
      CMSetProperty(instance, name, value, type);
    };
    for (const Property& property : properties) setProperty(set, property);
    return instance;
  }

 private:
  CMPIObjectPath* newPath() const {
    CMPIObjectPath* path = CMNewObjectPath(broker, namespace_.c_str(), class_.name, nullptr);
    if (CMIsNullObject(path)) throw std::runtime_error("the object manager made no object path");
    return path;
  }

  const UnderlyingClass& class_;
  const std::string namespace_;
};

std::string charactersOf(const CMPIString* string) {
  const char* characters = CMIsNullObject(string) ? nullptr : CMGetCharsPtr(string, nullptr);
  return characters ? characters : "";
}

CMPIStatus failed(CMPIrc code, const std::string& reason,
                  const std::experimental::source_location& where = std::experimental::source_location::current()) {
  TWLog::TWLogger::logLevelMessage(where.function_name(), "UnderlyingIPConfigProvider", static_cast<int>(where.line()),
                                   "Tarnwick.UnderlyingIPConfigProvider", 6000, nullptr, 0, 0, reason);
  CMPIStatus status{code, nullptr};
  status.msg = CMNewString(broker, reason.c_str(), nullptr);
  return status;
}

// Runs an operation on the class that the path names; no exception leaves for the object manager.
CMPIStatus serve(const CMPIObjectPath* path, const std::function<CMPIStatus(const Request&)>& operation) {
  try {
    const std::string name = charactersOf(CMGetClassName(path, nullptr));
    const UnderlyingClass* underlyingClass = findUnderlyingClass(name.c_str());
    if (!underlyingClass) return failed(CMPI_RC_ERR_INVALID_CLASS, "the class '" + name + "' is not served here");
    return operation(Request(*underlyingClass, charactersOf(CMGetNameSpace(path, nullptr))));
  } catch (const std::exception& error) {
    return failed(CMPI_RC_ERR_FAILED, error.what());
  }
}

constexpr CMPIStatus ok{CMPI_RC_OK, nullptr};
constexpr CMPIStatus notSupported{CMPI_RC_ERR_NOT_SUPPORTED, nullptr};

CMPIStatus underlyingCleanup(CMPIInstanceMI*, const CMPIContext*, CMPIBoolean) { return ok; }

CMPIStatus underlyingEnumInstanceNames(CMPIInstanceMI*, const CMPIContext*, const CMPIResult* result,
                                       const CMPIObjectPath* path) {
  return serve(path, [&](const Request& request) {
    for (const InstanceProperties& properties : request.read()) CMReturnObjectPath(result, request.pathOf(properties));
    CMReturnDone(result);
    return ok;
  });
}

CMPIStatus underlyingEnumInstances(CMPIInstanceMI*, const CMPIContext*, const CMPIResult* result,
                                   const CMPIObjectPath* path, const char** wanted) {
  return serve(path, [&](const Request& request) {
    for (const InstanceProperties& properties : request.read())
      CMReturnInstance(result, request.instanceOf(properties, wanted));
    CMReturnDone(result);
    return ok;
  });
}

CMPIStatus underlyingGetInstance(CMPIInstanceMI*, const CMPIContext*, const CMPIResult* result,
                                 const CMPIObjectPath* path, const char** wanted) {
  return serve(path, [&](const Request& request) {
    for (const InstanceProperties& properties : request.read()) {
      if (!isObjPathsEqual(path, request.pathOf(properties), false)) continue;
      CMReturnInstance(result, request.instanceOf(properties, wanted));
      CMReturnDone(result);
      return ok;
    }
    return CMPIStatus{CMPI_RC_ERR_NOT_FOUND, nullptr};
  });
}

CMPIStatus underlyingCreateInstance(CMPIInstanceMI*, const CMPIContext*, const CMPIResult*, const CMPIObjectPath*,
                                    const CMPIInstance*) {
  return notSupported;
}

CMPIStatus underlyingModifyInstance(CMPIInstanceMI*, const CMPIContext*, const CMPIResult*, const CMPIObjectPath*,
                                    const CMPIInstance*, const char**) {
  return notSupported;
}

CMPIStatus underlyingDeleteInstance(CMPIInstanceMI*, const CMPIContext*, const CMPIResult*, const CMPIObjectPath*) {
  return notSupported;
}

CMPIStatus underlyingExecQuery(CMPIInstanceMI*, const CMPIContext*, const CMPIResult*, const CMPIObjectPath*,
                               const char*, const char*) {
  return notSupported;
}

}  // namespace

CMInstanceMIStub(underlying, UnderlyingIPConfigProvider, broker, CMNoHook)
