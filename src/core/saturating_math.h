#ifndef OVO_CORE_SATURATING_MATH_H
#define OVO_CORE_SATURATING_MATH_H

#include <cstdint>

namespace ovo {

// Rectangles, sizes and eye parameters come from the application, the profile and the
// control codes unchecked. Arithmetic on them that feeds a GL call is held to the int32
// range at either end instead of overflowing; within the range it is exact.

// 2^31, exact in single precision: every float below it and not below its negation fits.
constexpr float SATURATING_FLOAT_LIMIT = 2147483648.0f;

// Toward zero, as a cast; beyond the range its nearer end; NaN gives 0. A value in range
// costs two comparisons.
inline int32_t SaturatingTrunc(float value) {
    if (value < SATURATING_FLOAT_LIMIT && value >= -SATURATING_FLOAT_LIMIT) {
        return static_cast<int32_t>(value);
    }
    return value > 0.0f ? INT32_MAX : value < 0.0f ? INT32_MIN : 0;
}

inline int32_t SaturateToInt32(int64_t value) {
    return value > INT32_MAX ? INT32_MAX : value < INT32_MIN ? INT32_MIN : static_cast<int32_t>(value);
}

// Any two int32 sum and multiply exactly in 64 bits.
inline int32_t SaturatingAdd(int32_t a, int32_t b) {
    return SaturateToInt32(static_cast<int64_t>(a) + b);
}

inline int32_t SaturatingMul(int32_t a, int32_t b) {
    return SaturateToInt32(static_cast<int64_t>(a) * b);
}

}  // namespace ovo

#endif
