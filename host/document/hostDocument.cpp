#include "host/document/hostDocument.h"

#include "host/document/sampleCodes.h"

#include <algorithm>
#include <cstring>

namespace Stillmark
{
namespace
{

/// Whether a call is one that the interface allows.
bool sound(const documentPort *port, const TNRect32 &area, const TNPixelMemory &memory)
{
    if (!port || !memory.data || memory.depth != port->depth)
        return false;
    const TNRect32 &all = port->bounds;
    if (area.left >= area.right || area.top >= area.bottom || area.left < all.left || area.top < all.top ||
        area.right > all.right || area.bottom > all.bottom)
        return false;
    return memory.columnBits > 0 && memory.rowBits > 0 && memory.columnBits % memory.depth == 0 &&
           memory.rowBits % memory.depth == 0;
}

/// Calls use(rectangle in what the port reads, memory at its first sample) band by band.
template <typename Use>
void forEachBand(const documentPort &port, const TNRect32 &area, const TNPixelMemory &memory, int rowsAtOnce,
                 const Use &use)
{
    const auto inside = [](std::int32_t at, std::int32_t first) { return static_cast<int>(std::int64_t{at} - first); };
    rectangle band{inside(area.left, port.first.x), inside(area.top, port.first.y), inside(area.right, area.left), 0};
    const int bottom = inside(area.bottom, port.first.y);
    TNPixelMemory part = memory;
    for (; band.y < bottom; band.y += band.height)
    {
        band.height = std::min(rowsAtOnce, bottom - band.y);
        use(band, part);
        part.data = static_cast<std::byte *>(part.data) + memory.rowBits / 8 * band.height;
    }
}

std::byte *rowOf(const TNPixelMemory &memory, int row)
{
    return static_cast<std::byte *>(memory.data) + memory.rowBits / 8 * row;
}

} // namespace

hostDocument::hostDocument(pictureSource &shownSource, pictureResult *shownResult, const documentSettings &settings)
    : source(shownSource), result(shownResult), selection(settings.selection), layerMask(settings.layerMask),
      channels(shownSource, shownResult != nullptr, settings),
      converter(shownSource.mode() == colourMode::cmyk ? settings.profile : std::vector<std::uint8_t>())
{
}

TNImageMode hostDocument::imageMode() const
{
    const int depth = source.depth();
    const auto byDepth = [&](TNImageMode of8, TNImageMode of16, TNImageMode of32) {
        return depth == 8 ? of8 : depth == 16 ? of16 : of32;
    };
    switch (source.mode())
    {
    case colourMode::grey:
        return byDepth(TNModeGrey, TNModeGrey16, TNModeGrey32);
    case colourMode::cmyk:
        return byDepth(TNModeCMYK, TNModeCMYK16, TNModeCMYK16);
    case colourMode::lab:
        return byDepth(TNModeLab, TNModeLab16, TNModeLab16);
    default:
        return byDepth(TNModeRGB, TNModeRGB16, TNModeRGB32);
    }
}

TNRect32 hostDocument::filterRect() const
{
    const TNRect32 &layer = channels.layerBounds();
    if (!selection)
        return layer;
    const rectangle &selected = selection->bounds();
    return {layer.left + selected.x, layer.top + selected.y, layer.left + selected.x + selected.width,
            layer.top + selected.y + selected.height};
}

TNError hostDocument::readPixels(TNPort port, const TNRect32 &area, const TNPixelMemory &destination)
{
    const documentPort *from = channels.toRead(port);
    if (!sound(from, area, destination))
        return TNErrParameter;
    const int rows = source.bandRows(area.right - area.left);
    forEachBand(*from, area, destination, rows,
                [&](const rectangle &band, const TNPixelMemory &to) { readBand(*from, band, to); });
    return TNNoError;
}

TNError hostDocument::writePixels(TNPort port, const TNRect32 &area, const TNPixelMemory &memory)
{
    const documentPort *to = channels.toWrite(port);
    if (!result || !sound(to, area, memory))
        return TNErrParameter;
    const int rows = source.bandRows(area.right - area.left);
    forEachBand(*to, area, memory, rows,
                [&](const rectangle &band, const TNPixelMemory &from) { writeBand(*to, band, from); });
    return TNNoError;
}

planeSamples hostDocument::codesOf(const documentPort &port, const rectangle &band)
{
    if (port.of == documentPort::plane::source)
        return source.plane(port.number, band);
    if (port.of == documentPort::plane::layerMask)
        return layerMask->plane(0, band);
    const auto rowBytes = static_cast<std::size_t>(band.width);
    selectedRows.resize(rowBytes * static_cast<std::size_t>(band.height));
    selection->read(band, selectedRows.data(), rowBytes);
    return {reinterpret_cast<const std::byte *>(selectedRows.data()), rowBytes};
}

void hostDocument::readBand(const documentPort &from, const rectangle &band, const TNPixelMemory &to)
{
    const planeSamples read = codesOf(from, band);
    for (int row = 0; row < band.height; ++row)
        samplesFromCodes({from.depth, from.inverted}, static_cast<std::size_t>(band.width), read.row(row),
                         rowOf(to, row), static_cast<std::size_t>(to.columnBits / 8));
}

void hostDocument::writeBand(const documentPort &to, const rectangle &band, const TNPixelMemory &from)
{
    const sampleForm form{to.depth, to.inverted};
    const bool blends = selection && autoMask && *autoMask != 0;
    const bool needsOld = needsOldCodes(form, blends);
    const bool aligned = reinterpret_cast<std::uintptr_t>(from.data) % static_cast<std::size_t>(form.depth / 8) == 0;
    if (!needsOld && !form.inverted && aligned && from.columnBits == from.depth)
        return result->write(to.number, band,
                             {static_cast<const std::byte *>(from.data), static_cast<std::size_t>(from.rowBits / 8)});

    const auto columns = static_cast<std::size_t>(band.width);
    const std::size_t rowBytes = columns * static_cast<std::size_t>(form.depth / 8);
    codes.resize(rowBytes * static_cast<std::size_t>(band.height));
    planeSamples old;
    if (needsOld)
        old = source.plane(to.number, band);
    if (blends)
    {
        selectedRows.resize(columns * static_cast<std::size_t>(band.height));
        selection->read(band, selectedRows.data(), columns);
    }
    for (int row = 0; row < band.height; ++row)
    {
        const auto at = static_cast<std::size_t>(row);
        codesFromSamples(form, columns, rowOf(from, row), static_cast<std::size_t>(from.columnBits / 8),
                         needsOld ? old.row(row) : nullptr, blends ? selectedRows.data() + at * columns : nullptr,
                         codes.data() + at * rowBytes);
    }
    result->write(to.number, band, {codes.data(), rowBytes});
}

TNError hostDocument::cmykToRgb8(std::uint8_t *quads, std::uint64_t pixels)
{
    if (!quads && pixels > 0)
        return TNErrParameter;
    converter.cmykToRgb(quads, pixels);
    return TNNoError;
}

TNError hostDocument::cmykToRgb16(std::uint16_t *quads, std::uint64_t pixels)
{
    if (!quads && pixels > 0)
        return TNErrParameter;
    converter.cmykToRgb(quads, pixels);
    return TNNoError;
}

} // namespace Stillmark
