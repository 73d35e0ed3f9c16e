#include "store/traces/readOnlyKernel.h"

namespace Project
{

PReadOnlyKernel::PReadOnlyKernel(const PKernel &other) : PKernel(other)
{
    const std::int64_t side = settings.size;
    const auto square = [&](std::int64_t first, std::int64_t extent, std::int32_t &from, std::int32_t &to) {
        from = Sarnik::CRect::Clamped(first + extent / 2 - side / 2);
        to = Sarnik::CRect::Clamped(from + side);
    };
    square(region.left, region.Width(), region.left, region.right);
    square(region.top, region.Height(), region.top, region.bottom);
    drawnRegion = region;
}

std::unique_ptr<PReadOnlyKernel> PReadOnlyKernel::Of(const PKernel &other)
{
    return std::unique_ptr<PReadOnlyKernel>(new PReadOnlyKernel(other));
}

} // namespace Project
