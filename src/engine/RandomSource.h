#pragma once

#include <cstdint>
#include <random>

namespace verbloom {

/// A source of uniform draws u in [0, 1).
class RandomSource
{
public:
    virtual ~RandomSource() = default;
    virtual double NextUniform() = 0;
};

/// Mersenne Twister draws: each u is built from two 32-bit outputs (53 bits), so the same seed
/// gives the same draws on every machine and standard library.
class MersenneRandomSource final : public RandomSource
{
public:
    explicit MersenneRandomSource(std::uint32_t seed = std::mt19937::default_seed);
    /// u = ((a >> 5) * 2^26 + (b >> 6)) / 2^53 from two outputs a, b: a 53-bit fraction, exact
    /// in a double. Defined here so that the spin loop can inline it.
    double NextUniform() override
    {
        const auto a = static_cast<std::uint32_t>(m_engine());
        const auto b = static_cast<std::uint32_t>(m_engine());
        return ((a >> 5) * 67108864.0 + (b >> 6)) / 9007199254740992.0;
    }

private:
    std::mt19937 m_engine;
};

/// The one random source of the process. It is never seeded: every start repeats its draws.
RandomSource &ProcessRandom();

} // namespace verbloom
