// SPDX-License-Identifier: Apache-2.0
// Writes an XML document into memory.
#pragma once

#include <algorithm>
#include <cstddef>
#include <string>
#include <string_view>
#include <vector>

namespace Cimom::CimXml {

// Whatever text it is given, the document is well-formed: what XML cannot carry becomes U+FFFD.
class XmlWriter {
 public:
  enum class Prolog { Declared, None };

  explicit XmlWriter(Prolog prolog = Prolog::Declared) {
    if (prolog == Prolog::Declared) {
      put("<?xml version=\"1.0\" encoding=\"UTF-8\"?>\n");
    }
  }

  // An element that ends with its scope.
  class [[nodiscard]] Scope {
   public:
    Scope(XmlWriter& writer, std::string_view name) : writer_(writer), name_(name) {}
    ~Scope() { writer_.endTag(name_); }
    Scope(const Scope&) = delete;
    Scope& operator=(const Scope&) = delete;

   private:
    XmlWriter& writer_;
    std::string_view name_;
  };

  // Names must outlive the element, as literals do.
  Scope element(std::string_view name) {
    startTag(name);
    return {*this, name};
  }
  Scope element(std::string_view name, std::string_view attributeName, std::string_view attributeValue) {
    startTag(name);
    attribute(attributeName, attributeValue);
    return {*this, name};
  }

  // Of the element begun last, before its content.
  void attribute(std::string_view name, std::string_view value) {
    put(" ", name, "=\"");
    escape(value, Place::AttributeValue);
    put("\"");
  }

  // The same of a value that needs no escape, as a name from the schema.
  void plainAttribute(std::string_view name, std::string_view value) { put(" ", name, "=\"", value, "\""); }

  void text(std::string_view text) {
    closeStartTag();
    escape(text, Place::Content);
  }

  void textElement(std::string_view name, std::string_view content) {
    const auto scope = element(name);
    text(content);
  }

  // Elements that another writer has written without a prolog.
  void written(std::string_view xml) {
    closeStartTag();
    put(xml);
  }

  // The document so far; complete when every scope has ended. In pieces, of which there is one at least: a large one
  // need not be moved while it grows.
  std::vector<std::string> takePieces();
  std::string take();

 private:
  enum class Place { Content, AttributeValue };

  void startTag(std::string_view name) {
    closeStartTag();
    room(name.size() + 1 + atEnd(name));
    reserved_ += atEnd(name);
    put("<", name);
    inStartTag_ = true;
  }

  // Room for it was made with the start tag, so that it cannot fail.
  void endTag(std::string_view name) {
    reserved_ -= atEnd(name);
    closeStartTag();
    put("</", name, ">");
  }

  void closeStartTag() {
    if (inStartTag_) {
      put(">");
      inStartTag_ = false;
    }
  }

  // What the end of an element takes at most: its tag, and the end of its start tag.
  static std::size_t atEnd(std::string_view name) { return name.size() + std::string_view("></>").size(); }

  void escape(std::string_view text, Place place);

  // An answer is many short pieces: they are copied to where there is room for them. In line, so that literals are
  // copied by a length that is known.
  template <typename... Pieces>
  [[gnu::always_inline]] void put(const Pieces&... pieces) {
    const auto copy = [](char* to, std::string_view piece) { return std::copy(piece.begin(), piece.end(), to); };
    char* at = room((std::string_view(pieces).size() + ...));
    ((at = copy(at, pieces)), ...);
    size_ = static_cast<std::size_t>(at - xml_.data());
  }

  char* room(std::size_t bytes) {
    if (xml_.size() - size_ - reserved_ < bytes) {
      grow(bytes);
    }
    return xml_.data() + size_;
  }

  void grow(std::size_t bytes);

  std::vector<std::string> pieces_;  // those that are full
  std::string xml_;
  std::size_t size_ = 0;      // of what is written in it; the rest is room
  std::size_t reserved_ = 0;  // of the room, for the ends of the elements that are open
  bool inStartTag_ = false;
};

}  // namespace Cimom::CimXml
