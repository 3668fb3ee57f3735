// SPDX-License-Identifier: Apache-2.0
// Writes an XML document into memory.
#pragma once

#include <libxml/tree.h>
#include <libxml/xmlwriter.h>

#include <memory>
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
    explicit Scope(XmlWriter& writer) : writer_(writer) {}
    ~Scope();
    Scope(const Scope&) = delete;
    Scope& operator=(const Scope&) = delete;

   private:
    XmlWriter& writer_;
  };

  Scope element(const char* name);
  Scope element(const char* name, const char* attributeName, std::string_view attributeValue);

  void attribute(const char* name, std::string_view value);  // of the element begun last
  void text(std::string_view text);
  void textElement(const char* name, std::string_view text);

  // The document so far; complete when every scope has ended.
  std::string take();

 private:
  std::unique_ptr<xmlBuffer, decltype(&xmlBufferFree)> buffer_;
  std::unique_ptr<xmlTextWriter, decltype(&xmlFreeTextWriter)> writer_;
};

}  // namespace Cimom::CimXml
