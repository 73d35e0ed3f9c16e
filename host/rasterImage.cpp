#include "host/rasterImage.h"

#include <algorithm>
#include <limits>
#include <stdexcept>
#include <type_traits>

namespace Stillmark
{

struct rasterImage::view
{
    rasterImage *owner;
    int first, planes;
    form samples;
};

namespace
{

/// Codes of Out from samples of In, rounded to the nearest; NaN becomes 0.
template <typename Out, typename In> Out converted(In value)
{
    constexpr bool toFloat = std::is_floating_point_v<Out>;
    if constexpr (std::is_same_v<In, Out>)
        return value;
    else if constexpr (toFloat)
        return static_cast<Out>(value) / static_cast<Out>(std::numeric_limits<In>::max());
    else if constexpr (std::is_floating_point_v<In>)
    {
        const In clamped = value >= 0 ? std::min(value, In(1)) : In(0); // NaN compares false
        return static_cast<Out>(clamped * static_cast<In>(std::numeric_limits<Out>::max()) + In(0.5));
    }
    else if constexpr (sizeof(In) > sizeof(Out))
        return static_cast<Out>((value + 128u) / 257u);
    else
        return static_cast<Out>(value * 257u);
}

template <typename Out, typename In>
void convertRow(const In *from, int pixelPlanes, int first, int planes, int width, Out *to)
{
    for (from += first; width > 0; --width, from += pixelPlanes)
        for (int p = 0; p < planes; ++p)
            *to++ = converted<Out>(from[p]);
}

template <typename Out>
void convertRow(const void *from, const sampleRaster &raster, int first, int planes, int width, void *to)
{
    Out *out = static_cast<Out *>(to);
    switch (raster.sampleBytes())
    {
    case 1:
        return convertRow(static_cast<const std::uint8_t *>(from), raster.planes(), first, planes, width, out);
    case 2:
        return convertRow(static_cast<const std::uint16_t *>(from), raster.planes(), first, planes, width, out);
    default:
        return convertRow(static_cast<const float *>(from), raster.planes(), first, planes, width, out);
    }
}

void labBytesRow(const std::uint8_t *from, int pixelPlanes, int width, VipsPel *to)
{
    for (; width > 0; --width, from += pixelPlanes, to += 4)
    {
        to[0] = from[0];
        to[1] = from[1] ^ 0x80;
        to[2] = from[2] ^ 0x80;
        to[3] = 0;
    }
}

void labShortsRow(const std::uint16_t *from, int pixelPlanes, int planes, int width, std::uint16_t *to)
{
    for (; width > 0; --width, from += pixelPlanes, to += planes)
    {
        std::copy(from, from + planes, to);
        to[0] = from[0] >> 1;
        to[1] = from[1] ^ 0x8000;
        to[2] = from[2] ^ 0x8000;
    }
}

} // namespace

rasterImage::rasterImage(const sampleRaster &pixels, const progressCheck &progress) : raster(pixels), report(progress)
{
}

rasterImage::~rasterImage() = default;

vipsImage rasterImage::make(int first, int planes, form samples, VipsInterpretation meaning)
{
    startVips();
    views.push_back(std::make_unique<view>(view{this, first, planes, samples}));
    VipsBandFormat format = VIPS_FORMAT_UCHAR;
    if (samples == form::shorts)
        format = VIPS_FORMAT_USHORT;
    else if (samples == form::floats)
        format = VIPS_FORMAT_FLOAT;
    else if (samples == form::labShorts)
        format = VIPS_FORMAT_SHORT;
    const bool packed = samples == form::labBytes;

    vipsImage image(vips_image_new());
    vips_image_init_fields(image.get(), raster.width(), raster.height(), packed ? 4 : planes, format,
                           packed ? VIPS_CODING_LABQ : VIPS_CODING_NONE, meaning, 1, 1);
    if (vips_image_pipelinev(image.get(), VIPS_DEMAND_STYLE_THINSTRIP, nullptr) != 0 ||
        vips_image_generate(image.get(), nullptr, draw, nullptr, this, views.back().get()) != 0)
        throw std::runtime_error("The picture library failed: " + takeVipsError());
    return image;
}

void rasterImage::rethrow() const
{
    const std::lock_guard guard(lock);
    if (failure)
        std::rethrow_exception(failure);
}

int rasterImage::draw(VipsRegion *region, void *, void *self, void *what, gboolean *) noexcept
{
    auto *owner = static_cast<rasterImage *>(self);
    try
    {
        owner->drawArea(region, *static_cast<const view *>(what));
        return 0;
    }
    catch (...)
    {
        const std::lock_guard guard(owner->lock);
        if (!owner->failure)
            owner->failure = std::current_exception();
        return -1;
    }
}

void rasterImage::drawArea(VipsRegion *region, const view &what)
{
    const VipsRect &valid = region->valid;
    const std::size_t rowBytes = static_cast<std::size_t>(valid.width) * raster.pixelBytes();
    std::vector<std::uint8_t> row(rowBytes);
    for (int y = valid.top; y < VIPS_RECT_BOTTOM(&valid); ++y)
    {
        raster.read({valid.left, y, valid.width, 1}, row.data(), rowBytes);
        VipsPel *to = VIPS_REGION_ADDR(region, valid.left, y);
        switch (what.samples)
        {
        case form::bytes:
            convertRow<std::uint8_t>(row.data(), raster, what.first, what.planes, valid.width, to);
            break;
        case form::shorts:
            convertRow<std::uint16_t>(row.data(), raster, what.first, what.planes, valid.width, to);
            break;
        case form::floats:
            convertRow<float>(row.data(), raster, what.first, what.planes, valid.width, to);
            break;
        case form::labBytes:
            labBytesRow(row.data(), raster.planes(), valid.width, to);
            break;
        case form::labShorts:
            labShortsRow(reinterpret_cast<const std::uint16_t *>(row.data()), raster.planes(), what.planes, valid.width,
                         reinterpret_cast<std::uint16_t *>(to));
            break;
        }
    }
    if (what.first == 0)
        advance(valid);
}

void rasterImage::advance(const VipsRect &area)
{
    const std::lock_guard guard(lock);
    if (failure) // other threads draw on until libvips has stopped them
        throw Platform::cancelled();
    drawn += static_cast<double>(area.width) * area.height / (static_cast<double>(raster.width()) * raster.height());
    if (report && !report(std::min(drawn, 1.0)))
    {
        // Noted under this lock, so that no other thread reports after the stop.
        failure = std::make_exception_ptr(Platform::cancelled());
        throw Platform::cancelled();
    }
}

} // namespace Stillmark
