// SPDX-License-Identifier: Apache-2.0
#include "cimom/cimxml/Document.h"

#include <libxml/parser.h>

#include <mutex>

#include "cimom/cimxml/DocumentLimits.h"
#include "cimom/cimxml/Errors.h"

namespace Cimom::CimXml {
namespace {

using ParserContext = std::unique_ptr<xmlParserCtxt, decltype(&xmlFreeParserCtxt)>;

constexpr const char* blanks = " \t\r\n";

std::string_view view(const xmlChar* text) { return text ? reinterpret_cast<const char*>(text) : std::string_view(); }

bool isText(const xmlNode& node) { return node.type == XML_TEXT_NODE || node.type == XML_CDATA_SECTION_NODE; }

std::optional<Element> firstElement(xmlNode* node) {
  while (node && node->type != XML_ELEMENT_NODE) {
    node = node->next;
  }
  if (!node) {
    return std::nullopt;
  }
  return Element(node);
}

std::string trimmed(std::string text) {
  text.erase(text.find_last_not_of(blanks) + 1);
  text.erase(0, text.find_first_not_of(blanks));
  return text;
}

std::string describe(const xmlError& error) {
  return "line " + std::to_string(error.line) + ": " + (error.message ? trimmed(error.message) : "cannot be parsed");
}

}  // namespace

std::string_view Element::name() const { return view(node_->name); }

std::optional<std::string> Element::attribute(std::string_view name) const {
  for (const xmlAttr* candidate = node_->properties; candidate; candidate = candidate->next) {
    if (view(candidate->name) != name) {
      continue;
    }
    std::string value;
    for (const xmlNode* part = candidate->children; part; part = part->next) {
      value += view(part->content);
    }
    return value;
  }
  return std::nullopt;
}

std::string Element::requiredAttribute(std::string_view name) const {
  auto value = attribute(name);
  if (!value) {
    refuse("has no attribute " + std::string(name));
  }
  return *std::move(value);
}

std::string Element::text() const {
  std::string text;
  for (const xmlNode* part = node_->children; part; part = part->next) {
    if (isText(*part)) {
      text += view(part->content);
    } else if (part->type == XML_ELEMENT_NODE || part->type == XML_ENTITY_REF_NODE) {
      refuse("must contain only text, not " + std::string(view(part->name)));
    }
  }
  return trimmed(std::move(text));
}

std::optional<Element> Element::first() const { return firstElement(node_->children); }

std::optional<Element> Element::next() const { return firstElement(node_->next); }

Element Element::only() const {
  const auto child = first();
  if (!child) {
    refuse("is empty");
  }
  if (const auto second = child->next()) {
    refuse("must contain only one element, but " + std::string(second->name()) + " follows");
  }
  return *child;
}

Element Element::only(std::string_view childName) const {
  const Element child = only();
  if (!child.is(childName)) {
    refuse("must contain " + std::string(childName) + ", not " + std::string(child.name()));
  }
  return child;
}

void Element::refuse(const std::string& what) const {
  throw TransportError(400, "request-not-valid",
                       "line " + std::to_string(xmlGetLineNo(node_)) + ": " + std::string(name()) + " " + what);
}

Document::Document(std::string_view xml) : document_(nullptr, &xmlFreeDoc) {
  requireWithinLimits(xml);
  static std::once_flag initialized;
  std::call_once(initialized, xmlInitParser);
  const ParserContext context(xmlNewParserCtxt(), &xmlFreeParserCtxt);
  if (!context) {
    throw std::bad_alloc();
  }
  document_.reset(xmlCtxtReadMemory(context.get(), xml.data(), static_cast<int>(xml.size()), nullptr, nullptr,
                                    XML_PARSE_NONET | XML_PARSE_NOERROR | XML_PARSE_NOWARNING | XML_PARSE_COMPACT));
  if (!document_) {
    throw TransportError(400, "request-not-well-formed", describe(context->lastError));
  }
}

Element Document::root() const { return Element(xmlDocGetRootElement(document_.get())); }

}  // namespace Cimom::CimXml
