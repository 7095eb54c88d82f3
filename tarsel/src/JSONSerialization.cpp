#include "tarsel/JSONSerialization.h"

#include <cmath>
#include <limits>
#include <string>
#include <typeinfo>

#include <nlohmann/json.hpp>

#include "tarsel/ThrowError.h"

namespace tarsel::serialization {

namespace {

using config::ErrorLevel;
using config::ThrowError;
using nlohmann::json;

[[noreturn]] void ThrowBadText(const std::string& inReason) {
  ThrowError(ErrorLevel::kError, "$$$/tarsel/serialization/Error/BadJSON=The JSON text cannot be read: ^0",
             config::kErrorGroupContract, config::kErrorCodeConversion, false, inReason);
}

[[noreturn]] void ThrowTooDeep() {
  ThrowError(ErrorLevel::kError,
             "$$$/tarsel/serialization/Error/TooDeep=JSON values may not be nested more than ^0 deep.",
             config::kErrorGroupContract, config::kErrorCodeConversion, false, kMaxJSONDepth);
}

// Builds the values straight from the parser's events, so that no
// intermediate document is made and the depth can be limited before the
// nesting costs anything.
class AnyBuilder {
 public:
  bool null() { return Put(boost::any()); }
  bool boolean(bool inValue) { return Put(inValue); }
  bool number_integer(json::number_integer_t inValue) { return Put(static_cast<std::int64_t>(inValue)); }
  bool number_unsigned(json::number_unsigned_t inValue) {
    if (inValue <= static_cast<json::number_unsigned_t>(std::numeric_limits<std::int64_t>::max())) {
      return Put(static_cast<std::int64_t>(inValue));
    }
    return Put(static_cast<double>(inValue));
  }
  bool number_float(json::number_float_t inValue, const json::string_t&) { return Put(static_cast<double>(inValue)); }
  bool string(json::string_t& inValue) { return Put(utility::UTF8to16(inValue)); }
  bool binary(json::binary_t&) { return Fail("binary values are not JSON"); }
  bool start_object(std::size_t) { return Open(true); }
  bool key(json::string_t& inKey) {
    mStack.back().key.assign(inKey.data(), inKey.size());
    return true;
  }
  bool end_object() { return Close(); }
  bool start_array(std::size_t) { return Open(false); }
  bool end_array() { return Close(); }
  bool parse_error(std::size_t, const std::string&, const nlohmann::detail::exception& inError) {
    std::string message = inError.what();
    // Drop the library's "[json.exception.parse_error.101] " prefix.
    if (const auto close = message.find("] "); message.rfind("[json.", 0) == 0 && close != std::string::npos) {
      message.erase(0, close + 2);
    }
    return Fail(message);
  }

  const std::string& GetError() const { return mError; }
  bool TooDeep() const { return mTooDeep; }
  boost::any TakeResult() { return std::move(mResult); }

 private:
  struct Frame {
    bool isObject = false;
    JSONObject object;
    JSONArray array;
    UTF8String key;
  };

  bool Fail(std::string inMessage) {
    if (mError.empty()) mError = std::move(inMessage);
    return false;
  }

  bool Put(boost::any&& inValue) {
    if (mStack.empty()) {
      mResult = std::move(inValue);
    } else if (mStack.back().isObject) {
      Frame& top = mStack.back();
      top.object.insert_or_assign(top.key, std::move(inValue));
    } else {
      mStack.back().array.push_back(std::move(inValue));
    }
    return true;
  }

  bool Open(bool inObject) {
    if (mStack.size() >= kMaxJSONDepth) {
      mTooDeep = true;
      return Fail("too deep");
    }
    mStack.emplace_back();
    mStack.back().isObject = inObject;
    return true;
  }

  bool Close() {
    Frame frame = std::move(mStack.back());
    mStack.pop_back();
    if (frame.isObject) return Put(boost::any(std::move(frame.object)));
    return Put(boost::any(std::move(frame.array)));
  }

  std::vector<Frame> mStack;
  boost::any mResult;
  std::string mError;
  bool mTooDeep = false;
};

json ToJSON(const boost::any& inValue, std::size_t inDepth);

json NumberToJSON(double inValue) {
  if (!std::isfinite(inValue)) {
    ThrowError(ErrorLevel::kError,
               "$$$/tarsel/serialization/Error/NonFinite=The number ^0 cannot be written as JSON.",
               config::kErrorGroupContract, config::kErrorCodeConversion, false, inValue);
  }
  return json(inValue);
}

template <typename T>
const T* As(const boost::any& inValue) {
  return boost::any_cast<T>(&inValue);
}

json ToJSON(const boost::any& inValue, std::size_t inDepth) {
  if (inValue.empty()) return json(nullptr);
  if (const auto* v = As<bool>(inValue)) return json(*v);
  if (const auto* v = As<int>(inValue)) return json(*v);
  if (const auto* v = As<unsigned>(inValue)) return json(*v);
  if (const auto* v = As<long>(inValue)) return json(*v);
  if (const auto* v = As<unsigned long>(inValue)) return json(*v);
  if (const auto* v = As<long long>(inValue)) return json(*v);
  if (const auto* v = As<unsigned long long>(inValue)) return json(*v);
  if (const auto* v = As<float>(inValue)) return NumberToJSON(*v);
  if (const auto* v = As<double>(inValue)) return NumberToJSON(*v);
  if (const auto* v = As<UTF16String>(inValue)) return json(utility::ToStdString(utility::UTF16to8(*v)));
  if (const auto* v = As<UTF8String>(inValue)) return json(utility::ToStdString(*v));
  if (const auto* v = As<std::string>(inValue)) return json(*v);
  if (inDepth >= kMaxJSONDepth && (As<JSONObject>(inValue) || As<JSONArray>(inValue))) ThrowTooDeep();
  if (const auto* v = As<JSONObject>(inValue)) {
    json object = json::object();
    for (const auto& [key, value] : *v) object[utility::ToStdString(key)] = ToJSON(value, inDepth + 1);
    return object;
  }
  if (const auto* v = As<JSONArray>(inValue)) {
    json array = json::array();
    for (const boost::any& value : *v) array.push_back(ToJSON(value, inDepth + 1));
    return array;
  }
  ThrowError(ErrorLevel::kError,
             "$$$/tarsel/serialization/Error/UnsupportedType=A value of type ^0 cannot be written as JSON.",
             config::kErrorGroupContract, config::kErrorCodeConversion, false, inValue.type().name());
}

}  // namespace

boost::any JSONParse(std::string_view inText) {
  AnyBuilder builder;
  bool parsed = false;
  try {
    parsed = json::sax_parse(inText.begin(), inText.end(), &builder);
  } catch (const json::exception& error) {
    ThrowBadText(error.what());
  }
  if (builder.TooDeep()) ThrowTooDeep();
  if (!parsed) ThrowBadText(builder.GetError());
  return builder.TakeResult();
}

UTF8String GetJSONString(const boost::any& inValue) {
  const json document = ToJSON(inValue, 0);
  // Broken UTF-8 in 8-bit strings becomes U+FFFD rather than failing.
  const std::string text = document.dump(-1, ' ', false, json::error_handler_t::replace);
  return UTF8String(text.data(), text.size());
}

void AddToObject(boost::any& ioObject, std::string_view inKey, const boost::any& inValue) {
  if (ioObject.empty()) ioObject = JSONObject();
  auto* object = boost::any_cast<JSONObject>(&ioObject);
  if (!object) {
    ThrowError(ErrorLevel::kError,
               "$$$/tarsel/serialization/Error/NotAnObject=A property can only be added to a JSON object.",
               config::kErrorGroupContract, config::kErrorCodeConversion);
  }
  // Copy first: inValue may be a part of ioObject itself.
  boost::any value(inValue);
  object->insert_or_assign(UTF8String(inKey.data(), inKey.size()), std::move(value));
}

void AppendToArray(boost::any& ioArray, const boost::any& inValue) {
  if (ioArray.empty()) ioArray = JSONArray();
  auto* array = boost::any_cast<JSONArray>(&ioArray);
  if (!array) {
    ThrowError(ErrorLevel::kError,
               "$$$/tarsel/serialization/Error/NotAnArray=A value can only be appended to a JSON array.",
               config::kErrorGroupContract, config::kErrorCodeConversion);
  }
  boost::any value(inValue);
  array->push_back(std::move(value));
}

boost::any GetVariantInObject(const boost::any& inObject, std::string_view inKey) {
  const auto* object = boost::any_cast<JSONObject>(&inObject);
  if (!object) return boost::any();
  auto it = object->find(inKey);
  return it == object->end() ? boost::any() : it->second;
}

bool ObjectHasProperty(const boost::any& inObject, std::string_view inKey) {
  const auto* object = boost::any_cast<JSONObject>(&inObject);
  return object && object->find(inKey) != object->end();
}

}  // namespace tarsel::serialization
