#include "host/document/comparingSink.h"

#include <algorithm>
#include <cstring>

namespace Stillmark
{

void comparingSink::write(int plane, const rectangle &area, const planeSamples &codes)
{
    const auto sampleBytes = static_cast<std::size_t>(source.sampleBytes());
    const auto columns = static_cast<std::size_t>(area.width);
    const int rowsAtOnce = source.bandRows(area.width);
    for (int y = 0; y < area.height; y += rowsAtOnce)
    {
        const rectangle band{area.x, area.y + y, area.width, std::min(rowsAtOnce, area.height - y)};
        const planeSamples expected = source.plane(plane, band);
        for (int row = 0; row < band.height; ++row)
        {
            const std::byte *is = codes.row(y + row), *should = expected.row(row);
            if (std::memcmp(is, should, columns * sampleBytes) == 0)
                continue;
            for (std::size_t i = 0; i < columns; ++i)
                differing += std::memcmp(is + i * sampleBytes, should + i * sampleBytes, sampleBytes) != 0;
        }
    }
    const std::uint64_t count = static_cast<std::uint64_t>(columns) * static_cast<std::uint64_t>(area.height);
    written += count;
    if (plane == 0)
        pixels += count;
}

} // namespace Stillmark
