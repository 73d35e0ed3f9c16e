#pragma once

#include "shell/channelSource.h"

#include <cstring>
#include <map>
#include <memory>
#include <stdexcept>
#include <vector>

namespace TestSupport
{

/// A document in memory, behind the interface of layer reads. Every call is checked: a rectangle outside of its channel
/// or a negative stride throws. The Nth call can be made to fail.
class fakeChannels final : public Sarnik::CChannelSource
{
public:
    struct plane
    {
        Sarnik::CRect bounds;
        int depth;
        std::vector<std::uint32_t> samples; ///< bits, row by row

        std::uint32_t &At(std::int32_t x, std::int32_t y)
        {
            return samples[static_cast<std::size_t>((std::int64_t{y} - bounds.top) * bounds.Width() + x - bounds.left)];
        }
    };

    bool hasDocument = true;
    Sarnik::CImageFormat format;
    std::int32_t originX = 0, originY = 0;
    std::map<int, Sarnik::CChannelList> lists;
    int failCallAt = -1, failCode = -36;
    int calls = 0;

    /// A channel of samples that tell where they are and whose they are.
    Sarnik::CChannel Make(const Sarnik::CRect &bounds, int depth, bool present = true)
    {
        auto p = std::make_unique<plane>(plane{bounds, depth, {}});
        p->samples.resize(static_cast<std::size_t>(bounds.Width() * bounds.Height()));
        const auto seed = static_cast<std::uint32_t>(planes.size() + 1);
        std::uint32_t i = 0;
        for (std::uint32_t &s : p->samples)
        {
            const std::uint32_t v = (i++ * 2654435761u) ^ (seed * 40503u);
            s = depth == 8 ? v >> 24 : depth == 16 ? (v >> 8) % 32769u : v;
        }
        planes.push_back(std::move(p));
        return {bounds, depth, present, planes.back().get()};
    }
    static plane &Of(const Sarnik::CChannel &channel)
    {
        return *static_cast<plane *>(const_cast<void *>(channel.port));
    }

    bool HasDocument() const override { return hasDocument; }
    Sarnik::CImageFormat Format() const override { return format; }
    std::int32_t OriginX() const override { return originX; }
    std::int32_t OriginY() const override { return originY; }
    const Sarnik::CChannelList *Channels(int layer) override
    {
        const auto found = lists.find(layer);
        return found == lists.end() ? nullptr : &found->second;
    }
    int Read(const Sarnik::CChannel &channel, const Sarnik::CRect &rect, const Sarnik::CSampleLayout &to) override
    {
        return Transfer(channel, rect, to, [](std::uint32_t &sample, std::byte *at, std::size_t bytes) {
            std::memcpy(at, &sample, bytes);
        });
    }
    int Write(const Sarnik::CChannel &channel, const Sarnik::CRect &rect, const Sarnik::CSampleLayout &from) override
    {
        return Transfer(channel, rect, from, [](std::uint32_t &sample, std::byte *at, std::size_t bytes) {
            sample = 0;
            std::memcpy(&sample, at, bytes);
        });
    }

private:
    template <class Move>
    int Transfer(const Sarnik::CChannel &channel, const Sarnik::CRect &rect, const Sarnik::CSampleLayout &layout,
                 Move move)
    {
        if (calls++ == failCallAt)
            return failCode;
        plane &p = Of(channel);
        if (rect.Empty() || !p.bounds.Contains(rect) || layout.depth != p.depth || layout.columnBits != p.depth ||
            layout.rowBits < rect.Width() * p.depth)
            throw std::logic_error("a read or write that no host would allow");
        const auto bytes = static_cast<std::size_t>(p.depth / 8);
        for (std::int32_t y = rect.top; y < rect.bottom; ++y)
            for (std::int32_t x = rect.left; x < rect.right; ++x)
                move(p.At(x, y),
                     layout.data + (std::int64_t{y} - rect.top) * layout.rowBits / 8 +
                         (std::int64_t{x} - rect.left) * layout.columnBits / 8,
                     bytes);
        return 0;
    }

    std::vector<std::unique_ptr<plane>> planes;
};

} // namespace TestSupport
