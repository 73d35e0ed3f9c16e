#include "host/document/documentChannels.h"

#include <algorithm>
#include <limits>
#include <stdexcept>

namespace Stillmark
{
namespace
{

/// A rectangle of this size at a + b.
TNRect32 placed(TNPoint32 a, TNPoint32 b, int width, int height)
{
    const std::int64_t left = std::int64_t{a.x} + b.x, top = std::int64_t{a.y} + b.y;
    const auto narrow = [](std::int64_t number) {
        if (number < std::numeric_limits<std::int32_t>::min() || number > std::numeric_limits<std::int32_t>::max())
            throw std::invalid_argument("documentChannels: coordinates beyond 32 bits");
        return static_cast<std::int32_t>(number);
    };
    return {narrow(left), narrow(top), narrow(left + width), narrow(top + height)};
}

TNRect32 common(const TNRect32 &a, const TNRect32 &b)
{
    return {std::max(a.left, b.left), std::max(a.top, b.top), std::min(a.right, b.right), std::min(a.bottom, b.bottom)};
}

bool empty(const TNRect32 &rect)
{
    return rect.left >= rect.right || rect.top >= rect.bottom;
}

void check(const pictureSource &source, const documentSettings &settings)
{
    if (source.depth() == 32 && source.mode() != colourMode::grey && source.mode() != colourMode::rgb)
        throw std::invalid_argument("documentChannels: no image mode for 32-bit CMYK or Lab");
    if (settings.layerMask && settings.layerMask->depth() != source.depth())
        throw std::invalid_argument("documentChannels: the layer mask has another depth");
    if (settings.selection &&
        (settings.selection->width() != source.width() || settings.selection->height() != source.height()))
        throw std::invalid_argument("documentChannels: the selection has another size");
}

} // namespace

/// Channels that read, or read and write, consecutive planes.
struct documentChannels::list
{
    documentPort port; ///< of the first
    int count = 1;
    bool writable = false;
    const std::set<int> *switchedOff = nullptr; ///< null: none
};

documentChannels::documentChannels(const pictureSource &source, bool writable, const documentSettings &settings)
{
    check(source, settings);
    const int width = source.width(), height = source.height(), colours = source.colourPlanes();
    const TNPoint32 size = settings.canvas.value_or(TNPoint32{width, height});
    layer = placed(settings.layerAt, {0, 0}, width, height);

    documentPort pixels;
    pixels.bounds = placed(settings.layerAt, settings.origin, width, height);
    pixels.first = {pixels.bounds.left, pixels.bounds.top};
    pixels.depth = source.depth();
    documentPort colour = pixels, transparency = pixels, further = pixels;
    colour.inverted = source.mode() == colourMode::cmyk;
    transparency.number = colours;
    further.number = colours + 1;

    shown.version = 4;
    shown.depth = source.depth();
    shown.size = size;
    shown.origin = settings.origin;
    shown.targetComposite = addList({colour, colours, writable, &settings.switchedOff});
    onlyLayer.composite = addList({colour, colours, false});
    shown.layers = &onlyLayer;
    if (source.extraPlanes() > 0)
    {
        shown.targetTransparency = addList({transparency, 1, writable});
        onlyLayer.transparency = addList({transparency});
    }
    if (source.extraPlanes() > 1)
        shown.alpha = addList({further, source.extraPlanes() - 1});

    const TNRect32 onCanvas = common(pixels.bounds, placed(settings.origin, {0, 0}, size.x, size.y));
    if (!empty(onCanvas))
    {
        colour.bounds = transparency.bounds = onCanvas;
        shown.mergedComposite = addList({colour, colours});
        if (source.extraPlanes() > 0)
            shown.mergedTransparency = addList({transparency});
    }
    if (settings.layerMask)
    {
        documentPort mask;
        mask.of = documentPort::plane::layerMask;
        mask.bounds =
            placed(settings.layerMaskAt, settings.origin, settings.layerMask->width(), settings.layerMask->height());
        mask.first = {mask.bounds.left, mask.bounds.top};
        mask.depth = source.depth();
        shown.targetMask = onlyLayer.mask = addList({mask});
    }
    if (settings.selection)
    {
        documentPort selected = pixels;
        selected.of = documentPort::plane::selection;
        selected.depth = 8;
        shown.selection = addList({selected});
    }
}

TNPort documentChannels::addPort(const documentPort &port)
{
    ports.push_back(port);
    return reinterpret_cast<TNPort>(&ports.back());
}

const TNChannel *documentChannels::addList(const list &what)
{
    const TNChannel *first = nullptr;
    for (int i = what.count - 1; i >= 0; --i)
    {
        documentPort port = what.port;
        port.number += i;
        TNChannel channel{};
        channel.next = first;
        channel.bounds = port.bounds;
        channel.depth = port.depth;
        channel.present = !what.switchedOff || what.switchedOff->count(i) == 0;
        if (channel.present)
        {
            channel.readPort = addPort(port);
            port.writable = true;
            channel.writePort = what.writable ? addPort(port) : nullptr;
        }
        channels.push_back(channel);
        first = &channels.back();
    }
    return first;
}

const documentPort *documentChannels::find(TNPort port, bool writable) const
{
    for (const documentPort &each : ports)
        if (reinterpret_cast<TNPort>(const_cast<documentPort *>(&each)) == port)
            return each.writable == writable ? &each : nullptr;
    return nullptr;
}

} // namespace Stillmark
