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

TEST(XmlWriterTest, KeepsALargeDocumentInPieces) {
  const auto write = [](XmlWriter& xml) {
    const auto outer = xml.element("A");
    for (std::size_t size = 0; size < 600; ++size) {
      xml.textElement("B", std::string(size, 'x'));
    }
    xml.textElement("C", std::string(200'000, '<'));
  };
  std::string expected = "<A>";
  for (std::size_t size = 0; size < 600; ++size) {
    expected += "<B>" + std::string(size, 'x') + "</B>";
  }
  expected += "<C>";
  for (int count = 0; count < 200'000; ++count) {
    expected += "&lt;";
  }
  expected += "</C></A>";

  XmlWriter whole(XmlWriter::Prolog::None);
  write(whole);
  EXPECT_EQ(whole.take(), expected);

  XmlWriter parted(XmlWriter::Prolog::None);
  write(parted);
  std::string joined;
  const auto pieces = parted.takePieces();
  EXPECT_GT(pieces.size(), 4u);
  for (const std::string& piece : pieces) {
    joined += piece;
  }
  EXPECT_EQ(joined, expected);
  EXPECT_EQ(parted.take(), "");
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
