// The two conversions the operation factory applies to the doubles that constants and value
// limits arrive as: whether one is a whole number, and its 64-bit integer value.
#pragma once

#include <cmath>
#include <cstdint>
#include <limits>

namespace itf {

// Finite and equal to its truncation: 2.0 is a whole number, 2.5, infinity and NaN are not.
inline bool isIntegerValue(double value) {
    return std::isfinite(value) && value == std::trunc(value);
}

// Truncates toward zero; values beyond the 64-bit range saturate and NaN becomes 0, so that a
// huge limit or constant never overflows into undefined behaviour.
inline std::int64_t satCastToInt64(double value) {
    constexpr double kTwoTo63 = 9223372036854775808.0;
    if (std::isnan(value))
        return 0;
    if (value >= kTwoTo63)
        return std::numeric_limits<std::int64_t>::max();
    if (value < -kTwoTo63)
        return std::numeric_limits<std::int64_t>::min();
    return static_cast<std::int64_t>(value);
}

} // namespace itf
