#pragma once

#include "host/document/pictureSource.h"
#include "host/document/selectionMask.h"
#include "shell/tintorel.h"

#include <cstdint>
#include <deque>
#include <optional>
#include <set>
#include <vector>

namespace Stillmark
{

/// How a document shows its picture. Positions are in picture coordinates, which are those of the canvas.
struct documentSettings
{
    TNPoint32 origin{0, 0};                   ///< document coordinates = picture coordinates + origin
    std::optional<TNPoint32> canvas;          ///< its size; none: the source's
    TNPoint32 layerAt{0, 0};                  ///< where the source's first pixel lies
    std::set<int> switchedOff;                ///< colour planes that the target shows as not present
    pictureSource *layerMask = nullptr;       ///< its first plane; of the source's depth
    TNPoint32 layerMaskAt{0, 0};              ///< where its first pixel lies
    const selectionMask *selection = nullptr; ///< lies over the source; null: all is selected
    std::vector<std::uint8_t> profile;        ///< ICC, for the conversion of CMYK; empty: none
};

/// What stands behind a port.
struct documentPort
{
    enum class plane
    {
        source,
        layerMask,
        selection
    };

    plane of = plane::source;
    int number = 0;    ///< of the source's plane
    TNRect32 bounds{}; ///< of the channel, in document coordinates
    TNPoint32 first{}; ///< where the first pixel of what it reads lies, in document coordinates
    int depth = 8;
    bool inverted = false; ///< the largest value stands for the code 0
    bool writable = false; ///< a port to write by; else one to read by
};

/// Owns the TNDocument, its lists and ports.
class documentChannels
{
public:
    documentChannels(const pictureSource &source, bool writable, const documentSettings &settings);
    documentChannels(const documentChannels &) = delete;
    documentChannels &operator=(const documentChannels &) = delete;

    const TNDocument *document() const { return &shown; }
    /// The layer's, in picture coordinates.
    const TNRect32 &layerBounds() const { return layer; }

    /// Null for a port that is none of ours, or made for the other direction.
    const documentPort *toRead(TNPort port) const { return find(port, false); }
    const documentPort *toWrite(TNPort port) const { return find(port, true); }

private:
    struct list;

    const documentPort *find(TNPort port, bool writable) const;
    TNPort addPort(const documentPort &port);
    const TNChannel *addList(const list &channelsOfList);

    TNRect32 layer{};
    TNDocument shown{};
    TNLayer onlyLayer{};
    std::deque<TNChannel> channels;
    std::deque<documentPort> ports;
};

} // namespace Stillmark
