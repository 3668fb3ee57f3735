// SPDX-License-Identifier: Apache-2.0
#include "cimom/broker/BrokerCore.h"
#include "cimom/broker/Guard.h"

namespace Cimom {
namespace {

using Member = std::string ObjectPath::*;

template <Member member>
CMPIStatus setText(CMPIObjectPath* path, const char* text) {
  return guarded([&] { ownModelOf<ObjectPath>(path).*member = required(text, "the text"); });
}

template <Member member>
CMPIString* getText(const CMPIObjectPath* path, CMPIStatus* status) {
  return guarded(status, static_cast<CMPIString*>(nullptr),
                 [&] { return makeCopy(modelOf<ObjectPath>(path).*member); });
}

CMPIStatus addKey(CMPIObjectPath* path, const char* name, const CMPIValue* value, const CMPIType type) {
  return guarded([&] {
    ObjectPath& model = ownModelOf<ObjectPath>(path);
    model.keys.set(required(name, "the key's name"), fromCmpi(value, type));
  });
}

CMPIData getKey(const CMPIObjectPath* path, const char* name, CMPIStatus* status) {
  return guarded(status, noData, [&] { return entryOf(modelOf<ObjectPath>(path).keys, name, CMPI_keyValue); });
}

CMPIData getKeyAt(const CMPIObjectPath* path, CMPICount index, CMPIString** name, CMPIStatus* status) {
  return guarded(status, noData, [&] { return entryAt(modelOf<ObjectPath>(path).keys, index, name, CMPI_keyValue); });
}

CMPICount getKeyCount(const CMPIObjectPath* path, CMPIStatus* status) {
  return guarded(status, CMPICount(0), [&] { return static_cast<CMPICount>(modelOf<ObjectPath>(path).keys.size()); });
}

// The path that another is set from. It is the same kind of object, and as such an invalid handle where it has none.
const ObjectPath& sourceOf(const CMPIObjectPath* source) {
  return source ? modelOf<ObjectPath>(source) : *argumentOf<ObjectPath>(source);
}

CMPIStatus setNameSpaceFromObjectPath(CMPIObjectPath* path, const CMPIObjectPath* source) {
  return guarded([&] {
    ObjectPath& model = ownModelOf<ObjectPath>(path);
    model.nameSpace = sourceOf(source).nameSpace;
  });
}

CMPIStatus setHostAndNameSpaceFromObjectPath(CMPIObjectPath* path, const CMPIObjectPath* source) {
  return guarded([&] {
    ObjectPath& model = ownModelOf<ObjectPath>(path);
    model.nameSpace = sourceOf(source).nameSpace;
    model.host = sourceOf(source).host;
  });
}

// The path's class, as the broker of the current request knows it.
const ClassDefinition& classOf(const CMPIObjectPath* path) {
  const ObjectPath& model = modelOf<ObjectPath>(path);
  const CMPIBroker* broker = RequestScope::currentBroker();
  if (!broker) {
    throw StatusError(CMPI_RC_ERR_FAILED, "qualifiers can only be read within a request");
  }
  return coreOf(broker).requireClass(model.nameSpace, model.className);
}

template <typename Declaration>
const Declaration& declared(const Declaration* declaration, CMPIrc code, const char* name) {
  if (!declaration) {
    throw StatusError(code, "\"" + std::string(name) + "\" is not declared");
  }
  return *declaration;
}

const MethodDeclaration& methodOf(const CMPIObjectPath* path, const char* name) {
  return declared(classOf(path).findMethod(required(name, "the method's name")), CMPI_RC_ERR_METHOD_NOT_FOUND, name);
}

// A qualifier's value; a null value with CMPI_RC_ERR_NOT_FOUND if it is not there.
CMPIData qualifierOf(const Qualifiers& qualifiers, const char* name) {
  const Qualifier* qualifier = findQualifier(qualifiers, required(name, "the qualifier's name"));
  return toCmpi(declared(qualifier, CMPI_RC_ERR_NOT_FOUND, name).value);
}

CMPIData getClassQualifier(const CMPIObjectPath* path, const char* qualifier, CMPIStatus* status) {
  return guarded(status, noData, [&] { return qualifierOf(classOf(path).qualifiers, qualifier); });
}

CMPIData getPropertyQualifier(const CMPIObjectPath* path, const char* property, const char* qualifier,
                              CMPIStatus* status) {
  return guarded(status, noData, [&] {
    const auto* found = classOf(path).findProperty(required(property, "the property's name"));
    return qualifierOf(declared(found, CMPI_RC_ERR_NO_SUCH_PROPERTY, property).qualifiers, qualifier);
  });
}

CMPIData getMethodQualifier(const CMPIObjectPath* path, const char* method, const char* qualifier, CMPIStatus* status) {
  return guarded(status, noData, [&] { return qualifierOf(methodOf(path, method).qualifiers, qualifier); });
}

CMPIData getParameterQualifier(const CMPIObjectPath* path, const char* method, const char* parameter,
                               const char* qualifier, CMPIStatus* status) {
  return guarded(status, noData, [&] {
    const MethodDeclaration& declaration = methodOf(path, method);
    required(parameter, "the parameter's name");
    for (const PropertyDeclaration& one : declaration.parameters) {
      if (sameName(one.name, parameter)) {
        return qualifierOf(one.qualifiers, qualifier);
      }
    }
    throw StatusError(CMPI_RC_ERR_NOT_FOUND, "\"" + std::string(parameter) + "\" is not declared");
  });
}

CMPIString* toString(const CMPIObjectPath* path, CMPIStatus* status) {
  return guarded(status, static_cast<CMPIString*>(nullptr),
                 [&] { return make(Text{modelOf<ObjectPath>(path).toString()}); });
}

}  // namespace

CMPIObjectPathFT Abi<ObjectPath>::table = {
    .ftVersion = CMPICurrentVersion,
    .release = release<ObjectPath>,
    .clone = clone<ObjectPath>,
    .setNameSpace = setText<&ObjectPath::nameSpace>,
    .getNameSpace = getText<&ObjectPath::nameSpace>,
    .setHostname = setText<&ObjectPath::host>,
    .getHostname = getText<&ObjectPath::host>,
    .setClassName = setText<&ObjectPath::className>,
    .getClassName = getText<&ObjectPath::className>,
    .addKey = addKey,
    .getKey = getKey,
    .getKeyAt = getKeyAt,
    .getKeyCount = getKeyCount,
    .setNameSpaceFromObjectPath = setNameSpaceFromObjectPath,
    .setHostAndNameSpaceFromObjectPath = setHostAndNameSpaceFromObjectPath,
    .getClassQualifier = getClassQualifier,
    .getPropertyQualifier = getPropertyQualifier,
    .getMethodQualifier = getMethodQualifier,
    .getParameterQualifier = getParameterQualifier,
    .toString = toString,
};

}  // namespace Cimom
