#pragma once

#include <QStringView>
#include <QtGlobal>
#include <span>

namespace ardcard::demo::detail {

// The demo's own random numbers (SplitMix64): the same seed gives the same
// sequence on every platform and library, which the standard distributions
// do not promise.
class DemoRandom {
public:
    explicit DemoRandom(quint64 seed) : state_(seed) {}

    quint64 next() {
        quint64 z = (state_ += 0x9E3779B97F4A7C15ULL);
        z = (z ^ (z >> 30)) * 0xBF58476D1CE4E5B9ULL;
        z = (z ^ (z >> 27)) * 0x94D049BB133111EBULL;
        return z ^ (z >> 31);
    }
    // 0 .. n-1
    int below(int n) { return static_cast<int>(next() % static_cast<quint64>(n)); }
    // lo .. hi, both included
    int between(int lo, int hi) { return lo + below(hi - lo + 1); }
    bool chance(int percent) { return below(100) < percent; }
    QStringView pick(std::span<const QStringView> words) {
        return words[static_cast<size_t>(below(static_cast<int>(words.size())))];
    }

private:
    quint64 state_;
};

} // namespace ardcard::demo::detail
