// SPDX-License-Identifier: Apache-2.0
#pragma once

#include <cmpift.h>

#include <string>

#include "cimom/cimxml/Request.h"
#include "cimom/schema/ClassRepository.h"

namespace Cimom::CimXml {

// Makes CMPI objects of what a client sent; the class says which type each key and property has. The objects live in
// the current request scope. Errors are OperationErrors that name the key or the property.
class ObjectBuilder {
 public:
  ObjectBuilder(const CMPIBroker* broker, const ClassRepository& classes, const std::string& nameSpace)
      : broker_(broker), classes_(classes), nameSpace_(nameSpace) {}

  // A key has its class's type; one that the class does not declare has the type that the client claims, or the one
  // that its text looks like.
  CMPIObjectPath* path(const ObjectName& name) const;

  // The instance is of the class that INSTANCE names, whatever its path says. A property that the class does not
  // declare is CIM_ERR_NO_SUCH_PROPERTY, one of another type than the class's CIM_ERR_TYPE_MISMATCH. What the client
  // sets to null is null, whatever default the class has.
  CMPIInstance* instance(const Instance& instance) const;

  // A property's new value.
  struct TypedValue {
    CMPIValue value{};
    CMPIType type = CMPI_null;
    bool isNull = true;
    const CMPIValue* pointer() const { return isNull ? nullptr : &value; }
  };
  TypedValue propertyValue(const ObjectName& owner, const Property& property) const;

  // An argument of a method. One that does not fit its declaration is CIM_ERR_INVALID_PARAMETER.
  TypedValue argument(const PropertyDeclaration& declared, const Parameter& given) const;

 private:
  const ClassDefinition* classOf(const ObjectName& name) const;
  void addKey(CMPIObjectPath* path, const ObjectName& name, const KeyBinding& key) const;
  TypedValue keyValue(const KeyBinding& key, CMPIType type) const;
  TypedValue typed(const std::string& what, const Property& property, CMPIType type) const;
  template <typename Elements, typename Read>
  CMPIArray* array(const Elements& elements, CMPIType elementType, Read read) const;
  void text(const std::string& what, const std::string& text, CMPIType type, CMPIValue& value) const;
  bool scalar(CMPIType type, const std::string& text, CMPIValue& value) const;
  CMPIInstance* embedded(const std::string& what, const std::string& text) const;

  const CMPIBroker* broker_;
  const ClassRepository& classes_;
  const std::string& nameSpace_;
  unsigned depth_ = 0;  // of instances within instances
};

}  // namespace Cimom::CimXml
