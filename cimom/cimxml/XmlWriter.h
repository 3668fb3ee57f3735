// SPDX-License-Identifier: Apache-2.0
// Writes an XML document into memory.
#pragma once

#include <string>
#include <string_view>

namespace Cimom::CimXml {

// Whatever text it is given, the document is well-formed: what XML cannot carry becomes U+FFFD.
class XmlWriter {
 public:
  enum class Prolog { Declared, None };

  explicit XmlWriter(Prolog prolog = Prolog::Declared);

  // An element that ends with its scope.
  class [[nodiscard]] Scope {
   public:
    Scope(XmlWriter& writer, const char* name) : writer_(writer), name_(name) {}
    ~Scope();
    Scope(const Scope&) = delete;
    Scope& operator=(const Scope&) = delete;

   private:
    XmlWriter& writer_;
    const char* name_;
  };

  // Names must outlive the element, as literals do.
  Scope element(const char* name);
  Scope element(const char* name, const char* attributeName, std::string_view attributeValue);

  void attribute(const char* name, std::string_view value);  // of the element begun last, before its content
  void text(std::string_view text);
  void textElement(const char* name, std::string_view text);
  // Elements that another writer has written without a prolog.
  void written(std::string_view xml);

  // The document so far; complete when every scope has ended.
  // Throws std::bad_alloc if memory ran out at the end of an element.
  std::string take();

 private:
  enum class Place { Content, AttributeValue };

  void endTag(const char* name);
  void closeStartTag();
  void append(std::string_view text, Place place);

  std::string xml_;
  bool inStartTag_ = false;
  bool isCut_ = false;
};

}  // namespace Cimom::CimXml
