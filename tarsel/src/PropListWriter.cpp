// Writing property lists as XML text, and the point and rectangle helpers.
#include <algorithm>
#include <cmath>
#include <cstdio>
#include <cstring>
#include <filesystem>
#include <fstream>
#include <limits>

#include "tarsel/PropListUtils.h"
#include "tarsel/ThrowError.h"

namespace tarsel::proplist::utils {

namespace {

constexpr const char* kLineEnd = "\r\n";

// printf gives at least two exponent digits; documents carry three.
std::string WidenExponent(std::string inText) {
  const std::size_t e = inText.find('e');
  if (e == std::string::npos || e + 2 >= inText.size()) return inText;
  const std::size_t digits = inText.size() - (e + 2);
  if (digits < 3) inText.insert(e + 2, 3 - digits, '0');
  return inText;
}

std::string FormatNumber(double inValue, int inPrecision) {
  if (std::isnan(inValue)) return "nan";
  if (std::isinf(inValue)) return inValue < 0 ? "-inf" : "inf";
  char buffer[64];
  std::snprintf(buffer, sizeof(buffer), "%.*g", inPrecision, inValue);
  return WidenExponent(buffer);
}

// Code points that an XML 1.0 document cannot carry, even as references.
bool IsXmlChar(char32_t c) {
  if (c < 0x20) return c == 0x09 || c == 0x0A || c == 0x0D;
  if (c >= 0xD800 && c <= 0xDFFF) return false;
  return c != 0xFFFE && c != 0xFFFF;
}

bool IsPlainAscii(char32_t c) { return c >= 0x20 && c < 0x7F && c != '&' && c != '<' && c != '>'; }

void AppendEscapedUTF16(std::string& out, std::u16string_view inText) {
  // Most texts of a document are plain ASCII: copy those straight across.
  if (std::all_of(inText.begin(), inText.end(), [](char16_t c) { return IsPlainAscii(c); })) {
    for (char16_t c : inText) out.push_back(static_cast<char>(c));
    return;
  }
  UTF16String clean;
  clean.reserve(inText.size());
  for (std::size_t i = 0; i < inText.size(); ++i) {
    const char16_t c = inText[i];
    if (c >= 0xD800 && c <= 0xDBFF && i + 1 < inText.size() && inText[i + 1] >= 0xDC00 && inText[i + 1] <= 0xDFFF) {
      clean.push_back(c);
      clean.push_back(inText[++i]);
    } else if (!IsXmlChar(c)) {
      clean.push_back(u'\xFFFD');
    } else {
      clean.push_back(c);
    }
  }
  const UTF8String utf8 = utility::UTF16to8(clean);
  for (char c : utf8) {
    switch (c) {
      case '&': out += "&amp;"; break;
      case '<': out += "&lt;"; break;
      case '>': out += "&gt;"; break;
      // References keep line ends inside texts from being normalised on
      // reading, and keep every line of the document ending in CR LF.
      case '\r': out += "&#13;"; break;
      case '\n': out += "&#10;"; break;
      default: out.push_back(c);
    }
  }
}

void AppendEscapedUTF8(std::string& out, std::string_view inText) {
  if (std::all_of(inText.begin(), inText.end(), [](char c) { return IsPlainAscii(static_cast<unsigned char>(c)); })) {
    out.append(inText);
    return;
  }
  // Decoding replaces broken UTF-8 sequences, which XML cannot carry either.
  AppendEscapedUTF16(out, utility::UTF8to16(inText));
}

void Indent(std::string& out, int inDepth) { out.append(static_cast<std::size_t>(inDepth) * 2, ' '); }

// The opening of a value element without its closing bracket, e.g.
// "<int type='signed' size='32'".
const char* ElementOpening(ValueType inType) {
  switch (inType) {
    case ValueType::kInt32:
    case ValueType::kInt32Array: return "<int type='signed' size='32'";
    case ValueType::kUInt32:
    case ValueType::kUInt32Array: return "<int type='unsigned' size='32'";
    case ValueType::kFloat:
    case ValueType::kFloatArray: return "<float";
    case ValueType::kDouble:
    case ValueType::kDoubleArray: return "<float size='64'";
    case ValueType::kString:
    case ValueType::kStringArray: return "<string";
    default: return "<ustring";
  }
}

const char* ElementName(ValueType inType) {
  switch (inType) {
    case ValueType::kInt32:
    case ValueType::kUInt32: return "int";
    case ValueType::kFloat:
    case ValueType::kDouble: return "float";
    case ValueType::kString: return "string";
    default: return "ustring";
  }
}

struct ScalarWriter {
  std::string& out;
  void operator()(std::int32_t v) const { out += std::to_string(v); }
  void operator()(std::uint32_t v) const { out += std::to_string(v); }
  void operator()(float v) const { out += FormatFloat(v); }
  void operator()(double v) const { out += FormatNumber(v, 17); }
  void operator()(const UTF8String& v) const { AppendEscapedUTF8(out, v); }
  void operator()(const UTF16String& v) const { AppendEscapedUTF16(out, v); }
};

template <typename T>
void WriteScalar(std::string& out, ValueType inType, const T& inValue, int inDepth) {
  Indent(out, inDepth);
  out += ElementOpening(inType);
  out += '>';
  ScalarWriter{out}(inValue);
  out += "</";
  out += ElementName(inType);
  out += '>';
  out += kLineEnd;
}

template <typename T>
void WriteArray(std::string& out, ValueType inArrayType, ValueType inElementType, const std::vector<T>& inValues,
                int inDepth) {
  Indent(out, inDepth);
  out += "<array>";
  out += kLineEnd;
  Indent(out, inDepth + 1);
  out += "<array.type>";
  out += ElementOpening(inArrayType);
  out += "/></array.type>";
  out += kLineEnd;
  for (const T& value : inValues) WriteScalar(out, inElementType, value, inDepth + 1);
  Indent(out, inDepth);
  out += "</array>";
  out += kLineEnd;
}

void WriteList(std::string& out, const PropList& inList, int inDepth);

void WriteValue(std::string& out, const PropValue& inValue, int inDepth) {
  const PropValue::Storage& s = inValue.GetStorage();
  switch (inValue.GetType()) {
    case ValueType::kBool:
      Indent(out, inDepth);
      out += std::get<bool>(s) ? "<true/>" : "<false/>";
      out += kLineEnd;
      break;
    case ValueType::kInt32: WriteScalar(out, ValueType::kInt32, std::get<std::int32_t>(s), inDepth); break;
    case ValueType::kUInt32: WriteScalar(out, ValueType::kUInt32, std::get<std::uint32_t>(s), inDepth); break;
    case ValueType::kFloat: WriteScalar(out, ValueType::kFloat, std::get<float>(s), inDepth); break;
    case ValueType::kDouble: WriteScalar(out, ValueType::kDouble, std::get<double>(s), inDepth); break;
    case ValueType::kString: WriteScalar(out, ValueType::kString, std::get<UTF8String>(s), inDepth); break;
    case ValueType::kUString: WriteScalar(out, ValueType::kUString, std::get<UTF16String>(s), inDepth); break;
    case ValueType::kList: {
      // Not `list ? *list : PropList()`: the conditional would copy the whole
      // nested list, at every level, before writing it.
      static const PropList kEmpty;
      const PropListP& list = std::get<PropListP>(s);
      WriteList(out, list ? *list : kEmpty, inDepth);
      break;
    }
    case ValueType::kInt32Array:
      WriteArray(out, ValueType::kInt32Array, ValueType::kInt32, std::get<std::vector<std::int32_t>>(s), inDepth);
      break;
    case ValueType::kUInt32Array:
      WriteArray(out, ValueType::kUInt32Array, ValueType::kUInt32, std::get<std::vector<std::uint32_t>>(s),
                 inDepth);
      break;
    case ValueType::kFloatArray:
      WriteArray(out, ValueType::kFloatArray, ValueType::kFloat, std::get<std::vector<float>>(s), inDepth);
      break;
    case ValueType::kDoubleArray:
      WriteArray(out, ValueType::kDoubleArray, ValueType::kDouble, std::get<std::vector<double>>(s), inDepth);
      break;
    case ValueType::kStringArray:
      WriteArray(out, ValueType::kStringArray, ValueType::kString, std::get<std::vector<UTF8String>>(s), inDepth);
      break;
    case ValueType::kUStringArray:
      WriteArray(out, ValueType::kUStringArray, ValueType::kUString, std::get<std::vector<UTF16String>>(s),
                 inDepth);
      break;
    case ValueType::kNone: break;
  }
}

void WriteList(std::string& out, const PropList& inList, int inDepth) {
  Indent(out, inDepth);
  out += "<prop.list>";
  out += kLineEnd;
  for (const auto& [key, value] : inList) {
    Indent(out, inDepth + 1);
    out += "<prop.pair>";
    out += kLineEnd;
    Indent(out, inDepth + 2);
    out += "<key>";
    AppendEscapedUTF8(out, key);
    out += "</key>";
    out += kLineEnd;
    WriteValue(out, value, inDepth + 2);
    Indent(out, inDepth + 1);
    out += "</prop.pair>";
    out += kLineEnd;
  }
  Indent(out, inDepth);
  out += "</prop.list>";
  out += kLineEnd;
}

std::int32_t ClampToInt32(long inValue) {
  return static_cast<std::int32_t>(std::clamp<long>(inValue, std::numeric_limits<std::int32_t>::min(),
                                                    std::numeric_limits<std::int32_t>::max()));
}

template <typename T, std::size_t N>
bool ReadNumbers(const PropList& inList, std::string_view inKey, T (&outValues)[N]) {
  const PropValue* value = inList.FindValue(inKey);
  const auto* values = value ? value->GetIf<std::vector<T>>() : nullptr;
  if (!values || values->size() != N) return false;
  std::copy(values->begin(), values->end(), outValues);
  return true;
}

}  // namespace

std::string FormatFloat(float inValue) { return FormatNumber(inValue, 6); }

UTF8String WritePropList(const PropList& inList) {
  std::string out;
  out += "<?xml version='1.0'?>";
  out += kLineEnd;
  out += "<prop.map version='4'>";
  out += kLineEnd;
  WriteList(out, inList, 1);
  out += "</prop.map>";
  out += kLineEnd;
  return UTF8String(out.data(), out.size());
}

void SavePropList(const std::string& inPath, const PropList& inList) {
  const UTF8String text = WritePropList(inList);
  // Write beside the target and rename, so that a failed save never leaves a
  // half-written document where a good one stood.
  const std::string temporary = inPath + ".saving";
  bool written = false;
  {
    std::ofstream file(temporary, std::ios::binary | std::ios::trunc);
    if (file) {
      file.write(text.data(), static_cast<std::streamsize>(text.size()));
      file.close();
      written = !file.fail();
    }
  }
  std::error_code error;
  if (written) std::filesystem::rename(temporary, inPath, error);
  if (!written || error) {
    std::filesystem::remove(temporary, error);
    config::ThrowError(config::ErrorLevel::kError,
                       "$$$/tarsel/proplist/Error/CannotWrite=The property list file \"^0\" cannot be written.",
                       config::kErrorGroupResources, 2, false, inPath);
  }
}

bool ReadPoint32(const PropList& inList, std::string_view inKey, geom::PointT<long>& outPoint) {
  std::int32_t v[2];
  if (!ReadNumbers(inList, inKey, v)) return false;
  outPoint = geom::PointT<long>(v[0], v[1]);
  return true;
}

void WritePoint32(PropList& ioList, std::string_view inKey, const geom::PointT<long>& inPoint) {
  ioList.SetValue(inKey, std::vector<std::int32_t>{ClampToInt32(inPoint.x), ClampToInt32(inPoint.y)});
}

bool ReadPointF32(const PropList& inList, std::string_view inKey, geom::PointT<float>& outPoint) {
  float v[2];
  if (!ReadNumbers(inList, inKey, v)) return false;
  outPoint = geom::PointT<float>(v[0], v[1]);
  return true;
}

void WritePointF32(PropList& ioList, std::string_view inKey, const geom::PointT<float>& inPoint) {
  ioList.SetValue(inKey, std::vector<float>{inPoint.x, inPoint.y});
}

bool ReadRect32(const PropList& inList, std::string_view inKey, geom::RectT<long>& outRect) {
  std::int32_t v[4];
  if (!ReadNumbers(inList, inKey, v)) return false;
  outRect = geom::RectT<long>(v[0], v[1], v[2], v[3]);
  return true;
}

void WriteRect32(PropList& ioList, std::string_view inKey, const geom::RectT<long>& inRect) {
  ioList.SetValue(inKey, std::vector<std::int32_t>{ClampToInt32(inRect.left), ClampToInt32(inRect.top),
                                                   ClampToInt32(inRect.width), ClampToInt32(inRect.height)});
}

bool ReadRectF32(const PropList& inList, std::string_view inKey, geom::RectT<float>& outRect) {
  float v[4];
  if (!ReadNumbers(inList, inKey, v)) return false;
  outRect = geom::RectT<float>(v[0], v[1], v[2], v[3]);
  return true;
}

void WriteRectF32(PropList& ioList, std::string_view inKey, const geom::RectT<float>& inRect) {
  ioList.SetValue(inKey, std::vector<float>{inRect.left, inRect.top, inRect.width, inRect.height});
}

}  // namespace tarsel::proplist::utils
