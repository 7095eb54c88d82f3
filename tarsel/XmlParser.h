#pragma once
// Event-driven XML reading. GetParser(handler) gives a parser that reports a
// document to an AbstractParseHandler as it reads it, element by element.
//
// The parser reads UTF-8 (or whatever the XML declaration names and the
// underlying reader knows), never loads anything from outside the text (no
// external entities, no DTD), refuses entity declarations altogether, and
// refuses documents nested deeper than its depth limit. Every failure, its
// own or one raised by the handler, leaves Parse as the toolkit's exception;
// syntax errors name the line.
#include <cstddef>
#include <memory>
#include <string>
#include <string_view>
#include <utility>
#include <vector>

#include "tarsel/UTFString.h"

namespace tarsel::xml {

// The attributes of one element, in document order.
class Attributes {
 public:
  using Entry = std::pair<UTF8String, UTF8String>;

  void Add(std::string_view inName, std::string_view inValue);
  // The value of the named attribute, or null.
  const UTF8String* Find(std::string_view inName) const;
  std::size_t Size() const { return mEntries.size(); }
  const Entry& operator[](std::size_t inIndex) const { return mEntries[inIndex]; }
  std::vector<Entry>::const_iterator begin() const { return mEntries.begin(); }
  std::vector<Entry>::const_iterator end() const { return mEntries.end(); }

 private:
  std::vector<Entry> mEntries;
};

class AbstractDocParser;

// Receives the events of one document. Texts are UTF-8 and are valid only for
// the duration of the call. A handler may throw to stop parsing; the exception
// leaves Parse unchanged if it is the toolkit's own.
class AbstractParseHandler {
 public:
  virtual ~AbstractParseHandler() = default;

  virtual void StartDocument() {}
  virtual void EndDocument() {}
  virtual void StartElement(std::string_view inName, const Attributes& inAttributes) = 0;
  virtual void EndElement(std::string_view inName) = 0;
  // Character data, possibly in several pieces for one run of text.
  virtual void Characters(std::string_view inText) = 0;
  virtual void Comment(std::string_view /*inText*/) {}
  virtual void StartCDATA() {}
  virtual void EndCDATA() {}
};

class AbstractDocParser {
 public:
  static constexpr std::size_t kDefaultMaxDepth = 256;

  virtual ~AbstractDocParser() = default;

  // Parses one complete document from text. A parser may be used again for
  // another document once the previous call has returned or thrown.
  virtual void Parse(std::string_view inText) = 0;
  // Reads the file and parses it; a file that cannot be read raises the
  // toolkit's exception naming the path.
  virtual void ParseFile(const std::string& inPath) = 0;

  // Line and column of the event being reported, for the handler's messages.
  virtual std::size_t GetCurrentLineNumber() const = 0;
  virtual std::size_t GetCurrentColumnNumber() const = 0;

  // Deepest element nesting accepted; deeper documents are refused.
  virtual void SetMaxDepth(std::size_t inDepth) = 0;
  virtual std::size_t GetMaxDepth() const = 0;
};

// A parser that reports to inHandler, which must outlive it.
std::unique_ptr<AbstractDocParser> GetParser(AbstractParseHandler& inHandler);

}  // namespace tarsel::xml
