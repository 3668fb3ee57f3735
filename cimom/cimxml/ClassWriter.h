// SPDX-License-Identifier: Apache-2.0
#pragma once

#include "cimom/cimxml/ObjectWriter.h"
#include "cimom/model/ClassDefinition.h"

namespace Cimom::CimXml {

// What of a class a client wants to see (DSP0200, GetClass).
struct ClassView {
  bool localOnly = true;  // leaves out properties and methods that the class inherits and does not override
  bool includeQualifiers = true;
  bool includeClassOrigin = false;
  PropertyFilter properties;
};

// Writes CLASS and QUALIFIER.DECLARATION.
class ClassWriter {
 public:
  ClassWriter(XmlWriter& xml, ClassView view) : xml_(xml), values_(xml, none_, none_), view_(std::move(view)) {}

  void write(const ClassDefinition& definition);
  void write(const QualifierDeclaration& declaration);

 private:
  void qualifiers(const Qualifiers& qualifiers);
  void flavor(const Qualifier& qualifier);
  void property(const PropertyDeclaration& property);
  void method(const MethodDeclaration& method);
  void parameter(const PropertyDeclaration& parameter);
  void origin(const std::string& originClass, bool propagated);
  bool isShown(bool propagated) const;

  XmlWriter& xml_;
  const std::string none_;  // a schema's default values are in no host and no namespace
  ObjectWriter values_;
  ClassView view_;
};

}  // namespace Cimom::CimXml
