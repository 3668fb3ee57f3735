// SPDX-License-Identifier: Apache-2.0
// An XML document in memory, and its elements as the request reader walks them.
#pragma once

#include <libxml/tree.h>

#include <memory>
#include <optional>
#include <string>
#include <string_view>

namespace Cimom::CimXml {

// What XML says of an element: comments, processing instructions and blanks between elements do not show. Errors are
// TransportErrors "request-not-valid" that name the element.
class Element {
 public:
  explicit Element(xmlNode* node) : node_(node) {}

  std::string_view name() const;
  bool is(std::string_view name) const { return this->name() == name; }

  std::optional<std::string> attribute(std::string_view name) const;
  std::string requiredAttribute(std::string_view name) const;

  // The character data, without outer blanks; an element inside is an error.
  std::string text() const;

  std::optional<Element> first() const;  // child
  std::optional<Element> next() const;   // sibling

  Element only() const;                            // the one child
  Element only(std::string_view childName) const;  // the one child, which has that name

  [[noreturn]] void refuse(const std::string& what) const;

 private:
  xmlNode* node_;
};

class Document {
 public:
  // Throws TransportError "request-not-well-formed", and as requireWithinLimits does. Nothing but the text is read: no
  // DTD, no external entity; a document nested deeper than 256 elements is refused.
  explicit Document(std::string_view xml);

  Element root() const;

 private:
  std::unique_ptr<xmlDoc, decltype(&xmlFreeDoc)> document_;
};

}  // namespace Cimom::CimXml
