#pragma once
// The rounding shared by number data, unit expressions and the fields built on
// them. Every conversion of a double to a 32-bit integer goes through
// TruncateToInt32, because a plain cast of a value outside the int range (or
// of NaN) is undefined behaviour.
#include <cstdint>

namespace norvik::controls {

// Truncates toward zero. NaN and values whose truncation lies outside the
// 32-bit range give the 32-bit minimum, which is what the processor's own
// truncating conversion answers for them.
std::int32_t TruncateToInt32(double inValue);

// Half away from zero, by adding or subtracting 0.5 and truncating: beyond the
// 32-bit range the result is the 32-bit minimum, as for TruncateToInt32.
std::int32_t RoundToInt32(double inValue);

// Whether a and b differ by less than inTolerance relative to the larger
// magnitude; a tolerance of 0 asks for exact equality.
bool NearlyEqual(double a, double b, double inTolerance);

}  // namespace norvik::controls
