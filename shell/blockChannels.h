#pragma once

#include "framework/pixels/toGrey.h"
#include "shell/channelSource.h"
#include "shell/tintorel.h"

namespace Sarnik
{

/// What is to be filtered, in picture coordinates: the block's 32-bit fields where the plug-in uses them, else the
/// 16-bit ones.
CRect ImageBounds(const TNFilterBlock &block);

/// The host's document as layer reads see it. Lists may be cut short here: no more than 64 channels are taken of one,
/// so that a host whose list runs in a circle does no harm; a channel without a rectangle counts as empty, one of
/// another depth than is asked for, or without a port, fails to be read.
class CBlockChannels final : public CChannelSource
{
public:
    /// ports: the channel ports suite, or null to go by the block's own functions. Both outlive this.
    CBlockChannels(const TNFilterBlock &filterBlock, const TNChannelPortsSuite *ports)
        : block(filterBlock), suite(ports)
    {
    }

    bool HasDocument() const override { return block.document != nullptr; }
    CImageFormat Format() const override { return imageFormat(block.imageMode); }
    std::int32_t OriginX() const override { return block.document != nullptr ? block.document->origin.x : 0; }
    std::int32_t OriginY() const override { return block.document != nullptr ? block.document->origin.y : 0; }
    const CChannelList *Channels(int layer) override;
    int Read(const CChannel &channel, const CRect &rect, const CSampleLayout &to) override;
    int Write(const CChannel &channel, const CRect &rect, const CSampleLayout &from) override;

    bool HasSelection() const { return block.document != nullptr && block.document->selection != nullptr; }
    bool HasTransparency() const { return block.document != nullptr && block.document->targetTransparency != nullptr; }

private:
    const TNFilterBlock &block;
    const TNChannelPortsSuite *suite;
    CChannelList list; ///< the last one asked for
};

/// CMYK to RGB by the host's colour space suite. A failing call throws CTintorelError, or CAbort for a number that is
/// no error code.
class CSuiteQuadConverter final : public CQuadConverter
{
public:
    explicit CSuiteQuadConverter(const TNColorSpaceSuite &colorSpace) : suite(colorSpace) {}
    void CmykToRgb(std::uint8_t *quads, std::size_t pixels) override;
    void CmykToRgb(std::uint16_t *quads, std::size_t pixels) override;

private:
    const TNColorSpaceSuite &suite;
};

} // namespace Sarnik
