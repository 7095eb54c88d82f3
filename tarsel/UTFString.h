#pragma once
// The two string types of the toolkit. UTF16String holds every visible text in
// 16-bit code units; UTF8String holds keys and identifiers. Both take their
// storage from SmallBlockAllocator.
#include <string>
#include <string_view>

#include "tarsel/SmallBlockAllocator.h"

namespace tarsel {

using UTF16String =
    std::basic_string<char16_t, std::char_traits<char16_t>, utility::SmallBlockStlAllocator<char16_t>>;
using UTF8String = std::basic_string<char, std::char_traits<char>, utility::SmallBlockStlAllocator<char>>;

namespace utility {
// Conversions between the encodings. Ill-formed input (a lone surrogate, a
// broken UTF-8 sequence) becomes U+FFFD instead of failing.
UTF16String UTF8to16(std::string_view inText);
UTF8String UTF16to8(std::u16string_view inText);
UTF16String AsciiToUTF16(std::string_view inText);
inline std::string ToStdString(const UTF8String& s) { return std::string(s.data(), s.size()); }
}  // namespace utility

}  // namespace tarsel

using UTF16String = tarsel::UTF16String;
using UTF8String = tarsel::UTF8String;
