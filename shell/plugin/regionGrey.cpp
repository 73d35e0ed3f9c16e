#include "shell/plugin/regionGrey.h"

#include "framework/base/exceptions.h"

#include <algorithm>
#include <cmath>
#include <cstring>
#include <optional>

namespace Project
{

using CorvaneDeblur::byteArray;
using CorvaneDeblur::floatArray;
using Sarnik::CMemoryPixmap;
using Sarnik::CRect;

namespace
{

/// Rows are converted in bands of about this many bytes of double-precision grey.
constexpr std::int64_t bandBytes = 4 << 20;

float usable(double grey)
{
    return std::isfinite(grey) ? static_cast<float>(std::clamp(grey, -1000.0, 1000.0)) : 0.0f;
}

} // namespace

void ReadRegionGrey(Sarnik::CPixmap &source, const CRect &rect, const Sarnik::CGreySource &about,
                    const floatArray &grey, const byteArray &mask)
{
    if (rect.Empty())
        return;
    const auto rowsAtOnce = static_cast<std::int32_t>(
        std::clamp<std::int64_t>(bandBytes / (rect.Width() * std::int64_t{sizeof(double)}), 1, rect.Height()));
    for (std::int32_t top = rect.top; top < rect.bottom; top += rowsAtOnce)
    {
        const CRect band{rect.left, top, rect.right, std::min(rect.bottom, top + rowsAtOnce)};
        CMemoryPixmap values(band, 64, 1);
        std::optional<CMemoryPixmap> clipped;
        if (!mask.empty())
            clipped.emplace(band, 8, 1);
        if (!ToGrey(source, band, about, values, clipped ? &*clipped : nullptr))
            throw Sarnik::CError("$$$/Deblur/Error/NoGrey=Grey values of this kind of picture cannot be computed.");
        for (std::int32_t y = band.top; y < band.bottom; ++y)
        {
            const double *in = values.Plane(0).Row<double>(y);
            std::transform(in, in + rect.Width(), grey.row(y - rect.top), usable);
            if (!mask.empty())
                std::memcpy(mask.row(y - rect.top), clipped->Plane(0).Row<std::uint8_t>(y),
                            static_cast<std::size_t>(rect.Width()));
        }
    }
}

} // namespace Project
