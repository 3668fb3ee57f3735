// SPDX-License-Identifier: Apache-2.0
// Writes an XML document into memory.
#pragma once

#include <cstddef>
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
    Scope(XmlWriter& writer, std::string_view name) : writer_(writer), name_(name) {}
    ~Scope();
    Scope(const Scope&) = delete;
    Scope& operator=(const Scope&) = delete;

   private:
    XmlWriter& writer_;
    std::string_view name_;
  };

  // Names must outlive the element, as literals do.
  Scope element(std::string_view name);
  Scope element(std::string_view name, std::string_view attributeName, std::string_view attributeValue);

  void attribute(std::string_view name, std::string_view value);  // of the element begun last, before its content
  void text(std::string_view text);
  void textElement(std::string_view name, std::string_view text);
  // Elements that another writer has written without a prolog.
  void written(std::string_view xml);

  // The document so far; complete when every scope has ended.
  // Throws std::bad_alloc if memory ran out at the end of an element.
  std::string take();

 private:
  enum class Place { Content, AttributeValue };

  void endTag(std::string_view name);
  void closeStartTag();
  void escape(std::string_view text, Place place);
  template <typename... Pieces>
  void put(Pieces... pieces);
  char* room(std::size_t bytes);
  void grow(std::size_t bytes);

  // An answer is many short pieces: they are copied to where there is room for them.
  std::string xml_;
  std::size_t size_ = 0;  // of what is written; the rest is room
  bool inStartTag_ = false;
  bool isCut_ = false;
};

}  // namespace Cimom::CimXml
