#include "shell/layerReader.h"

#include "framework/base/exceptions.h"
#include "framework/pixels/fills.h"
#include "platform/math/multiversion.h"

#include <algorithm>

namespace Sarnik
{
namespace
{

std::uint32_t constantAt(CFillConstants constants, int plane)
{
    return static_cast<std::size_t>(plane) < constants.size() ? constants[static_cast<std::size_t>(plane)] : 0;
}

/// The rectangle of a pixmap that a channel list has samples for, and where that lies in the document.
struct overlapRects
{
    CRect inPixmap, inDocument;
    bool Partial(const CRect &bounds) const { return inPixmap != bounds; }
};

overlapRects overlapOf(const CChannelSource &host, const CRect &bounds, const CRect &channelBounds)
{
    const std::int64_t x = host.OriginX(), y = host.OriginY();
    const CRect inDocument = bounds.Moved(x, y).Intersected(channelBounds);
    return {inDocument.Moved(-x, -y).Intersected(bounds), inDocument};
}

CPixelArea areaOf(CBasicPixmap &pixmap, int plane, const CRect &rect)
{
    return pixmap.LockArea(rect, plane, CPixelAccess::write)[0];
}

void readChannel(CChannelSource &host, const CChannel &channel, const CRect &rect, const CPixelArea &area, int depth)
{
    if (host.Read(channel, rect, {area.data, depth, depth, area.rowBytes * 8}) != 0)
        throw CAbort(true);
}

/// Reads an overlap into a plane. A channel that has less than its list says is 0 where it has nothing.
void readInto(CChannelSource &host, const CChannel &channel, const overlapRects &overlap, CBasicPixmap &pixmap,
              int plane)
{
    CRect rect = overlap.inDocument, inPixmap = overlap.inPixmap;
    if (!channel.bounds.Contains(rect))
    {
        fillArea(pixmap, plane, inPixmap, 0);
        rect = rect.Intersected(channel.bounds);
        inPixmap = rect.Moved(-std::int64_t{host.OriginX()}, -std::int64_t{host.OriginY()});
    }
    if (!rect.Empty())
        readChannel(host, channel, rect, areaOf(pixmap, plane, inPixmap), pixmap.GetDepth());
}

class layerRead
{
public:
    layerRead(CChannelSource &source, CBasicPixmap &into, CFillMode mode, CFillConstants values)
        : host(source), pixmap(into), fillMode(mode), constants(values), bounds(into.Bounds()), depth(into.GetDepth())
    {
        const int ofMode = host.Format().planes;
        planes = std::min(ofMode + 1, pixmap.GetPlaneCount());
        colourPlanes = std::min(planes, ofMode);
    }

    void Read(int source, int fallback)
    {
        if (planes < 1)
            return;
        if (source == layerNone || !host.HasDocument())
        {
            for (int p = 0; p < pixmap.GetPlaneCount(); ++p)
                fillArea(pixmap, p, bounds, constantAt(constants, p));
            return;
        }

        const CChannelList *found = host.Channels(source);
        if (found == nullptr || found->colour.empty())
            return Read(fallback, layerNone);
        const CChannelList list = *found; // a read of the fallback asks the host again
        const overlapRects overlap = overlapOf(host, bounds, list.colour[0].bounds);
        if (overlap.inPixmap.Empty())
            return Read(fallback, layerNone);

        const bool partial = overlap.Partial(bounds);
        const bool prefill = fallback != layerNone || fillMode == CFillMode::fallback;
        if (partial && prefill)
            Read(fallback, layerNone);

        ReadColour(list, source, overlap);
        if (planes > colourPlanes)
            ReadTransparency(list, overlap);
        if (partial && !prefill)
            FillAround(overlap.inPixmap);
    }

private:
    void ReadColour(const CChannelList &list, int source, const overlapRects &overlap)
    {
        const int count = std::min(colourPlanes, static_cast<int>(list.colour.size()));
        for (int p = 0; p < count; ++p)
        {
            const CChannel &channel = list.colour[static_cast<std::size_t>(p)];
            if (source == layerTarget && !channel.present)
                continue;
            readInto(host, channel, overlap, pixmap, p);
        }
    }

    void ReadTransparency(const CChannelList &list, const overlapRects &overlap)
    {
        if (list.transparency.empty())
            fillArea(pixmap, colourPlanes, bounds, opaqueValue(depth));
        else
            readInto(host, list.transparency[0], overlap, pixmap, colourPlanes);
    }

    void FillAround(const CRect &inner)
    {
        for (int p = 0; p < colourPlanes; ++p)
            if (fillMode == CFillMode::constant)
                fillBorder(pixmap, p, inner, constantAt(constants, p));
            else
                replicateBorder(pixmap, p, inner);
        if (planes > colourPlanes)
            fillBorder(pixmap, colourPlanes, inner, 0);
    }

    CChannelSource &host;
    CBasicPixmap &pixmap;
    CFillMode fillMode;
    CFillConstants constants;
    CRect bounds;
    int depth;
    int planes = 0, colourPlanes = 0;
};

/// The channel that a mask read means, or null.
const CChannel *maskChannel(CChannelSource &host, int layer)
{
    const CChannelList *list = host.HasDocument() && layer != layerNone ? host.Channels(layer) : nullptr;
    if (list == nullptr)
        return nullptr;
    const std::vector<CChannel> &of = layer == layerSelection || layer == layerAlpha ? list->colour : list->mask;
    return of.empty() ? nullptr : &of[0];
}

void readWidened(CChannelSource &host, const CChannel &channel, const overlapRects &overlap, CBasicPixmap &pixmap,
                 int plane)
{
    CMemoryPixmap narrow(overlap.inPixmap, 8, 1);
    readInto(host, channel, overlap, narrow, 0);
    const CPixelArea from = narrow.Plane(0), to = areaOf(pixmap, plane, overlap.inPixmap);
    const auto n = static_cast<std::size_t>(overlap.inPixmap.Width());
    for (std::int32_t y = overlap.inPixmap.top; y < overlap.inPixmap.bottom; ++y)
        if (pixmap.GetDepth() == 16)
            widenSelection(n, from.Row<std::uint8_t>(y), to.Row<std::uint16_t>(y));
        else
            widenSelection(n, from.Row<std::uint8_t>(y), to.Row<float>(y));
}

void writeFrom(CChannelSource &host, CBasicPixmap &pixmap, int plane, const CChannel &channel, const CRect &rect)
{
    const overlapRects overlap = overlapOf(host, rect.Intersected(pixmap.Bounds()), channel.bounds);
    if (overlap.inPixmap.Empty())
        return;
    const CPixelLock lock = pixmap.LockArea(overlap.inPixmap, plane, CPixelAccess::read);
    const int depth = pixmap.GetDepth();
    const int code = host.Write(channel, overlap.inDocument, {lock[0].data, depth, depth, lock[0].rowBytes * 8});
    if (code < 0 && code >= INT16_MIN)
        throw CTintorelError(static_cast<std::int16_t>(code));
    if (code != 0)
        throw CAbort(true);
}

} // namespace

STILLMARK_MULTIVERSION
void widenSelection(std::size_t n, const std::uint8_t *in, std::uint16_t *out)
{
    for (std::size_t i = 0; i < n; ++i)
        out[i] = widenSelection(in[i]);
}

STILLMARK_MULTIVERSION
void widenSelection(std::size_t n, const std::uint8_t *in, float *out)
{
    for (std::size_t i = 0; i < n; ++i)
        out[i] = static_cast<float>(in[i]) / 255.0f;
}

void ReadLayer(CChannelSource &host, CBasicPixmap &pixmap, int source, int fallback, CFillMode fillMode,
               CFillConstants constants)
{
    if (!pixmap.Bounds().Empty())
        layerRead(host, pixmap, fillMode, constants).Read(source, fallback);
}

void ReadMask(CChannelSource &host, CBasicPixmap &pixmap, int layer, int plane, std::uint32_t constant)
{
    const CRect bounds = pixmap.Bounds();
    const int depth = pixmap.GetDepth();
    if (bounds.Empty() || (depth != 8 && depth != 16 && depth != 32))
        return;
    const CChannel *found = maskChannel(host, layer);
    const overlapRects overlap = found != nullptr ? overlapOf(host, bounds, found->bounds) : overlapRects{};
    if (overlap.inPixmap.Empty())
        return fillArea(pixmap, plane, bounds, constant);

    const CChannel channel = *found;
    if (overlap.Partial(bounds))
        fillBorder(pixmap, plane, overlap.inPixmap, constant);
    const bool narrow = layer == layerSelection && channel.depth == 8 && depth != 8;
    if (narrow)
        readWidened(host, channel, overlap, pixmap, plane);
    else
        readInto(host, channel, overlap, pixmap, plane);
}

void WriteTarget(CChannelSource &host, CBasicPixmap &pixmap, const CRect &rect, bool withTransparency)
{
    const CChannelList *found = host.HasDocument() ? host.Channels(layerTarget) : nullptr;
    if (found == nullptr || found->colour.empty())
        throw CAbort(true);
    const CChannelList list = *found;
    const int colour = std::min({host.Format().planes, pixmap.GetPlaneCount(), static_cast<int>(list.colour.size())});
    for (int p = 0; p < colour; ++p)
        if (list.colour[static_cast<std::size_t>(p)].present)
            writeFrom(host, pixmap, p, list.colour[static_cast<std::size_t>(p)], rect);
    if (withTransparency && !list.transparency.empty() && host.Format().planes < pixmap.GetPlaneCount())
        writeFrom(host, pixmap, host.Format().planes, list.transparency[0], rect);
}

} // namespace Sarnik
