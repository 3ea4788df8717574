// SoakRandom: the soak's seeded generator. The same seed gives the same
// sequence on every machine and build (splitmix64, and no standard
// distribution, whose results the standard leaves to the library).
#pragma once

#include <climits>
#include <cstddef>
#include <cstdint>

class SoakRandom {
public:
    explicit SoakRandom(std::uint64_t seed) : m_state(seed) {}

    std::uint64_t Next()
    {
        std::uint64_t z = (m_state += 0x9E3779B97F4A7C15ull);
        z = (z ^ (z >> 30)) * 0xBF58476D1CE4E5B9ull;
        z = (z ^ (z >> 27)) * 0x94D049BB133111EBull;
        return z ^ (z >> 31);
    }

    // 0 ... n - 1; 0 for n <= 0.
    int Below(int n) { return n <= 0 ? 0 : static_cast<int>(Next() % static_cast<std::uint64_t>(n)); }
    // low ... high, both included.
    int Between(int low, int high)
    {
        const std::uint64_t span = static_cast<std::uint64_t>(static_cast<long long>(high) - low) + 1;
        return static_cast<int>(low + static_cast<long long>(Next() % span));
    }
    bool Chance(int percent) { return Below(100) < percent; }

    template <class T, std::size_t N>
    const T& Pick(const T (&values)[N])
    {
        return values[Below(static_cast<int>(N))];
    }

    // An int an application should never pass, now and then an ordinary one.
    int AbsurdInt()
    {
        static constexpr int values[] = {0, 1, -1, 2, 7, -3, 100, -100, 12345, 1 << 20, -(1 << 20), 1 << 30,
                                         -(1 << 30), INT_MAX, INT_MIN, INT_MAX - 1, INT_MIN + 1};
        return Chance(20) ? static_cast<int>(Next()) : Pick(values);
    }

private:
    std::uint64_t m_state;
};
