// SPDX-License-Identifier: Apache-2.0
#include "cimom/schema/MofParser.h"

#include <algorithm>

#include "cimom/model/Errors.h"
#include "cimom/model/Names.h"
#include "cimom/model/Types.h"

namespace Cimom {
namespace {

using Kind = MofToken::Kind;

}  // namespace

MofParser::MofParser(MofReader& reader, MofDeclarations& declarations, std::string_view mof, std::string origin,
                     std::filesystem::path directory, std::string nameSpace)
    : reader_(reader),
      declarations_(declarations),
      origin_(std::move(origin)),
      directory_(std::move(directory)),
      nameSpace_(std::move(nameSpace)),
      lexer_(mof, origin_) {}

void MofParser::parse() {
  advance();
  while (token_.kind != Kind::End) {
    production();
  }
}

void MofParser::production() {
  if (accept("#")) {
    return pragma();
  }
  if (acceptKeyword("Qualifier")) {
    return qualifierDeclaration();
  }
  Qualifiers qualifiers = qualifierList();
  if (acceptKeyword("class")) {
    return classDeclaration(std::move(qualifiers));
  }
  if (token_.isKeyword("instance")) {
    fail("instances are not supported: they come from providers");
  }
  unexpected("a class, a qualifier declaration or a pragma");
}

void MofParser::pragma() {
  if (!acceptKeyword("pragma")) {
    unexpected("\"pragma\"");
  }
  const std::string name = expectName("the pragma's name");
  expect("(");
  const std::string argument = expectString("the pragma's argument");
  expect(")");
  if (sameName(name, "include")) {
    include(argument);
  } else if (sameName(name, "namespace")) {
    declarations_.namespaces.push_back(argument);
    nameSpace_ = argument;
  }
}

void MofParser::include(const std::string& file) {
  try {
    reader_.readFile(directory_ / file, declarations_, nameSpace_);
  } catch (const std::filesystem::filesystem_error& error) {
    fail("\"" + file + "\" cannot be included: " + error.code().message());
  }
}

// Qualifier NAME : TYPE [= VALUE], Scope(…) [, Flavor(…)];
void MofParser::qualifierDeclaration() {
  QualifierDeclaration declaration;
  Qualifier& declared = declaration.qualifier;
  declared.name = expectName("the qualifier's name");
  expect(":");
  PropertyDeclaration value;
  type(value);
  arrayBounds(value);
  declaration.arraySize = value.arraySize;
  declared.value = accept("=") ? initializer(value.type) : Value::null(value.type);
  while (accept(",")) {
    const bool flavor = token_.isKeyword("Flavor");
    if (!flavor && !token_.isKeyword("Scope")) {
      unexpected("\"Scope\" or \"Flavor\"");
    }
    advance();
    expect("(");
    if (flavor) {
      flavors(declared, ")");
    } else {
      do {
        declaration.scopes.push_back(expectName("a scope"));
      } while (accept(","));
    }
    expect(")");
  }
  expect(";");
  Qualifiers& known = reader_.qualifierTypes_;
  std::erase_if(known, [&](const Qualifier& one) { return sameName(one.name, declared.name); });
  known.push_back(declared);
  declarations_.qualifiers.push_back(std::move(declaration));
}

Qualifiers MofParser::qualifierList() {
  Qualifiers qualifiers;
  if (!accept("[")) {
    return qualifiers;
  }
  do {
    Qualifier one = qualifier();
    if (findQualifier(qualifiers, one.name)) {
      fail("duplicate qualifier " + one.name);
    }
    qualifiers.push_back(std::move(one));
  } while (accept(","));
  expect("]");
  return qualifiers;
}

// NAME [(VALUE) | {VALUES}] [: FLAVORS]; without a value a boolean qualifier is true, another has its default.
Qualifier MofParser::qualifier() {
  Qualifier result;
  result.name = expectName("a qualifier's name");
  const Qualifier* declared = findQualifier(reader_.qualifierTypes_, result.name);
  if (declared) {
    result = *declared;
  }
  if (token_.is("{")) {
    result.value = initializer(declared ? declared->value.type() : CMPIType(CMPI_ARRAY));
  } else if (accept("(")) {
    result.value = constant(declared ? declared->value.type() : CMPIType(CMPI_null));
    expect(")");
  } else if (!declared || declared->value.type() == CMPI_boolean) {
    result.value = Value::boolean(true);
  }
  if (accept(":")) {
    flavors(result, ",]");
  }
  return result;
}

// Flavors up to one of the closing marks; in a list of qualifiers blanks divide them, in a declaration commas.
void MofParser::flavors(Qualifier& target, std::string_view closing) {
  do {
    if (acceptKeyword("EnableOverride")) {
      target.overridable = true;
    } else if (acceptKeyword("DisableOverride")) {
      target.overridable = false;
    } else if (acceptKeyword("ToSubclass")) {
      target.toSubclass = true;
    } else if (acceptKeyword("Restricted")) {
      target.toSubclass = false;
    } else if (acceptKeyword("Translatable")) {
      target.translatable = true;
    } else {
      unexpected("a flavor");
    }
    if (closing == ")") {
      accept(",");
    }
  } while (token_.kind == Kind::Name);
}

void MofParser::classDeclaration(Qualifiers qualifiers) {
  ClassDeclaration declaration;
  ClassDefinition& own = declaration.own;
  own.declaredAt = origin_ + ":" + std::to_string(token_.line);
  own.name = expectName("the class's name");
  own.qualifiers = std::move(qualifiers);
  if (token_.is("$") || token_.isKeyword("as")) {
    fail("class aliases are not supported");
  }
  if (accept(":")) {
    declaration.superclassName = expectName("the superclass's name");
  }
  expect("{");
  while (!accept("}")) {
    feature(own);
  }
  expect(";");
  declaration.nameSpace = nameSpace_;
  declarations_.classes.push_back(std::move(declaration));
}

// [QUALIFIERS] TYPE NAME [ARRAY] [= DEFAULT]; or [QUALIFIERS] TYPE NAME (PARAMETERS);
void MofParser::feature(ClassDefinition& definition) {
  PropertyDeclaration property;
  property.qualifiers = qualifierList();
  type(property);
  property.name = expectName("the name of a property or method");
  property.originClass = definition.name;
  if (definition.findProperty(property.name) || definition.findMethod(property.name)) {
    fail("duplicate " + definition.name + "." + property.name);
  }
  if (token_.is("(")) {
    return method(definition, property.name, property.type, std::move(property.qualifiers));
  }
  arrayBounds(property);
  property.defaultValue = accept("=") ? initializer(property.type) : Value::null(property.type);
  expect(";");
  definition.properties.add(std::move(property));
}

void MofParser::method(ClassDefinition& definition, const std::string& name, CMPIType returnType,
                       Qualifiers qualifiers) {
  MethodDeclaration declaration{name, returnType, {}, std::move(qualifiers), definition.name, false};
  expect("(");
  if (!token_.is(")")) {
    do {
      declaration.parameters.push_back(parameter());
    } while (accept(","));
  }
  expect(")");
  expect(";");
  definition.methods.add(std::move(declaration));
}

PropertyDeclaration MofParser::parameter() {
  PropertyDeclaration declaration;
  declaration.qualifiers = qualifierList();
  type(declaration);
  declaration.name = expectName("the parameter's name");
  arrayBounds(declaration);
  return declaration;
}

// A type's name, or a class's name with REF.
void MofParser::type(PropertyDeclaration& target) {
  target.type = token_.kind == Kind::Name ? typeOfMofName(token_.text) : CMPIType(CMPI_null);
  if (target.type != CMPI_null) {
    return advance();
  }
  target.referenceClass = expectName("a type");
  if (!acceptKeyword("ref")) {
    unexpected("a known type, or \"REF\" after " + target.referenceClass);
  }
  target.type = CMPI_ref;
}

void MofParser::arrayBounds(PropertyDeclaration& target) {
  if (!accept("[")) {
    return;
  }
  if (token_.kind == Kind::Integer) {
    const auto size = token_.value.asInteger(CMPI_uint32);
    if (!size) {
      fail("an array of " + token_.text + " elements is too large");
    }
    target.arraySize = size->scalar()->uint32;
    advance();
  }
  expect("]");
  target.type = arrayOf(target.type);
}

// A constant, or for an array constants in braces.
Value MofParser::initializer(CMPIType type) {
  if (!isArray(type)) {
    return constant(type);
  }
  if (acceptKeyword("null")) {
    return Value::null(type);
  }
  const CMPIType elementType = elementTypeOf(type);
  Array array{elementType, {}};
  expect("{");
  if (!token_.is("}")) {
    do {
      array.elements.push_back(constant(elementType));
    } while (accept(","));
  }
  expect("}");
  if (array.elementType == CMPI_null) {
    array.elementType = array.elements.empty() ? CMPIType(CMPI_string) : array.elements.front().type();
  }
  return Value::array(std::move(array));
}

// A constant of a type; of the type that its notation shows if `type` is CMPI_null.
Value MofParser::constant(CMPIType type) {
  std::optional<Value> result;
  if (token_.isKeyword("null")) {
    result = Value::null(type);
  } else if (token_.isKeyword("true") || token_.isKeyword("false")) {
    result = Value::boolean(token_.isKeyword("true"));
  } else if (token_.kind != Kind::Name && token_.kind != Kind::Punctuation && token_.kind != Kind::End) {
    result = token_.value;
  } else {
    unexpected("a value");
  }
  if (type == CMPI_dateTime && token_.kind == Kind::String) {
    try {
      result = Value::dateTime(DateTime::parse(token_.text));
    } catch (const StatusError& error) {
      fail(error.what());
    }
  } else if (type != CMPI_null) {
    result = result->as(type);
  }
  if (!result) {
    fail("expected " + describeType(type) + ", not " + token_.describe());
  }
  advance();
  return *std::move(result);
}

void MofParser::advance() { token_ = lexer_.next(); }

bool MofParser::accept(std::string_view punctuation) {
  const bool there = token_.is(punctuation);
  if (there) {
    advance();
  }
  return there;
}

bool MofParser::acceptKeyword(std::string_view keyword) {
  const bool there = token_.isKeyword(keyword);
  if (there) {
    advance();
  }
  return there;
}

void MofParser::expect(std::string_view punctuation) {
  if (!accept(punctuation)) {
    unexpected("\"" + std::string(punctuation) + "\"");
  }
}

std::string MofParser::expectName(const char* what) {
  if (token_.kind != Kind::Name) {
    unexpected(what);
  }
  std::string name = std::move(token_.text);
  advance();
  return name;
}

std::string MofParser::expectString(const char* what) {
  if (token_.kind != Kind::String) {
    unexpected(std::string(what) + " in quotes");
  }
  std::string text = std::move(token_.text);
  advance();
  return text;
}

void MofParser::unexpected(const std::string& expected) const {
  fail("expected " + expected + ", not " + token_.describe());
}

}  // namespace Cimom
