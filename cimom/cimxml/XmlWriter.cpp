// SPDX-License-Identifier: Apache-2.0
#include "cimom/cimxml/XmlWriter.h"

#include <new>

#include "cimom/cimxml/Utf8.h"

namespace Cimom::CimXml {
namespace {

const xmlChar* xmlChars(const char* text) { return reinterpret_cast<const xmlChar*>(text); }

}  // namespace

XmlWriter::XmlWriter(Prolog prolog)
    : buffer_(xmlBufferCreate(), &xmlBufferFree),
      writer_(xmlNewTextWriterMemory(buffer_.get(), 0), &xmlFreeTextWriter) {
  if (!buffer_ || !writer_) {
    throw std::bad_alloc();
  }
  if (prolog == Prolog::Declared) {
    xmlTextWriterStartDocument(writer_.get(), nullptr, "UTF-8", nullptr);
  }
}

XmlWriter::Scope::~Scope() { xmlTextWriterFullEndElement(writer_.writer_.get()); }

XmlWriter::Scope XmlWriter::element(const char* name) {
  xmlTextWriterStartElement(writer_.get(), xmlChars(name));
  return Scope(*this);
}

XmlWriter::Scope XmlWriter::element(const char* name, const char* attributeName, std::string_view attributeValue) {
  xmlTextWriterStartElement(writer_.get(), xmlChars(name));
  attribute(attributeName, attributeValue);
  return Scope(*this);
}

void XmlWriter::attribute(const char* name, std::string_view value) {
  xmlTextWriterWriteAttribute(writer_.get(), xmlChars(name), xmlChars(toXmlText(value).c_str()));
}

void XmlWriter::text(std::string_view text) {
  xmlTextWriterWriteString(writer_.get(), xmlChars(toXmlText(text).c_str()));
}

void XmlWriter::textElement(const char* name, std::string_view content) {
  const auto scope = element(name);
  text(content);
}

std::string XmlWriter::take() {
  xmlTextWriterFlush(writer_.get());
  return reinterpret_cast<const char*>(xmlBufferContent(buffer_.get()));
}

}  // namespace Cimom::CimXml
