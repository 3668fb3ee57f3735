// SPDX-License-Identifier: Apache-2.0
// The CMPI instance provider of the underlying classes, one algorithm over their table. Read only: the processor is
// changed through the instrumentation. Object managers do hand out null objects with a good status, and good pointers
// beside a bad one: what is made or delivered is looked at, and a request that cannot go on says why.
#include <QV/ProviderHelper.h>
#include <cmpimacs.h>

#include <cstring>
#include <exception>
#include <functional>
#include <stdexcept>

#include "agent/backends/SharedBackEnd.h"
#include "agent/helper/Conversion.h"
#include "agent/log/Report.h"
#include "agent/underlying/ClassTable.h"

namespace {

using namespace QV;

constexpr const char* component = "Tarnwick.UnderlyingIPConfigProvider";

const CMPIBroker* broker = nullptr;

// Throws where the object manager did not do what it was asked for: "take the key" "Name".
void require(const CMPIStatus& status, const char* what, const char* which) {
  if (status.rc != CMPI_RC_OK) {
    const char* reason = textOf(status.msg);
    throw std::runtime_error("the object manager does not " + std::string(what) + ' ' + which + ": status " +
                             std::to_string(status.rc) + (reason ? std::string(", ") + reason : ""));
  }
}

template <typename Object>
Object* requireMade(Object* object, const CMPIStatus& status, const char* what, const char* which) {
  require(status, what, which);
  if (CMIsNullObject(object)) {
    throw std::runtime_error("the object manager does not " + std::string(what) + ' ' + which);
  }
  return object;
}

// What sets a property or a key of an object of the broker: CMPI_chars is itself the pointer, all else is pointed at.
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
  CMPIStatus status{CMPI_RC_OK, nullptr};
  CMPIArray* made = CMNewArray(broker, static_cast<CMPICount>(numbers.size()), CMPI_uint16, &status);
  CMPIArray* array = requireMade(made, status, "make an array for", name);
  CMPICount index = 0;
  CMPIValue value{};
  for (const std::uint16_t number : numbers) {
    value.uint16 = number;
    require(CMSetArrayElementAt(array, index++, &value, CMPI_uint16), "fill an array for", name);
  }
  value.array = array;
  set(name, &value, CMPI_uint16A);
}

void setValue(const Setter&, const char*, std::monostate) {}

void setProperty(const Setter& set, const Property& property) {
  std::visit([&](const auto& value) { setValue(set, property.name, value); }, property.value);
}

// Both names are of this library's own tables, spelled alike.
bool isKey(const UnderlyingClass& underlyingClass, const Property& property) {
  for (const char* key : underlyingClass.keys) {
    if (key && std::strcmp(key, property.name) == 0) {
      return true;
    }
  }
  return false;
}

// One request: the class that it asks for, the namespace in which its objects are made, and where they go.
class Request {
 public:
  Request(const UnderlyingClass& underlyingClass, std::string nameSpace, const CMPIResult* result)
      : class_(underlyingClass), keys_(underlyingClass.keys), namespace_(std::move(nameSpace)), result_(result) {}

  Instances read() const { return readInstances(class_); }

  CMPIObjectPath* pathOf(const InstanceProperties& properties) const {
    CMPIObjectPath* path = newPath();
    const Setter addKey = [&](const char* name, const CMPIValue* value, CMPIType type) {
      require(CMAddKey(path, name, value, type), "take the key", name);
    };
    for (const Property& property : properties) {
      if (isKey(class_, property)) {
        setProperty(addKey, property);
      }
    }
    return path;
  }

  // A property that the object manager does not take is one that its class does not declare: it is left out.
  CMPIInstance* instanceOf(const InstanceProperties& properties, const char** wanted) {
    CMPIStatus status{CMPI_RC_OK, nullptr};
    CMPIInstance* made = CMNewInstance(broker, pathOf(properties), &status);
    CMPIInstance* instance = requireMade(made, status, "make an instance of", class_.name);
    if (wanted) {
      CMSetPropertyFilter(instance, wanted, keys_.data());
    }
    const Setter set = [&](const char* name, const CMPIValue* value, CMPIType type) {
      CMSetProperty(instance, name, value, type);
    };
    for (const Property& property : properties) {
      setProperty(set, property);
    }
    return instance;
  }

  void deliver(const CMPIObjectPath* path) const {
    require(CMReturnObjectPath(result_, path), "take an object path of", class_.name);
  }

  void deliver(const CMPIInstance* instance) const {
    require(CMReturnInstance(result_, instance), "take an instance of", class_.name);
  }

  void deliverEnd() const { require(CMReturnDone(result_), "take the end of", class_.name); }

 private:
  CMPIObjectPath* newPath() const {
    CMPIStatus status{CMPI_RC_OK, nullptr};
    CMPIObjectPath* made = CMNewObjectPath(broker, namespace_.c_str(), class_.name, &status);
    return requireMade(made, status, "make an object path of", class_.name);
  }

  const UnderlyingClass& class_;
  std::array<const char*, 5> keys_;  // as long as the instances that refer to them
  const std::string namespace_;
  const CMPIResult* const result_;
};

CMPIStatus failed(CMPIrc code, const char* reason,
                  const TWLog::SourceLocation& where = TWLog::SourceLocation::current()) noexcept {
  TWLog::report(component, TWLog::failureLevel, reason, where);
  CMPIStatus made{CMPI_RC_OK, nullptr};
  CMPIString* message = CMNewString(broker, reason, &made);
  return {code, made.rc == CMPI_RC_OK && !CMIsNullObject(message) ? message : nullptr};
}

const char* orEmpty(const char* text) { return text ? text : ""; }

// Runs an operation on the class that the path names; no exception leaves for the object manager.
CMPIStatus serve(const CMPIResult* result, const CMPIObjectPath* path,
                 const std::function<CMPIStatus(Request&)>& operation) {
  if (!result || CMIsNullObject(path)) {
    return failed(CMPI_RC_ERR_INVALID_PARAMETER, "the object manager passes no object path, or nowhere to put results");
  }
  try {
    const std::string name = orEmpty(textOf(CMGetClassName(path, nullptr)));
    const UnderlyingClass* underlyingClass = findUnderlyingClass(name.c_str());
    if (!underlyingClass) {
      return failed(CMPI_RC_ERR_INVALID_CLASS, ("the class '" + name + "' is not served here").c_str());
    }
    Request request(*underlyingClass, orEmpty(textOf(CMGetNameSpace(path, nullptr))), result);
    return operation(request);
  } catch (const std::exception& error) {
    return failed(CMPI_RC_ERR_FAILED, error.what());
  }
}

constexpr CMPIStatus ok{CMPI_RC_OK, nullptr};
constexpr CMPIStatus notSupported{CMPI_RC_ERR_NOT_SUPPORTED, nullptr};

CMPIStatus underlyingCleanup(CMPIInstanceMI*, const CMPIContext*, CMPIBoolean) { return ok; }

CMPIStatus underlyingEnumInstanceNames(CMPIInstanceMI*, const CMPIContext*, const CMPIResult* result,
                                       const CMPIObjectPath* path) {
  return serve(result, path, [](const Request& request) {
    for (const InstanceProperties& properties : request.read()) {
      request.deliver(request.pathOf(properties));
    }
    request.deliverEnd();
    return ok;
  });
}

CMPIStatus underlyingEnumInstances(CMPIInstanceMI*, const CMPIContext*, const CMPIResult* result,
                                   const CMPIObjectPath* path, const char** wanted) {
  return serve(result, path, [&](Request& request) {
    for (const InstanceProperties& properties : request.read()) {
      request.deliver(request.instanceOf(properties, wanted));
    }
    request.deliverEnd();
    return ok;
  });
}

CMPIStatus underlyingGetInstance(CMPIInstanceMI*, const CMPIContext*, const CMPIResult* result,
                                 const CMPIObjectPath* path, const char** wanted) {
  return serve(result, path, [&](Request& request) {
    for (const InstanceProperties& properties : request.read()) {
      if (!isObjPathsEqual(path, request.pathOf(properties), false)) {
        continue;
      }
      request.deliver(request.instanceOf(properties, wanted));
      request.deliverEnd();
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

// What every request would fail for is reported when the object manager loads the provider, before the first of them;
// once, however often it asks for the MI.
void openProcessor() {
  [[maybe_unused]] static const bool opened = [] {
    try {
      return sharedBackEnd() != nullptr;
    } catch (const std::exception& error) {
      TWLog::report(component, TWLog::failureLevel, error.what());
      return false;
    }
  }();
}

}  // namespace

CMInstanceMIStub(underlying, UnderlyingIPConfigProvider, broker, openProcessor())
