// Reading property lists from XML text, on top of the event-driven parser.
#include <algorithm>
#include <charconv>
#include <fstream>
#include <sstream>

#include "tarsel/PropListUtils.h"
#include "tarsel/ThrowError.h"
#include "tarsel/XmlParser.h"

namespace tarsel::proplist::utils {

namespace {

using config::ErrorLevel;
using config::ThrowError;

// Element nesting accepted in documents: two elements per list level, so
// about five hundred levels of sub-lists.
constexpr std::size_t kMaxElementDepth = 1024;

enum class Kind { kMap, kList, kPair, kKey, kScalar, kBool, kArray, kArrayType, kTypeName };

// Scalar element types; also the element types of arrays.
enum class Scalar { kInt32, kUInt32, kFloat, kDouble, kString, kUString };

struct Frame {
  Kind kind = Kind::kMap;
  Scalar scalar = Scalar::kString;  // kScalar, kTypeName
  PropListP list;                   // kList
  UTF8String key;                   // kPair
  bool hasKey = false;              // kPair
  bool hasValue = false;            // kPair; for kArray: whether array.type was read
  bool truth = false;               // kBool
  PropValue value;                  // kPair: its value; kArray: the entries
  std::string text;                 // kKey, kScalar
};

bool IsXmlSpace(char c) { return c == ' ' || c == '\t' || c == '\n' || c == '\r'; }

std::string_view Trim(std::string_view inText) {
  while (!inText.empty() && IsXmlSpace(inText.front())) inText.remove_prefix(1);
  while (!inText.empty() && IsXmlSpace(inText.back())) inText.remove_suffix(1);
  return inText;
}

const char* ScalarName(Scalar inType) {
  switch (inType) {
    case Scalar::kInt32: return "signed 32-bit integer";
    case Scalar::kUInt32: return "unsigned 32-bit integer";
    case Scalar::kFloat: return "32-bit float";
    case Scalar::kDouble: return "64-bit float";
    case Scalar::kString: return "string";
    case Scalar::kUString: return "ustring";
  }
  return "";
}

class PropListHandler final : public xml::AbstractParseHandler {
 public:
  explicit PropListHandler(PropList& outList) : mResult(outList) {}

  void SetParser(const xml::AbstractDocParser* inParser) { mParser = inParser; }

  void StartElement(std::string_view inName, const xml::Attributes& inAttributes) override;
  void EndElement(std::string_view inName) override;
  void Characters(std::string_view inText) override;
  void EndDocument() override;

 private:
  std::size_t Line() const { return mParser ? mParser->GetCurrentLineNumber() : 0; }
  [[noreturn]] void Fail(std::string_view inKeyText, const config::ReplacementValue& in1 = {},
                         const config::ReplacementValue& in2 = {}) const;
  void Push(Kind inKind, Scalar inScalar = Scalar::kString);
  void CheckAttributes(std::string_view inName, const xml::Attributes& inAttributes,
                       std::initializer_list<std::string_view> inAllowed) const;
  Scalar ReadIntType(const xml::Attributes& inAttributes) const;
  Scalar ReadFloatType(const xml::Attributes& inAttributes) const;
  bool StartValue(std::string_view inName, const xml::Attributes& inAttributes, Kind& outKind,
                  Scalar& outScalar) const;
  void StartMap(std::string_view inName, const xml::Attributes& inAttributes);
  // Each answers false when the element does not belong where it stands.
  bool StartInPair(std::string_view inName, const xml::Attributes& inAttributes);
  bool StartInArray(std::string_view inName, const xml::Attributes& inAttributes);
  void StartInArrayType(std::string_view inName, const xml::Attributes& inAttributes);
  PropValue ParseScalar(Scalar inType, const std::string& inText) const;
  void Deliver(PropValue&& inValue);
  void DeliverToArray(Frame& ioArray, PropValue&& inValue);
  void FinishPair(Frame& ioPair);

  PropList& mResult;
  const xml::AbstractDocParser* mParser = nullptr;
  std::vector<Frame> mStack;
  PropList mDocument;
  bool mHasMap = false;
  bool mHasList = false;
};

void PropListHandler::Fail(std::string_view inKeyText, const config::ReplacementValue& in1,
                           const config::ReplacementValue& in2) const {
  ThrowError(ErrorLevel::kError, inKeyText, config::kErrorGroupResources, 2, false, Line(), in1, in2);
}

void PropListHandler::Push(Kind inKind, Scalar inScalar) {
  Frame frame;
  frame.kind = inKind;
  frame.scalar = inScalar;
  if (inKind == Kind::kList) frame.list = PropListP(new PropList());
  mStack.push_back(std::move(frame));
}

void PropListHandler::CheckAttributes(std::string_view inName, const xml::Attributes& inAttributes,
                                      std::initializer_list<std::string_view> inAllowed) const {
  for (const auto& [name, value] : inAttributes) {
    if (std::find(inAllowed.begin(), inAllowed.end(), std::string_view(name)) == inAllowed.end()) {
      Fail("$$$/tarsel/proplist/Error/BadAttribute=Property list error at line ^0: "
           "the element \"^1\" cannot have the attribute \"^2\".",
           inName, name);
    }
  }
}

Scalar PropListHandler::ReadIntType(const xml::Attributes& inAttributes) const {
  CheckAttributes("int", inAttributes, {"type", "size"});
  const UTF8String* type = inAttributes.Find("type");
  const UTF8String* size = inAttributes.Find("size");
  if (!type || (*type != "signed" && *type != "unsigned") || (size && *size != "32")) {
    Fail("$$$/tarsel/proplist/Error/BadIntType=Property list error at line ^0: "
         "an int must be of type 'signed' or 'unsigned' and size '32'.");
  }
  return *type == "signed" ? Scalar::kInt32 : Scalar::kUInt32;
}

Scalar PropListHandler::ReadFloatType(const xml::Attributes& inAttributes) const {
  CheckAttributes("float", inAttributes, {"size"});
  const UTF8String* size = inAttributes.Find("size");
  if (!size || *size == "32") return Scalar::kFloat;
  if (*size == "64") return Scalar::kDouble;
  Fail("$$$/tarsel/proplist/Error/BadFloatSize=Property list error at line ^0: a float must have size '32' or '64'.");
}

// Recognises the value elements; answers false for any other name.
bool PropListHandler::StartValue(std::string_view inName, const xml::Attributes& inAttributes, Kind& outKind,
                                 Scalar& outScalar) const {
  if (inName == "int") {
    outKind = Kind::kScalar;
    outScalar = ReadIntType(inAttributes);
  } else if (inName == "float") {
    outKind = Kind::kScalar;
    outScalar = ReadFloatType(inAttributes);
  } else if (inName == "string" || inName == "ustring") {
    CheckAttributes(inName, inAttributes, {});
    outKind = Kind::kScalar;
    outScalar = inName == "string" ? Scalar::kString : Scalar::kUString;
  } else if (inName == "true" || inName == "false") {
    CheckAttributes(inName, inAttributes, {});
    outKind = Kind::kBool;
  } else if (inName == "prop.list") {
    CheckAttributes(inName, inAttributes, {});
    outKind = Kind::kList;
  } else if (inName == "array") {
    CheckAttributes(inName, inAttributes, {});
    outKind = Kind::kArray;
  } else {
    return false;
  }
  return true;
}

void PropListHandler::StartInArrayType(std::string_view inName, const xml::Attributes& inAttributes) {
  Frame& arrayFrame = mStack[mStack.size() - 2];
  Kind kind = Kind::kMap;
  Scalar scalar = Scalar::kString;
  if (!StartValue(inName, inAttributes, kind, scalar) || kind != Kind::kScalar) {
    Fail("$$$/tarsel/proplist/Error/BadArrayType=Property list error at line ^0: "
         "\"^1\" cannot be the type of an array.",
         inName);
  }
  if (arrayFrame.hasValue) {
    Fail("$$$/tarsel/proplist/Error/TwoArrayTypes=Property list error at line ^0: an array names more than one type.");
  }
  arrayFrame.hasValue = true;
  arrayFrame.scalar = scalar;
  switch (scalar) {
    case Scalar::kInt32: arrayFrame.value = PropValue(std::vector<std::int32_t>()); break;
    case Scalar::kUInt32: arrayFrame.value = PropValue(std::vector<std::uint32_t>()); break;
    case Scalar::kFloat: arrayFrame.value = PropValue(std::vector<float>()); break;
    case Scalar::kDouble: arrayFrame.value = PropValue(std::vector<double>()); break;
    case Scalar::kString: arrayFrame.value = PropValue(std::vector<UTF8String>()); break;
    case Scalar::kUString: arrayFrame.value = PropValue(std::vector<UTF16String>()); break;
  }
  Push(Kind::kTypeName, scalar);
}

void PropListHandler::StartMap(std::string_view inName, const xml::Attributes& inAttributes) {
  if (inName != "prop.map" || mHasMap) {
    Fail("$$$/tarsel/proplist/Error/NotAPropList=Property list error at line ^0: "
         "the document is not a property list (it starts with \"^1\").",
         inName);
  }
  CheckAttributes(inName, inAttributes, {"version"});
  const UTF8String* version = inAttributes.Find("version");
  if (!version || version->size() != 1 || (*version)[0] < '1' || (*version)[0] > '4') {
    Fail("$$$/tarsel/proplist/Error/BadVersion=Property list error at line ^0: "
         "prop.map version \"^1\" is not supported.",
         version ? *version : UTF8String());
  }
  mHasMap = true;
  Push(Kind::kMap);
}

bool PropListHandler::StartInPair(std::string_view inName, const xml::Attributes& inAttributes) {
  const Frame& pair = mStack.back();
  if (inName == "key") {
    CheckAttributes(inName, inAttributes, {});
    if (pair.hasKey || pair.hasValue) {
      Fail("$$$/tarsel/proplist/Error/MisplacedKey=Property list error at line ^0: "
           "a key must come once, before the value.");
    }
    Push(Kind::kKey);
    return true;
  }
  Kind kind = Kind::kMap;
  Scalar scalar = Scalar::kString;
  if (!StartValue(inName, inAttributes, kind, scalar)) return false;
  if (!pair.hasKey) {
    Fail("$$$/tarsel/proplist/Error/MissingKey=Property list error at line ^0: a pair has a value before its key.");
  }
  Push(kind, scalar);
  mStack.back().truth = inName == "true";
  return true;
}

bool PropListHandler::StartInArray(std::string_view inName, const xml::Attributes& inAttributes) {
  const Frame& array = mStack.back();
  if (!array.hasValue) {
    if (inName != "array.type") return false;
    CheckAttributes(inName, inAttributes, {});
    Push(Kind::kArrayType);
    return true;
  }
  Kind kind = Kind::kMap;
  Scalar scalar = Scalar::kString;
  if (!StartValue(inName, inAttributes, kind, scalar)) return false;
  if (kind != Kind::kScalar || scalar != array.scalar) {
    Fail("$$$/tarsel/proplist/Error/ArrayEntryType=Property list error at line ^0: "
         "the entry \"^1\" does not match the type of its array.",
         inName);
  }
  Push(kind, scalar);
  return true;
}

void PropListHandler::StartElement(std::string_view inName, const xml::Attributes& inAttributes) {
  if (mStack.empty()) {
    StartMap(inName, inAttributes);
    return;
  }
  bool accepted = false;
  switch (mStack.back().kind) {
    case Kind::kMap:
      if (inName == "prop.list" && !mHasList) {
        CheckAttributes(inName, inAttributes, {});
        mHasList = true;
        Push(Kind::kList);
        accepted = true;
      }
      break;
    case Kind::kList:
      if (inName == "prop.pair") {
        CheckAttributes(inName, inAttributes, {});
        Push(Kind::kPair);
        accepted = true;
      }
      break;
    case Kind::kPair: accepted = StartInPair(inName, inAttributes); break;
    case Kind::kArray: accepted = StartInArray(inName, inAttributes); break;
    case Kind::kArrayType:
      StartInArrayType(inName, inAttributes);
      accepted = true;
      break;
    case Kind::kKey:
    case Kind::kScalar:
    case Kind::kBool:
    case Kind::kTypeName: break;
  }
  if (!accepted) {
    Fail("$$$/tarsel/proplist/Error/UnexpectedElement=Property list error at line ^0: "
         "the element \"^1\" is not allowed here.",
         inName);
  }
}

void PropListHandler::Characters(std::string_view inText) {
  if (!mStack.empty() && (mStack.back().kind == Kind::kKey || mStack.back().kind == Kind::kScalar)) {
    mStack.back().text.append(inText);
    return;
  }
  if (!Trim(inText).empty()) {
    Fail("$$$/tarsel/proplist/Error/UnexpectedText=Property list error at line ^0: text is not allowed here.");
  }
}

PropValue PropListHandler::ParseScalar(Scalar inType, const std::string& inText) const {
  if (inType == Scalar::kString) return PropValue(UTF8String(inText.data(), inText.size()));
  if (inType == Scalar::kUString) return PropValue(utility::UTF8to16(inText));
  const std::string_view text = Trim(inText);
  const char* first = text.data();
  const char* last = text.data() + text.size();
  std::from_chars_result result{first, std::errc::invalid_argument};
  PropValue value;
  switch (inType) {
    case Scalar::kInt32: {
      std::int32_t v = 0;
      result = std::from_chars(first, last, v);
      value = PropValue(v);
      break;
    }
    case Scalar::kUInt32: {
      std::uint32_t v = 0;
      result = std::from_chars(first, last, v);
      value = PropValue(v);
      break;
    }
    case Scalar::kFloat: {
      float v = 0;
      result = std::from_chars(first, last, v);
      value = PropValue(v);
      break;
    }
    case Scalar::kDouble: {
      double v = 0;
      result = std::from_chars(first, last, v);
      value = PropValue(v);
      break;
    }
    default: break;
  }
  if (text.empty() || result.ec != std::errc() || result.ptr != last) {
    Fail("$$$/tarsel/proplist/Error/BadNumber=Property list error at line ^0: \"^1\" is not a valid ^2.",
         std::string(text.substr(0, 64)), ScalarName(inType));
  }
  return value;
}

void PropListHandler::DeliverToArray(Frame& ioArray, PropValue&& inValue) {
  PropValue::Storage& entries = ioArray.value.GetStorage();
  // StartElement has checked that the entry has the array's type.
  const PropValue::Storage& entry = inValue.GetStorage();
  switch (ioArray.scalar) {
    case Scalar::kInt32: std::get<std::vector<std::int32_t>>(entries).push_back(std::get<std::int32_t>(entry)); break;
    case Scalar::kUInt32:
      std::get<std::vector<std::uint32_t>>(entries).push_back(std::get<std::uint32_t>(entry));
      break;
    case Scalar::kFloat: std::get<std::vector<float>>(entries).push_back(std::get<float>(entry)); break;
    case Scalar::kDouble: std::get<std::vector<double>>(entries).push_back(std::get<double>(entry)); break;
    case Scalar::kString:
      std::get<std::vector<UTF8String>>(entries).push_back(std::move(std::get<UTF8String>(inValue.GetStorage())));
      break;
    case Scalar::kUString:
      std::get<std::vector<UTF16String>>(entries).push_back(std::move(std::get<UTF16String>(inValue.GetStorage())));
      break;
  }
}

void PropListHandler::Deliver(PropValue&& inValue) {
  Frame& parent = mStack.back();
  if (parent.kind == Kind::kArray) {
    DeliverToArray(parent, std::move(inValue));
    return;
  }
  if (parent.kind == Kind::kMap) {
    mDocument = std::move(*std::get<PropListP>(inValue.GetStorage()));
    return;
  }
  if (parent.hasValue) {
    Fail("$$$/tarsel/proplist/Error/TwoValues=Property list error at line ^0: the pair \"^1\" has more than one value.",
         parent.key);
  }
  parent.hasValue = true;
  parent.value = std::move(inValue);
}

void PropListHandler::FinishPair(Frame& ioPair) {
  if (!ioPair.hasValue) {
    Fail("$$$/tarsel/proplist/Error/MissingValue=Property list error at line ^0: the pair \"^1\" has no value.",
         ioPair.key);
  }
  PropList& list = *mStack.back().list;
  if (list.HasKey(ioPair.key)) {
    Fail("$$$/tarsel/proplist/Error/DuplicateKey=Property list error at line ^0: the key \"^1\" appears twice.",
         ioPair.key);
  }
  list.SetPropValue(ioPair.key, std::move(ioPair.value));
}

void PropListHandler::EndElement(std::string_view /*inName*/) {
  // expat has already matched the end tag to its start.
  Frame frame = std::move(mStack.back());
  mStack.pop_back();
  switch (frame.kind) {
    case Kind::kMap:
      if (!mHasList) {
        Fail("$$$/tarsel/proplist/Error/NoList=Property list error at line ^0: prop.map holds no prop.list.");
      }
      break;
    case Kind::kList: Deliver(PropValue(frame.list)); break;
    case Kind::kPair: FinishPair(frame); break;
    case Kind::kKey:
      mStack.back().hasKey = true;
      mStack.back().key = UTF8String(frame.text.data(), frame.text.size());
      break;
    case Kind::kScalar: Deliver(ParseScalar(frame.scalar, frame.text)); break;
    case Kind::kBool: Deliver(PropValue(frame.truth)); break;
    case Kind::kArray:
      if (!frame.hasValue) {
        Fail("$$$/tarsel/proplist/Error/NoArrayType=Property list error at line ^0: an array does not name its type.");
      }
      Deliver(std::move(frame.value));
      break;
    case Kind::kArrayType:
      if (!mStack.back().hasValue) {
        Fail("$$$/tarsel/proplist/Error/NoArrayType=Property list error at line ^0: an array does not name its type.");
      }
      break;
    case Kind::kTypeName: break;
  }
}

void PropListHandler::EndDocument() { mResult = std::move(mDocument); }

}  // namespace

void ReadPropList(std::string_view inXML, PropList& outList) {
  PropList document;
  PropListHandler handler(document);
  std::unique_ptr<xml::AbstractDocParser> parser = xml::GetParser(handler);
  handler.SetParser(parser.get());
  parser->SetMaxDepth(kMaxElementDepth);
  try {
    parser->Parse(inXML);
  } catch (const config::Exception& error) {
    if (error.GetKeyPath().rfind("tarsel/xml/", 0) != 0) throw;
    ThrowError(ErrorLevel::kError,
               "$$$/tarsel/proplist/Error/NotWellFormed=The property list cannot be read. ^0",
               config::kErrorGroupResources, 2, false, error.GetMessage());
  }
  outList = std::move(document);
}

void LoadPropList(const std::string& inPath, PropList& outList) {
  std::ifstream file(inPath, std::ios::binary);
  std::ostringstream contents;
  if (file) contents << file.rdbuf();
  if (!file || file.bad()) {
    ThrowError(ErrorLevel::kError,
               "$$$/tarsel/proplist/Error/CannotRead=The property list file \"^0\" cannot be read.",
               config::kErrorGroupResources, 2, false, inPath);
  }
  ReadPropList(contents.str(), outList);
}

}  // namespace tarsel::proplist::utils
