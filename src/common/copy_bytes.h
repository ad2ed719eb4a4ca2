#pragma once

#include <cstddef>
#include <cstring>

namespace ardcard {

// Most pieces the writers copy (a field, a tag) are a few bytes: two
// overlapping moves of fixed size copy them without a call to the library's
// memcpy, inline in every caller.
[[gnu::always_inline]] inline void CopyBytes(char* to, const char* from, std::size_t n) {
    if (n >= 8 && n <= 16) {
        std::memcpy(to, from, 8);
        std::memcpy(to + n - 8, from + n - 8, 8);
    } else if (n >= 4 && n < 8) {
        std::memcpy(to, from, 4);
        std::memcpy(to + n - 4, from + n - 4, 4);
    } else if (n > 0 && n < 4) {
        to[0] = from[0];
        to[n / 2] = from[n / 2];
        to[n - 1] = from[n - 1];
    } else if (n > 16) {
        std::memcpy(to, from, n);
    }
}

} // namespace ardcard
