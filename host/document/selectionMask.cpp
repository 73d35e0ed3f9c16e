#include "host/document/selectionMask.h"

#include <algorithm>
#include <stdexcept>

namespace Stillmark
{
namespace
{

[[noreturn]] void refuse(const std::string &path, const std::string &why)
{
    throw Platform::fileError(path + ": cannot be used as a selection: " + why);
}

std::string sizeText(int width, int height)
{
    return std::to_string(width) + " x " + std::to_string(height) + " pixels";
}

/// The first planes of a row of codes, packed one after the other, as how much is selected. Rounded.
template <typename Code> void selectRow(const Code *codes, int width, bool colour, std::uint8_t *values)
{
    constexpr std::uint32_t unit = sizeof(Code) == 1 ? 1 : 257;
    for (int x = 0; x < width; ++x)
    {
        const std::uint32_t first = codes[x];
        const std::uint32_t light =
            colour ? (299 * first + 587u * codes[width + x] + 114u * codes[2 * width + x] + 500) / 1000 : first;
        values[x] = static_cast<std::uint8_t>((light + unit / 2) / unit);
    }
}

} // namespace

selectionMask::selectionMask(int width, int height) : raster(std::make_unique<sampleRaster>(width, height, 1, 1))
{
}

selectionMask::selectionMask(int width, int height, const std::vector<std::uint8_t> &values)
    : selectionMask(width, height)
{
    if (values.size() != static_cast<std::size_t>(width) * static_cast<std::size_t>(height))
        throw std::invalid_argument("selectionMask: not one value a pixel");
    for (int y = 0; y < height; ++y)
        append(y, values.data() + static_cast<std::size_t>(y) * static_cast<std::size_t>(width));
    if (selected.width == 0)
        throw std::invalid_argument("selectionMask: nothing is selected");
}

selectionMask selectionMask::open(const std::string &path, int width, int height, const progressCheck &progress)
{
    const photo picture = photo::open(path, progress);
    if (picture.depth() == 32 || (picture.mode() != colourMode::grey && picture.mode() != colourMode::rgb))
        refuse(path, "it is not a grey or RGB picture of 8 or 16 bits");
    if (picture.width() != width || picture.height() != height)
        refuse(path,
               "it has " + sizeText(picture.width(), picture.height()) + ", the photo " + sizeText(width, height));

    selectionMask mask(width, height);
    const bool colour = picture.mode() == colourMode::rgb;
    const std::size_t rowBytes = static_cast<std::size_t>(width) * static_cast<std::size_t>(picture.sampleBytes());
    std::vector<std::uint16_t> codes((rowBytes * static_cast<std::size_t>(picture.colourPlanes()) + 1) / 2);
    std::vector<std::uint8_t> values(static_cast<std::size_t>(width));
    for (int y = 0; y < height; ++y)
    {
        picture.read({0, y, width, 1}, codes.data(), rowBytes);
        if (picture.depth() == 8)
            selectRow(reinterpret_cast<const std::uint8_t *>(codes.data()), width, colour, values.data());
        else
            selectRow(codes.data(), width, colour, values.data());
        mask.append(y, values.data());
    }
    if (mask.selected.width == 0)
        refuse(path, "it is black all over, which selects nothing");
    return mask;
}

void selectionMask::append(int y, const std::uint8_t *row)
{
    const int columns = width();
    raster->write({0, y, columns, 1}, row, static_cast<std::size_t>(columns));
    const auto isSelected = [](std::uint8_t value) { return value != 0; };
    const std::uint8_t *first = std::find_if(row, row + columns, isSelected);
    if (first == row + columns)
        return;
    const std::uint8_t *last = row + columns;
    while (last[-1] == 0)
        --last;
    const int left = static_cast<int>(first - row), right = static_cast<int>(last - row);
    if (selected.width == 0)
        selected = {left, y, right - left, 1};
    else
    {
        const int mostRight = std::max(selected.x + selected.width, right);
        selected.x = std::min(selected.x, left);
        selected.width = mostRight - selected.x;
        selected.height = y + 1 - selected.y;
    }
}

void selectionMask::read(const rectangle &area, std::uint8_t *values, std::size_t rowBytes) const
{
    raster->read(area, values, rowBytes);
}

} // namespace Stillmark
