#include "RandomSource.h"

namespace verbloom {

MersenneRandomSource::MersenneRandomSource(std::uint32_t seed)
    : m_engine(seed)
{
}

RandomSource &ProcessRandom()
{
    static MersenneRandomSource source;
    return source;
}

} // namespace verbloom
