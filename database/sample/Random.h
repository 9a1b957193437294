// SPDX-License-Identifier: MIT
#pragma once

#include <QtGlobal>
#include <array>

namespace database::sample {

/// A small generator of its own (splitmix64), so that a book is the same on every machine and with
/// every library.
class Random {
public:
    /// Two seeds that differ in one bit give unrelated numbers.
    Random(quint64 seed, quint64 stream) : state_(seed * 0x9E3779B97F4A7C15ULL ^ (stream << 32)) {
        next();
    }

    quint64 next() {
        quint64 z = (state_ += 0x9E3779B97F4A7C15ULL);
        z = (z ^ (z >> 30)) * 0xBF58476D1CE4E5B9ULL;
        z = (z ^ (z >> 27)) * 0x94D049BB133111EBULL;
        return z ^ (z >> 31);
    }
    /// 0 to n - 1.
    int below(int n) { return static_cast<int>(next() % static_cast<quint64>(n)); }
    /// Both ends included.
    int between(int low, int high) { return low + below(high - low + 1); }
    bool chance(int percent) { return below(100) < percent; }
    template <class Item, size_t N>
    const Item& pick(const std::array<Item, N>& items) {
        return items[next() % N];
    }

private:
    quint64 state_;
};

}  // namespace database::sample
