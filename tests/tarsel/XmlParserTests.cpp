// The event-driven XML parser: the events a handler sees, errors with their
// lines, handlers that throw, and documents that try to reach outside.
#include <gtest/gtest.h>

#include <filesystem>
#include <fstream>
#include <stdexcept>
#include <string>
#include <vector>

#include "tarsel/ThrowError.h"
#include "tarsel/XmlParser.h"

using tarsel::config::Exception;
using tarsel::xml::AbstractParseHandler;
using tarsel::xml::Attributes;
using tarsel::xml::GetParser;

namespace {

// Records every event as one line of text; character pieces are joined.
class RecordingHandler : public AbstractParseHandler {
 public:
  void StartDocument() override { events.push_back("start-doc"); }
  void EndDocument() override { events.push_back("end-doc"); }
  void StartElement(std::string_view inName, const Attributes& inAttributes) override {
    std::string e = "<" + std::string(inName);
    for (const auto& [name, value] : inAttributes) e += " " + std::string(name.data(), name.size()) + "=" +
                                                         std::string(value.data(), value.size());
    events.push_back(e + ">");
  }
  void EndElement(std::string_view inName) override { events.push_back("</" + std::string(inName) + ">"); }
  void Characters(std::string_view inText) override {
    if (!events.empty() && events.back().rfind("text:", 0) == 0) {
      events.back() += std::string(inText);
    } else {
      events.push_back("text:" + std::string(inText));
    }
  }
  void Comment(std::string_view inText) override { events.push_back("comment:" + std::string(inText)); }
  void StartCDATA() override { events.push_back("cdata["); }
  void EndCDATA() override { events.push_back("]cdata"); }

  std::vector<std::string> events;
};

std::string ParseError(AbstractParseHandler& handler, const std::string& xml, std::string* outMessage = nullptr) {
  auto parser = GetParser(handler);
  try {
    parser->Parse(xml);
  } catch (const Exception& e) {
    if (outMessage) *outMessage = e.what();
    return e.GetKeyPath();
  }
  return "";
}

}  // namespace

TEST(XmlParserTests, ReportsEveryEventInDocumentOrder) {
  RecordingHandler handler;
  GetParser(handler)->Parse(
      "<?xml version='1.0'?><root a='1' b=\"two\"><!--note--><x>t&amp;<![CDATA[<c>]]></x></root>");
  const std::vector<std::string> expected = {"start-doc", "<root a=1 b=two>", "comment:note", "<x>",   "text:t&",
                                             "cdata[",    "text:<c>",         "]cdata",       "</x>", "</root>",
                                             "end-doc"};
  EXPECT_EQ(expected, handler.events);
}

TEST(XmlParserTests, SyntaxErrorsRaiseTheToolkitExceptionWithLineAndColumn) {
  RecordingHandler handler;
  std::string message;
  EXPECT_EQ("tarsel/xml/Error/Syntax", ParseError(handler, "<a>\n<b>\n</a>", &message));
  EXPECT_NE(std::string::npos, message.find("line 3")) << message;
  EXPECT_NE(std::string::npos, message.find("mismatched tag")) << message;
  EXPECT_EQ("tarsel/xml/Error/Syntax", ParseError(handler, ""));
  EXPECT_EQ("tarsel/xml/Error/Syntax", ParseError(handler, "<a></a><b/>")) << "two roots";
  EXPECT_EQ("tarsel/xml/Error/Syntax", ParseError(handler, "<a>&undefined;</a>"));
  EXPECT_EQ("tarsel/xml/Error/Syntax", ParseError(handler, "<a>\xFF\xFE</a>")) << "not UTF-8";
}

TEST(XmlParserTests, AnExceptionFromTheHandlerStopsParsingAndPassesThrough) {
  struct Throwing : RecordingHandler {
    void StartElement(std::string_view inName, const Attributes& inAttributes) override {
      RecordingHandler::StartElement(inName, inAttributes);
      if (inName == "stop") throw std::runtime_error("handler refused");
    }
  } handler;
  auto parser = GetParser(handler);
  EXPECT_THROW(parser->Parse("<a><stop/><after/></a>"), std::runtime_error);
  EXPECT_EQ((std::vector<std::string>{"start-doc", "<a>", "<stop>"}), handler.events)
      << "no event may follow the throw";

  handler.events.clear();
  parser->Parse("<fine/>");
  EXPECT_EQ((std::vector<std::string>{"start-doc", "<fine>", "</fine>", "end-doc"}), handler.events)
      << "the parser is usable again after a failure";
}

TEST(XmlParserTests, EntityDeclarationsAreRefusedSoEntitiesCannotExpand) {
  RecordingHandler handler;
  const std::string laughs =
      "<?xml version='1.0'?><!DOCTYPE lolz [<!ENTITY lol 'lol'><!ENTITY lol2 '&lol;&lol;&lol;&lol;'>]>"
      "<lolz>&lol2;</lolz>";
  EXPECT_EQ("tarsel/xml/Error/EntityDeclaration", ParseError(handler, laughs));
  const std::string external =
      "<?xml version='1.0'?><!DOCTYPE r [<!ENTITY x SYSTEM 'file:///etc/hostname'>]><r>&x;</r>";
  EXPECT_EQ("tarsel/xml/Error/EntityDeclaration", ParseError(handler, external));
  EXPECT_EQ("tarsel/xml/Error/ExternalReference",
            ParseError(handler, "<!DOCTYPE r SYSTEM 'file:///etc/hostname'><r>&x;</r>"));
  EXPECT_EQ("tarsel/xml/Error/ExternalReference",
            ParseError(handler, "<!DOCTYPE r PUBLIC '-//x//y' 'http://example.invalid/r.dtd'><r/>"));
  for (const std::string& e : handler.events) EXPECT_EQ(std::string::npos, e.find("text:")) << e;
}

TEST(XmlParserTests, NestingBeyondTheLimitIsRefused) {
  RecordingHandler handler;
  auto parser = GetParser(handler);
  parser->SetMaxDepth(3);
  EXPECT_NO_THROW(parser->Parse("<a><b><c/></b></a>"));
  try {
    parser->Parse("<a>\n<b>\n<c>\n<d/></c></b></a>");
    ADD_FAILURE() << "four levels must be refused";
  } catch (const Exception& e) {
    EXPECT_EQ("tarsel/xml/Error/TooDeep", e.GetKeyPath());
    EXPECT_NE(std::string::npos, std::string(e.what()).find("line 4")) << e.what();
  }
}

TEST(XmlParserTests, TheDefaultLimitStopsPathologicalNesting) {
  RecordingHandler handler;
  std::string xml;
  for (int i = 0; i < 100000; ++i) xml += "<a>";
  EXPECT_EQ("tarsel/xml/Error/TooDeep", ParseError(handler, xml));
}

TEST(XmlParserTests, TheHandlerCanAskForTheCurrentLine) {
  struct LineHandler : AbstractParseHandler {
    const tarsel::xml::AbstractDocParser* parser = nullptr;
    std::vector<std::size_t> lines;
    void StartElement(std::string_view, const Attributes&) override { lines.push_back(parser->GetCurrentLineNumber()); }
    void EndElement(std::string_view) override {}
    void Characters(std::string_view) override {}
  } handler;
  auto parser = GetParser(handler);
  handler.parser = parser.get();
  parser->Parse("<a>\r\n<b/>\r\n\r\n<c/></a>");
  EXPECT_EQ((std::vector<std::size_t>{1, 2, 4}), handler.lines);
}

TEST(XmlParserTests, FilesAreParsedAndMissingFilesRaise) {
  const auto path = std::filesystem::temp_directory_path() / "norvik_xml_parser_test.xml";
  {
    std::ofstream out(path, std::ios::binary);
    out << "<doc>file</doc>";
  }
  RecordingHandler handler;
  auto parser = GetParser(handler);
  parser->ParseFile(path.string());
  EXPECT_EQ((std::vector<std::string>{"start-doc", "<doc>", "text:file", "</doc>", "end-doc"}), handler.events);
  std::filesystem::remove(path);
  try {
    parser->ParseFile(path.string());
    ADD_FAILURE() << "a missing file must raise";
  } catch (const Exception& e) {
    EXPECT_EQ("tarsel/xml/Error/CannotReadFile", e.GetKeyPath());
  }
}
