#include "host/plugin/pixelTable.h"

#include <cstring>
#include <string>

namespace Stillmark
{
namespace
{

pixelTable &self(void *context)
{
    return *static_cast<pixelTable *>(context);
}

/// Samples that no picture has: all bits set is beyond the range of 16 bits and not a number in 32.
void fillWithNonsense(const TNRect32 &area, const TNPixelMemory &memory)
{
    const std::int64_t sampleBytes = memory.depth / 8, columnBytes = memory.columnBits / 8;
    const std::int64_t width = std::int64_t{area.right} - area.left, height = std::int64_t{area.bottom} - area.top;
    for (std::int64_t row = 0; row < height; row++)
    {
        auto *sample = static_cast<std::uint8_t *>(memory.data) + row * (memory.rowBits / 8);
        for (std::int64_t column = 0; column < width; column++, sample += columnBytes)
            std::memset(sample, 0xFF, static_cast<std::size_t>(sampleBytes));
    }
}

} // namespace

pixelTable::pixelTable(runState &run, pluginPicture &shownPicture) : state(run), picture(shownPicture)
{
    portsTable.context = this;
    portsTable.readPixels = [](void *context, TNPort port, const TNRect32 *area, const TNPixelMemory *memory) {
        return self(context).state.code("readPixels", [&] { return self(context).read(port, area, memory); });
    };
    portsTable.writePixels = [](void *context, TNPort port, const TNRect32 *area, const TNPixelMemory *memory) {
        return self(context).state.code("writePixels", [&] { return self(context).write(port, area, memory); });
    };

    coloursTable.context = this;
    coloursTable.cmykToRgb8 = [](void *context, std::uint8_t *quads, std::uint64_t pixels) {
        return self(context).state.codeAnywhere([&]() -> TNError {
            const hostLie lie = self(context).state.lie(hostCall::colour, "cmykToRgb8");
            if (lie.fails() || lie.raves())
                return lie.code;
            return quads ? self(context).picture.cmykToRgb8(quads, pixels) : TNError{TNErrParameter};
        });
    };
    coloursTable.cmykToRgb16 = [](void *context, std::uint16_t *quads, std::uint64_t pixels) {
        return self(context).state.codeAnywhere([&]() -> TNError {
            const hostLie lie = self(context).state.lie(hostCall::colour, "cmykToRgb16");
            if (lie.fails() || lie.raves())
                return lie.code;
            return quads ? self(context).picture.cmykToRgb16(quads, pixels) : TNError{TNErrParameter};
        });
    };
}

bool pixelTable::sound(const char *function, const TNRect32 *area, const TNPixelMemory *memory)
{
    const char *fault = nullptr;
    if (!area || !memory || !memory->data)
        fault = " without a rectangle or memory";
    else if (area->left >= area->right || area->top >= area->bottom)
        fault = " of an empty rectangle";
    else if (memory->depth != 8 && memory->depth != 16 && memory->depth != 32)
        fault = " with a depth that there is not";
    else if (memory->columnBits <= 0 || memory->rowBits <= 0 || memory->columnBits % memory->depth != 0 ||
             memory->rowBits % memory->depth != 0)
        fault = " with strides that hold no samples";
    if (fault)
        state.misuse(std::string(function) + fault);
    return !fault;
}

TNError pixelTable::read(TNPort port, const TNRect32 *area, const TNPixelMemory *destination)
{
    const hostLie lie = state.lie(hostCall::read);
    if (lie.fails())
        return lie.code;
    if (!sound("readPixels", area, destination))
        return TNErrParameter;
    if (lie.raves())
    {
        fillWithNonsense(*area, *destination);
        return TNNoError;
    }
    return picture.readPixels(port, *area, *destination);
}

TNError pixelTable::write(TNPort port, const TNRect32 *area, const TNPixelMemory *source)
{
    const hostLie lie = state.lie(hostCall::write);
    if (lie.fails())
        return lie.code;
    if (!sound("writePixels", area, source))
        return TNErrParameter;
    if (lie.raves())
        return TNNoError;
    const TNError result = picture.writePixels(port, *area, *source);
    written |= result == TNNoError;
    return result;
}

} // namespace Stillmark
