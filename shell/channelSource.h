#pragma once

#include "framework/pixels/imageMode.h"
#include "framework/pixels/rect.h"

#include <cstddef>
#include <vector>

namespace Sarnik
{

/// One channel of the host's document.
struct CChannel
{
    CRect bounds;               ///< where it has samples, in document coordinates
    int depth = 8;              ///< bits, as the host delivers it; a selection may have 8 in a deeper document
    bool present = true;        ///< not present: left out of reads and writes of the target
    const void *port = nullptr; ///< the channel source's own: what it reads and writes by
};

/// A list of channels that the host offers.
struct CChannelList
{
    std::vector<CChannel> colour;
    std::vector<CChannel> transparency; ///< one or none
    std::vector<CChannel> mask;         ///< the layer's mask, one or none
};

/// Channel sources by number; 0 and above are the document's layers.
constexpr int layerTarget = -1, layerMerged = -2, layerSelection = -3, layerAlpha = -4, layerNone = -5;

/// Samples of a channel in memory: strides in bits, as hosts count them.
struct CSampleLayout
{
    std::byte *data = nullptr; ///< the first sample of the rectangle
    int depth = 8;             ///< bits a sample
    std::int64_t columnBits = 8, rowBits = 0;
};

/// The host's pixels as layer reads see them. The host's answers are not trusted: whoever fills this checks them.
class CChannelSource
{
public:
    /// False: the host gives no description of its document; then there is nothing to read.
    virtual bool HasDocument() const = 0;
    virtual CImageFormat Format() const = 0;
    /// What is added to picture coordinates to get to document coordinates.
    virtual std::int32_t OriginX() const = 0;
    virtual std::int32_t OriginY() const = 0;
    /// Null where the host has no such list. Good until the next call.
    virtual const CChannelList *Channels(int layer) = 0;
    /// A rectangle inside the channel's bounds. 0, or the host's error code.
    virtual int Read(const CChannel &channel, const CRect &rect, const CSampleLayout &to) = 0;
    virtual int Write(const CChannel &channel, const CRect &rect, const CSampleLayout &from) = 0;

protected:
    ~CChannelSource() = default;
};

} // namespace Sarnik
