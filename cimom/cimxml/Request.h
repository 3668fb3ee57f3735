// SPDX-License-Identifier: Apache-2.0
// A CIM-XML request as the client wrote it: texts and type names, before any class gives them a meaning.
#pragma once

#include <memory>
#include <optional>
#include <string>
#include <string_view>
#include <variant>
#include <vector>

namespace Cimom::CimXml {

class Element;
struct KeyBinding;

// CLASSNAME or INSTANCENAME, with whatever path stands around it.
struct ObjectName {
  std::string host;       // empty: none given
  std::string nameSpace;  // empty: that of the request
  std::string className;
  std::vector<KeyBinding> keys;  // none for a class
};

// A key's value: a reference, or a text with the type that the client claims for it.
struct KeyValue {
  enum class Kind { String, Boolean, Numeric, Reference };

  Kind kind = Kind::String;
  std::string text;
  std::string type;  // the TYPE attribute; empty: none given
  std::shared_ptr<const ObjectName> reference;
};

struct KeyBinding {
  std::string name;  // empty for a lone KEYVALUE, which DSP0201 allows if a class has one key
  KeyValue value;
};

using Texts = std::vector<std::optional<std::string>>;  // an array's elements; one without a value is VALUE.NULL

using ObjectNames = std::vector<std::optional<ObjectName>>;  // the same of an array of references

// No value, VALUE, VALUE.ARRAY, a reference, VALUE.REFARRAY.
using Value = std::variant<std::monostate, std::string, Texts, ObjectName, ObjectNames>;

struct Property {
  std::string name;
  std::string type;  // "uint16", "string" …, "reference"; empty: none given
  bool isArray = false;
  Value value;
};

struct Instance {
  ObjectName path;        // without keys if the client gave an INSTANCE alone
  std::string className;  // as INSTANCE says it
  std::vector<Property> properties;
};

// CLASS or QUALIFIER.DECLARATION: no operation that takes one is offered, so only its name is kept.
struct Declaration {
  std::string name;
};

struct Parameter {
  std::string name;
  std::string type;  // the PARAMTYPE attribute; empty: none given
  std::variant<std::monostate, std::string, Texts, ObjectName, ObjectNames, Instance, Declaration> value;
};

struct Request {
  std::string messageId;
  std::string protocolVersion;
  bool isIntrinsic = true;  // IMETHODCALL; else METHODCALL, a method of a class
  std::string method;
  std::string nameSpace;
  ObjectName target;  // of a class's method: what it is called on
  std::vector<Parameter> parameters;
};

// Takes the body as it came. Throws TransportError: request-not-well-formed, request-not-valid,
// multiple-requests-unsupported, unsupported-cim-version, unsupported-dtd-version or unsupported-protocol-version.
Request readRequest(std::string_view xml);

// Takes the text of a value that embeds an INSTANCE. Throws TransportError as above.
Instance readEmbeddedInstance(std::string_view xml);

// A name with whatever path stands around it; an INSTANCE or VALUE.NAMEDINSTANCE. Throws TransportError
// "request-not-valid".
ObjectName readNameElement(const Element& element);
Instance readInstanceElement(const Element& element);

}  // namespace Cimom::CimXml
