#include "tarsel/XmlParser.h"

#include <climits>
#include <exception>
#include <fstream>
#include <iterator>
#include <sstream>

#include <expat.h>

#include "tarsel/ThrowError.h"

namespace tarsel::xml {

void Attributes::Add(std::string_view inName, std::string_view inValue) {
  mEntries.emplace_back(UTF8String(inName.data(), inName.size()), UTF8String(inValue.data(), inValue.size()));
}

const UTF8String* Attributes::Find(std::string_view inName) const {
  for (const Entry& entry : mEntries) {
    if (std::string_view(entry.first) == inName) return &entry.second;
  }
  return nullptr;
}

namespace {

using config::ErrorLevel;
using config::ThrowError;

// Why the parser stopped itself, when it was not expat that found the error.
enum class StopReason { kNone, kTooDeep, kEntityDeclaration, kExternalReference, kHandlerThrew };

class ExpatDocParser final : public AbstractDocParser {
 public:
  explicit ExpatDocParser(AbstractParseHandler& inHandler) : mHandler(inHandler) {}
  ~ExpatDocParser() override { FreeParser(); }

  void Parse(std::string_view inText) override;
  void ParseFile(const std::string& inPath) override;
  std::size_t GetCurrentLineNumber() const override;
  std::size_t GetCurrentColumnNumber() const override;
  void SetMaxDepth(std::size_t inDepth) override { mMaxDepth = inDepth; }
  std::size_t GetMaxDepth() const override { return mMaxDepth; }

 private:
  void CreateParser();
  void FreeParser();
  bool Feed(std::string_view inText);
  [[noreturn]] void RaiseFailure();
  void Stop(StopReason inReason);
  // Runs a handler call, turning an escaping exception into a stop: an
  // exception must never unwind through expat's C frames.
  template <typename F>
  void Guarded(F&& inCall);

  static void XMLCALL OnStartElement(void* inData, const XML_Char* inName, const XML_Char** inAttributes);
  static void XMLCALL OnEndElement(void* inData, const XML_Char* inName);
  static void XMLCALL OnCharacters(void* inData, const XML_Char* inText, int inLength);
  static void XMLCALL OnComment(void* inData, const XML_Char* inText);
  static void XMLCALL OnStartCDATA(void* inData);
  static void XMLCALL OnEndCDATA(void* inData);
  static void XMLCALL OnStartDoctype(void* inData, const XML_Char* inName, const XML_Char* inSystemId,
                                     const XML_Char* inPublicId, int inHasInternalSubset);
  static void XMLCALL OnSkippedEntity(void* inData, const XML_Char* inName, int inIsParameterEntity);
  static void XMLCALL OnEntityDecl(void* inData, const XML_Char*, int, const XML_Char*, int, const XML_Char*,
                                   const XML_Char*, const XML_Char*, const XML_Char*);

  AbstractParseHandler& mHandler;
  XML_Parser mParser = nullptr;
  std::size_t mMaxDepth = kDefaultMaxDepth;
  std::size_t mDepth = 0;
  StopReason mStopReason = StopReason::kNone;
  std::size_t mStopLine = 0;
  std::exception_ptr mHandlerError;
  Attributes mAttributes;
};

void ExpatDocParser::CreateParser() {
  FreeParser();
  mParser = XML_ParserCreate(nullptr);
  if (!mParser) throw std::bad_alloc();
  XML_SetUserData(mParser, this);
  XML_SetElementHandler(mParser, &OnStartElement, &OnEndElement);
  XML_SetCharacterDataHandler(mParser, &OnCharacters);
  XML_SetCommentHandler(mParser, &OnComment);
  XML_SetCdataSectionHandler(mParser, &OnStartCDATA, &OnEndCDATA);
  XML_SetEntityDeclHandler(mParser, &OnEntityDecl);
  XML_SetStartDoctypeDeclHandler(mParser, &OnStartDoctype);
  XML_SetSkippedEntityHandler(mParser, &OnSkippedEntity);
  XML_SetParamEntityParsing(mParser, XML_PARAM_ENTITY_PARSING_NEVER);
  mDepth = 0;
  mStopReason = StopReason::kNone;
  mStopLine = 0;
  mHandlerError = nullptr;
}

void ExpatDocParser::FreeParser() {
  if (mParser) XML_ParserFree(mParser);
  mParser = nullptr;
}

bool ExpatDocParser::Feed(std::string_view inText) {
  // expat takes lengths as int; long texts go in slices.
  constexpr std::size_t kSlice = 1u << 24;
  do {
    const std::size_t length = std::min(inText.size(), kSlice);
    const bool last = length == inText.size();
    if (XML_Parse(mParser, inText.data(), static_cast<int>(length), last ? 1 : 0) != XML_STATUS_OK) return false;
    inText.remove_prefix(length);
  } while (!inText.empty());
  return true;
}

void ExpatDocParser::Parse(std::string_view inText) {
  CreateParser();
  Guarded([this] { mHandler.StartDocument(); });
  if (mStopReason != StopReason::kNone || !Feed(inText)) RaiseFailure();
  FreeParser();
  mHandler.EndDocument();
}

void ExpatDocParser::ParseFile(const std::string& inPath) {
  std::ifstream file(inPath, std::ios::binary);
  std::ostringstream contents;
  if (file) contents << file.rdbuf();
  if (!file || file.bad()) {
    ThrowError(ErrorLevel::kError, "$$$/tarsel/xml/Error/CannotReadFile=The XML file \"^0\" cannot be read.",
               config::kErrorGroupResources, 2, false, inPath);
  }
  Parse(contents.str());
}

std::size_t ExpatDocParser::GetCurrentLineNumber() const {
  return mParser ? static_cast<std::size_t>(XML_GetCurrentLineNumber(mParser)) : 0;
}

std::size_t ExpatDocParser::GetCurrentColumnNumber() const {
  return mParser ? static_cast<std::size_t>(XML_GetCurrentColumnNumber(mParser)) + 1 : 0;
}

void ExpatDocParser::RaiseFailure() {
  const StopReason reason = mStopReason;
  const std::size_t stopLine = mStopLine;
  std::exception_ptr handlerError = mHandlerError;
  const std::size_t line = GetCurrentLineNumber();
  const std::size_t column = GetCurrentColumnNumber();
  const char* expatMessage = mParser ? XML_ErrorString(XML_GetErrorCode(mParser)) : nullptr;
  FreeParser();
  switch (reason) {
    case StopReason::kHandlerThrew:
      std::rethrow_exception(handlerError);
    case StopReason::kTooDeep:
      ThrowError(ErrorLevel::kError,
                 "$$$/tarsel/xml/Error/TooDeep=XML error at line ^0: elements are nested more than ^1 deep.",
                 config::kErrorGroupResources, 2, false, stopLine, mMaxDepth);
    case StopReason::kEntityDeclaration:
      ThrowError(ErrorLevel::kError,
                 "$$$/tarsel/xml/Error/EntityDeclaration=XML error at line ^0: entity declarations are not allowed.",
                 config::kErrorGroupResources, 2, false, stopLine);
    case StopReason::kExternalReference:
      ThrowError(ErrorLevel::kError,
                 "$$$/tarsel/xml/Error/ExternalReference=XML error at line ^0: "
                 "references to definitions outside the document are not allowed.",
                 config::kErrorGroupResources, 2, false, stopLine);
    case StopReason::kNone:
      break;
  }
  ThrowError(ErrorLevel::kError, "$$$/tarsel/xml/Error/Syntax=XML error at line ^0, column ^1: ^2.",
             config::kErrorGroupResources, 2, false, line, column, expatMessage ? expatMessage : "unknown error");
}

void ExpatDocParser::Stop(StopReason inReason) {
  if (mStopReason != StopReason::kNone) return;
  mStopReason = inReason;
  mStopLine = GetCurrentLineNumber();
  XML_StopParser(mParser, XML_FALSE);
}

template <typename F>
void ExpatDocParser::Guarded(F&& inCall) {
  if (mStopReason != StopReason::kNone) return;
  try {
    inCall();
  } catch (...) {
    mHandlerError = std::current_exception();
    if (mParser) {
      Stop(StopReason::kHandlerThrew);
    } else {
      mStopReason = StopReason::kHandlerThrew;
    }
  }
}

void XMLCALL ExpatDocParser::OnStartElement(void* inData, const XML_Char* inName, const XML_Char** inAttributes) {
  auto* self = static_cast<ExpatDocParser*>(inData);
  if (self->mStopReason != StopReason::kNone) return;
  if (++self->mDepth > self->mMaxDepth) {
    self->Stop(StopReason::kTooDeep);
    return;
  }
  self->Guarded([self, inName, inAttributes] {
    self->mAttributes = Attributes();
    for (const XML_Char** a = inAttributes; a && a[0]; a += 2) self->mAttributes.Add(a[0], a[1]);
    self->mHandler.StartElement(inName, self->mAttributes);
  });
}

void XMLCALL ExpatDocParser::OnEndElement(void* inData, const XML_Char* inName) {
  auto* self = static_cast<ExpatDocParser*>(inData);
  if (self->mDepth > 0) --self->mDepth;
  self->Guarded([self, inName] { self->mHandler.EndElement(inName); });
}

void XMLCALL ExpatDocParser::OnCharacters(void* inData, const XML_Char* inText, int inLength) {
  auto* self = static_cast<ExpatDocParser*>(inData);
  self->Guarded([self, inText, inLength] {
    self->mHandler.Characters(std::string_view(inText, static_cast<std::size_t>(inLength)));
  });
}

void XMLCALL ExpatDocParser::OnComment(void* inData, const XML_Char* inText) {
  auto* self = static_cast<ExpatDocParser*>(inData);
  self->Guarded([self, inText] { self->mHandler.Comment(inText); });
}

void XMLCALL ExpatDocParser::OnStartCDATA(void* inData) {
  auto* self = static_cast<ExpatDocParser*>(inData);
  self->Guarded([self] { self->mHandler.StartCDATA(); });
}

void XMLCALL ExpatDocParser::OnEndCDATA(void* inData) {
  auto* self = static_cast<ExpatDocParser*>(inData);
  self->Guarded([self] { self->mHandler.EndCDATA(); });
}

void XMLCALL ExpatDocParser::OnEntityDecl(void* inData, const XML_Char*, int, const XML_Char*, int,
                                          const XML_Char*, const XML_Char*, const XML_Char*, const XML_Char*) {
  static_cast<ExpatDocParser*>(inData)->Stop(StopReason::kEntityDeclaration);
}

// A document type that lives elsewhere could declare entities that the text
// then uses; since nothing outside the text is ever read, such a document is
// refused rather than read with its entities silently dropped.
void XMLCALL ExpatDocParser::OnStartDoctype(void* inData, const XML_Char*, const XML_Char* inSystemId,
                                            const XML_Char* inPublicId, int) {
  if (inSystemId || inPublicId) static_cast<ExpatDocParser*>(inData)->Stop(StopReason::kExternalReference);
}

void XMLCALL ExpatDocParser::OnSkippedEntity(void* inData, const XML_Char*, int) {
  static_cast<ExpatDocParser*>(inData)->Stop(StopReason::kExternalReference);
}

}  // namespace

std::unique_ptr<AbstractDocParser> GetParser(AbstractParseHandler& inHandler) {
  return std::make_unique<ExpatDocParser>(inHandler);
}

}  // namespace tarsel::xml
