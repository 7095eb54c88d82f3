#pragma once
// Structured values as JSON text. A value is a boost::any holding one of:
//
//   empty any          JSON null
//   bool               true, false
//   std::int64_t       a number written without fraction or exponent that
//                      fits in 64 signed bits
//   double             every other number
//   UTF16String        a string (visible texts are UTF-16 throughout)
//   JSONArray          an array: std::vector<boost::any>
//   JSONObject         an object: a map from UTF8String keys, in byte order
//
// JSONParse produces exactly these types. GetJSONString also writes the other
// integer and float types, UTF8String and std::string (as strings); any other
// type, a non-finite number or a structure nested deeper than kMaxJSONDepth
// raises the toolkit's exception. So does malformed JSON text: no exception
// of the underlying JSON library ever leaves these functions.
//
// Keys that appear twice in one object keep their last value.
#include <cstddef>
#include <cstdint>
#include <map>
#include <string_view>
#include <vector>

#include <boost/any.hpp>

#include "tarsel/UTFString.h"

namespace tarsel::serialization {

struct JSONKeyLess {
  using is_transparent = void;
  bool operator()(std::string_view a, std::string_view b) const { return a < b; }
};
using JSONObject = std::map<UTF8String, boost::any, JSONKeyLess>;
using JSONArray = std::vector<boost::any>;

constexpr std::size_t kMaxJSONDepth = 512;

boost::any JSONParse(std::string_view inText);
// Compact JSON text of the value.
UTF8String GetJSONString(const boost::any& inValue);

// Puts the value under the key, replacing what the key held. An empty ioObject
// becomes an object first; any other non-object raises the toolkit's exception.
void AddToObject(boost::any& ioObject, std::string_view inKey, const boost::any& inValue);
// Appends to an array, which an empty ioArray becomes first; any other
// non-array raises the toolkit's exception.
void AppendToArray(boost::any& ioArray, const boost::any& inValue);

// The value under the key; empty when inObject is no object or has no such
// key (ObjectHasProperty tells a missing key from a null value).
boost::any GetVariantInObject(const boost::any& inObject, std::string_view inKey);
bool ObjectHasProperty(const boost::any& inObject, std::string_view inKey);

}  // namespace tarsel::serialization
