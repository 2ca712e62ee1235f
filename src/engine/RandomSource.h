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
    double NextUniform() override;

private:
    std::mt19937 m_engine;
};

/// The one random source of the process. It is never seeded: every start repeats its draws.
RandomSource &ProcessRandom();

} // namespace verbloom
