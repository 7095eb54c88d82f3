#pragma once
// Helpers shared by the number readers of StringToNumber and Calculate. Not
// part of the public interface.
#include <string_view>

#include "tarsel/UTFString.h"

namespace tarsel::utility::detail {

// Reads plain ASCII number text ("-12.5e3", digits only, no grouping) that
// the caller has already checked for form. Raises NumberOutOfRange for
// magnitudes beyond a double; tiny numbers read as zero or denormals.
double ReadCheckedNumber(std::string_view inPlain, std::u16string_view inOriginal);

// The part of a hostile text that goes into an error message: at most a few
// dozen characters, control characters shown as U+FFFD.
UTF16String ExcerptForMessage(std::u16string_view inText);

}  // namespace tarsel::utility::detail
