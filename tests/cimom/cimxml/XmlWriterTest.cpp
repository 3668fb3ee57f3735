// SPDX-License-Identifier: Apache-2.0
#include <gtest/gtest.h>

#include "cimom/cimxml/Document.h"
#include "cimom/cimxml/XmlWriter.h"

namespace {

using namespace Cimom::CimXml;

TEST(XmlWriterTest, NestsElementsAsTheirScopesNest) {
  XmlWriter xml;
  {
    const auto outer = xml.element("A", "X", "1");
    xml.textElement("B", "text");
    const auto inner = xml.element("C");
  }
  EXPECT_EQ(xml.take(), "<?xml version=\"1.0\" encoding=\"UTF-8\"?>\n<A X=\"1\"><B>text</B><C></C></A>");
}

TEST(XmlWriterTest, WritesNoPrologWhereNoneIsWanted) {
  XmlWriter xml(XmlWriter::Prolog::None);
  xml.textElement("A", "");
  EXPECT_EQ(xml.take().substr(0, 2), "<A");
}

TEST(XmlWriterTest, WritesTextThatReadsBackAsItWas) {
  const std::string text = "<a b=\"c\">&amp; ]]> 'd' \t\r\n€ \xF0\x9F\x98\x80 end";
  XmlWriter xml;
  {
    const auto element = xml.element("A", "X", text);
    xml.text(text);
  }
  const Document document(xml.take());
  EXPECT_EQ(document.root().attribute("X"), text);
  EXPECT_EQ(document.root().text(), text);
}

TEST(XmlWriterTest, TakesWhatAnotherWriterWrote) {
  XmlWriter inner(XmlWriter::Prolog::None);
  inner.textElement("B", "<");
  XmlWriter xml(XmlWriter::Prolog::None);
  {
    const auto element = xml.element("A");
    xml.written(inner.take());
  }
  EXPECT_EQ(xml.take(), "<A><B>&lt;</B></A>");
}

TEST(XmlWriterTest, StaysWellFormedWhateverTheText) {
  for (int byte = 0; byte < 256; ++byte) {
    const std::string text = std::string("a") + static_cast<char>(byte) + "b";
    XmlWriter xml;
    {
      const auto element = xml.element("A", "X", text);
      xml.text(text);
    }
    EXPECT_NO_THROW(Document(xml.take())) << byte;
  }
}

}  // namespace
