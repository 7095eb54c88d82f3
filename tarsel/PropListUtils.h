#pragma once
// The XML text of property lists, and points and rectangles stored in them.
//
// A document is written as:
//
//   <?xml version='1.0'?>
//   <prop.map version='4'>
//     <prop.list>
//       <prop.pair>
//         <key>count</key>
//         <int type='unsigned' size='32'>2</int>
//       </prop.pair>
//       ...
//     </prop.list>
//   </prop.map>
//
// with every line ending in CR LF, two spaces of indentation per level, and
// the pairs of each list in byte order of their keys. Values: `int` (signed or
// unsigned, 32 bits), `float` (32 bits, six significant digits, exponents of
// three digits such as "-1.07374e+008"), `float size='64'` for doubles
// (seventeen significant digits, so that they read back exactly), `string`
// (8-bit text), `ustring` (UTF-16 text written as UTF-8), the empty elements
// `true` and `false`, a nested `prop.list`, and `array`, whose `array.type`
// holds an empty element naming the element type, followed by one element per
// entry. Line ends and other control characters inside texts are written as
// character references so that every line of the document ends in CR LF.
//
// Reading takes what writing gives, with any whitespace between elements and
// either line ending, pairs in any order, and prop.map versions 1 to 4.
// Anything else (text that is not well formed, unknown elements or attributes,
// numbers that do not parse or do not fit, a pair without a value, a key
// given twice) raises the toolkit's exception with a message naming the line.
//
// Points are arrays of two numbers (x, y), rectangles arrays of four (left,
// top, width, height): signed 32-bit integers for the "32" forms and 32-bit
// floats for the "F32" forms. The integer writers clamp to the 32-bit range.
#include <cstdint>
#include <string>
#include <string_view>

#include "tarsel/PointT.h"
#include "tarsel/PropList.h"
#include "tarsel/RectT.h"
#include "tarsel/UTFString.h"

namespace tarsel::proplist::utils {

// Replaces the content of outList with the document in inXML.
void ReadPropList(std::string_view inXML, PropList& outList);
// The document for inList.
UTF8String WritePropList(const PropList& inList);

// The same through a file. Load raises the toolkit's exception when the file
// cannot be read or does not hold a document; Save when it cannot be written.
void LoadPropList(const std::string& inPath, PropList& outList);
void SavePropList(const std::string& inPath, const PropList& inList);

// Each Read answers false, leaving the output as it was, when the key is
// missing or does not hold an array of the right type and length.
bool ReadPoint32(const PropList& inList, std::string_view inKey, geom::PointT<long>& outPoint);
void WritePoint32(PropList& ioList, std::string_view inKey, const geom::PointT<long>& inPoint);
bool ReadPointF32(const PropList& inList, std::string_view inKey, geom::PointT<float>& outPoint);
void WritePointF32(PropList& ioList, std::string_view inKey, const geom::PointT<float>& inPoint);
bool ReadRect32(const PropList& inList, std::string_view inKey, geom::RectT<long>& outRect);
void WriteRect32(PropList& ioList, std::string_view inKey, const geom::RectT<long>& inRect);
bool ReadRectF32(const PropList& inList, std::string_view inKey, geom::RectT<float>& outRect);
void WriteRectF32(PropList& ioList, std::string_view inKey, const geom::RectT<float>& inRect);

// The text of a float as documents hold it ("300", "-1.07374e+008").
std::string FormatFloat(float inValue);

}  // namespace tarsel::proplist::utils
