#include "shell/blockChannels.h"

#include "framework/base/exceptions.h"

namespace Sarnik
{
namespace
{

constexpr std::size_t mostChannels = 64;

std::vector<CChannel> collect(const TNChannel *first, std::size_t most = mostChannels)
{
    std::vector<CChannel> channels;
    for (const TNChannel *c = first; c != nullptr && channels.size() < most; c = c->next)
    {
        const TNRect32 &r = c->bounds;
        channels.push_back({{r.left, r.top, r.right, r.bottom}, c->depth, c->present != 0, c});
    }
    return channels;
}

CChannelList collect(const TNChannel *composite, const TNChannel *transparency, const TNChannel *mask)
{
    return {collect(composite), collect(transparency, 1), collect(mask, 1)};
}

const TNLayer *layerAt(const TNDocument &document, int number)
{
    const TNLayer *layer = document.version >= 2 ? document.layers : nullptr;
    for (int i = 0; i < number && layer != nullptr; ++i)
        layer = layer->next;
    return layer;
}

using transferFunction = TNError (*)(void *context, TNPort port, const TNRect32 *rect, const TNPixelMemory *memory);

int transfer(transferFunction function, void *context, TNPort port, const CChannel &channel, const CRect &rect,
             const CSampleLayout &layout)
{
    if (function == nullptr || port == nullptr || channel.depth != layout.depth)
        return TNErrParameter;
    const TNRect32 where{rect.left, rect.top, rect.right, rect.bottom};
    const TNPixelMemory memory{layout.data, layout.depth, static_cast<std::int32_t>(layout.columnBits), layout.rowBits};
    return function(context, port, &where, &memory);
}

void check(TNError code)
{
    if (code < 0)
        throw CTintorelError(code);
    if (code != 0)
        throw CAbort(true);
}

} // namespace

CRect ImageBounds(const TNFilterBlock &block)
{
    if (block.bounds32 != nullptr && block.bounds32->pluginUses != 0)
    {
        const TNRect32 &r = block.bounds32->filterRect;
        return {r.left, r.top, r.right, r.bottom};
    }
    const TNRect16 &r = block.filterRect;
    return {r.left, r.top, r.right, r.bottom};
}

const CChannelList *CBlockChannels::Channels(int layer)
{
    if (block.document == nullptr)
        return nullptr;
    const TNDocument &document = *block.document;
    if (layer >= 0)
    {
        const TNLayer *found = layerAt(document, layer);
        if (found == nullptr)
            return nullptr;
        list = collect(found->composite, found->transparency, found->mask);
        return &list;
    }
    switch (layer)
    {
    case layerTarget:
        list = collect(document.targetComposite, document.targetTransparency, document.targetMask);
        break;
    case layerMerged:
        list = collect(document.mergedComposite, document.mergedTransparency, nullptr);
        break;
    case layerSelection:
        list = collect(document.selection, nullptr, nullptr);
        break;
    case layerAlpha:
        list = collect(document.alpha, nullptr, nullptr);
        break;
    default:
        return nullptr;
    }
    return &list;
}

int CBlockChannels::Read(const CChannel &channel, const CRect &rect, const CSampleLayout &to)
{
    const TNPort port = static_cast<const TNChannel *>(channel.port)->readPort;
    return suite != nullptr ? transfer(suite->readPixels, suite->context, port, channel, rect, to)
                            : transfer(block.readPixels, block.pixelContext, port, channel, rect, to);
}

int CBlockChannels::Write(const CChannel &channel, const CRect &rect, const CSampleLayout &from)
{
    const TNPort port = static_cast<const TNChannel *>(channel.port)->writePort;
    return suite != nullptr ? transfer(suite->writePixels, suite->context, port, channel, rect, from)
                            : transfer(block.writePixels, block.pixelContext, port, channel, rect, from);
}

void CSuiteQuadConverter::CmykToRgb(std::uint8_t *quads, std::size_t pixels)
{
    check(suite.cmykToRgb8 != nullptr ? suite.cmykToRgb8(suite.context, quads, pixels) : TNError{TNErrParameter});
}

void CSuiteQuadConverter::CmykToRgb(std::uint16_t *quads, std::size_t pixels)
{
    check(suite.cmykToRgb16 != nullptr ? suite.cmykToRgb16(suite.context, quads, pixels) : TNError{TNErrParameter});
}

} // namespace Sarnik
