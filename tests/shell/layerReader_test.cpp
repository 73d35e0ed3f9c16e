#include "framework/base/exceptions.h"
#include "framework/pixels/fills.h"
#include "shell/layerReader.h"
#include "tests/shell/fakeChannels.h"

#include <gtest/gtest.h>

namespace
{

using namespace Sarnik;
using TestSupport::fakeChannels;

std::uint32_t bitsAt(CBasicPixmap &pixmap, int plane, std::int32_t x, std::int32_t y)
{
    const std::size_t bytes = static_cast<std::size_t>(pixmap.GetDepth()) / 8;
    std::uint32_t v = 0;
    std::memcpy(&v, pixmap.Plane(plane).Row<std::byte>(y) + (x - pixmap.Bounds().left) * static_cast<int>(bytes),
                bytes);
    return v;
}

/// Bounds away from 0 in both coordinate systems, and a channel that is smaller than the picture.
struct documentOf
{
    documentOf(CPixelKind kind, int depth, int planes, bool transparency)
    {
        host.format = {kind, depth, planes};
        host.originX = 100;
        host.originY = -50;
        CChannelList list;
        for (int p = 0; p < planes; ++p)
            list.colour.push_back(host.Make(inDocument, depth));
        if (transparency)
            list.transparency.push_back(host.Make(inDocument, depth));
        host.lists[layerTarget] = list;
    }
    fakeChannels host;
    const CRect inPicture{-7, 20, 36, 61};
    const CRect inDocument{93, -30, 136, 11};

    std::uint32_t Truth(const CChannel &channel, std::int32_t x, std::int32_t y)
    {
        return fakeChannels::Of(channel).At(x + host.originX, y + host.originY);
    }
};

constexpr std::uint32_t constants[] = {11, 22, 33, 44};

std::uint32_t opaque(int depth)
{
    return depth == 8 ? 255u : depth == 16 ? 32768u : 0xffffffffu;
}

/// Every read against its definition: all depths, with and without transparency, rectangles inside, across each edge,
/// one pixel wide and outside, every way to fill.
TEST(ReadLayer, DeliversSamplesAndFillsTheRest)
{
    for (const int depth : {8, 16, 32})
        for (const int planes : {1, 3, 4})
            for (const bool transparency : {false, true})
                for (const int mode : {0, 1, 2, 3})
                    for (const CRect &rect : {CRect{-7, 20, 36, 61}, CRect{0, 30, 9, 35}, CRect{-20, 10, -6, 70},
                                              CRect{30, 50, 80, 70}, CRect{-9, 60, 40, 64}, CRect{40, 0, 50, 90}})
                    {
                        SCOPED_TRACE(testing::Message() << depth << " bits, " << planes << " planes, mode " << mode
                                                        << ", from " << rect.left << ", " << rect.top);
                        documentOf d(CPixelKind::rgb, depth, planes, transparency);
                        CMemoryPixmap pixmap(rect, depth, planes + 1);
                        ReadLayer(d.host, pixmap, layerTarget, layerNone, CFillMode(mode), constants);
                        const CChannelList &list = d.host.lists[layerTarget];
                        const CRect seen = rect.Intersected(d.inPicture);
                        EXPECT_EQ(d.host.calls == 0, seen.Empty()) << "no read where there is nothing";

                        for (std::int32_t y = rect.top; y < rect.bottom; ++y)
                            for (std::int32_t x = rect.left; x < rect.right; ++x)
                            {
                                const bool inside = d.inPicture.Contains({x, y, x + 1, y + 1});
                                for (int p = 0; p < planes; ++p)
                                {
                                    std::uint32_t wanted = constants[p];
                                    if (!seen.Empty() && (inside || mode >= 2))
                                        wanted = d.Truth(list.colour[static_cast<std::size_t>(p)],
                                                         std::clamp(x, seen.left, seen.right - 1),
                                                         std::clamp(y, seen.top, seen.bottom - 1));
                                    ASSERT_EQ(bitsAt(pixmap, p, x, y), wanted) << p << " at " << x << ", " << y;
                                }
                                // Without samples transparency is the constant of its plane, or 0 around them.
                                std::uint32_t alpha = planes < 4 ? constants[planes] : 0;
                                if (!seen.Empty() && !transparency)
                                    alpha = mode == 0 || inside ? opaque(depth) : 0;
                                else if (inside)
                                    alpha = d.Truth(list.transparency[0], x, y);
                                else if (!seen.Empty() && mode != 0)
                                    alpha = 0;
                                ASSERT_EQ(bitsAt(pixmap, planes, x, y), alpha) << "transparency " << x << ", " << y;
                            }
                    }
}

TEST(ReadLayer, FallsBackOnceAndThenFills)
{
    documentOf d(CPixelKind::rgb, 8, 3, false);
    const CRect far{-100, -100, 200, 200};
    CChannelList merged;
    for (int p = 0; p < 3; ++p)
        merged.colour.push_back(d.host.Make(far.Moved(100, -50), 8));
    d.host.lists[layerMerged] = merged;
    const auto read = [&](const CRect &rect, int source, int fallback, CFillMode mode = CFillMode::replicate) {
        CMemoryPixmap pixmap(rect, 8, 3);
        d.host.calls = 0;
        ReadLayer(d.host, pixmap, source, fallback, mode, constants);
        return bitsAt(pixmap, 1, rect.left, rect.top);
    };
    const auto mergedAt = [&](std::int32_t x, std::int32_t y) { return d.Truth(merged.colour[1], x, y); };

    EXPECT_EQ(read({0, 0, 30, 30}, layerTarget, layerMerged), mergedAt(0, 0)) << "around a part: the fallback";
    EXPECT_EQ(d.host.calls, 6);
    EXPECT_EQ(read({90, 90, 95, 95}, layerTarget, layerMerged), mergedAt(90, 90)) << "beside it";
    EXPECT_EQ(read({0, 0, 5, 5}, 3, layerMerged), mergedAt(0, 0)) << "no such layer";
    EXPECT_EQ(read({0, 0, 5, 5}, 3, 4), 22u) << "nor a fallback";
    EXPECT_EQ(read({0, 0, 5, 5}, layerNone, layerMerged), 22u) << "no source: no fallback either";
    EXPECT_EQ(d.host.calls, 0);
    d.host.hasDocument = false;
    EXPECT_EQ(read({0, 25, 5, 30}, layerTarget, layerMerged), 22u);
    EXPECT_EQ(d.host.calls, 0);
}

TEST(ReadLayer, LeavesOutChannelsThatAreNotPresentInTheTargetAlone)
{
    documentOf d(CPixelKind::rgb, 8, 3, false);
    d.host.lists[layerTarget].colour[1].present = false;
    d.host.lists[0] = d.host.lists[layerTarget];
    for (const int layer : {layerTarget, 0})
    {
        CMemoryPixmap pixmap({0, 30, 4, 34}, 8, 3);
        ReadLayer(d.host, pixmap, layer, layerNone, CFillMode::constant);
        const CChannelList &list = d.host.lists[layer];
        EXPECT_EQ(bitsAt(pixmap, 0, 3, 33), d.Truth(list.colour[0], 3, 33));
        EXPECT_EQ(bitsAt(pixmap, 1, 3, 33), layer == 0 ? d.Truth(list.colour[1], 3, 33) : 0u);
        EXPECT_EQ(bitsAt(pixmap, 2, 3, 33), d.Truth(list.colour[2], 3, 33)) << "in its own plane";
    }
}

/// A host may say that its channels are as large as the first one when they are not.
TEST(ReadLayer, TrustsNoChannelToBeAsLargeAsItsList)
{
    documentOf d(CPixelKind::rgb, 16, 3, false);
    d.host.lists[layerTarget].colour[2] = d.host.Make({93, -30, 110, -20}, 16);
    d.host.lists[layerTarget].transparency.push_back(d.host.Make({0, 0, 0, 0}, 16));
    CMemoryPixmap pixmap(d.inPicture, 16, 4);
    ReadLayer(d.host, pixmap, layerTarget, layerNone, CFillMode::replicate);
    EXPECT_EQ(bitsAt(pixmap, 2, 9, 29), d.Truth(d.host.lists[layerTarget].colour[2], 9, 29));
    EXPECT_EQ(bitsAt(pixmap, 2, 10, 29), 0u);
    EXPECT_EQ(bitsAt(pixmap, 3, 0, 30), 0u);

    CMemoryPixmap edge({INT32_MAX - 3, INT32_MIN, INT32_MAX, INT32_MIN + 3}, 16, 4);
    EXPECT_NO_THROW(ReadLayer(d.host, edge, layerTarget, layerNone, CFillMode::replicate));
}

TEST(ReadLayer, AFailedReadAbortsInSilenceWhereverItHappens)
{
    for (int n = 0; n < 4; ++n)
    {
        documentOf d(CPixelKind::rgb, 8, 3, true);
        d.host.failCallAt = n;
        CMemoryPixmap pixmap({0, 30, 4, 34}, 8, 4);
        try
        {
            ReadLayer(d.host, pixmap, layerTarget, layerNone, CFillMode::replicate);
            ADD_FAILURE() << "read " << n << " failed unseen";
        }
        catch (const CAbort &abort)
        {
            EXPECT_TRUE(abort.Silent());
        }
    }
}

TEST(ReadMask, WidensSelectionsOfEightBits)
{
    EXPECT_EQ(widenSelection(std::uint8_t{255}), 32768);
    EXPECT_EQ(widenSelection(std::uint8_t{0}), 0);
    for (const int documentDepth : {8, 16, 32})
    {
        SCOPED_TRACE(documentDepth);
        documentOf d(CPixelKind::grey, documentDepth, 1, false);
        const int arrives = documentDepth == 16 ? 8 : documentDepth;
        CChannelList selection;
        selection.colour.push_back(d.host.Make(d.inDocument, arrives));
        d.host.lists[layerSelection] = selection;
        const CRect rect{-30, 40, 20, 80};
        CMemoryPixmap pixmap(rect, documentDepth, 2);
        ReadMask(d.host, pixmap, layerSelection, 1, 5);
        for (std::int32_t y = rect.top; y < rect.bottom; ++y)
            for (std::int32_t x = rect.left; x < rect.right; ++x)
            {
                std::uint32_t wanted = 5;
                if (d.inPicture.Contains({x, y, x + 1, y + 1}))
                {
                    wanted = d.Truth(selection.colour[0], x, y);
                    if (documentDepth == 16)
                        wanted = (wanted * 32768 + 128) / 255;
                }
                ASSERT_EQ(bitsAt(pixmap, 1, x, y), wanted) << x << ", " << y;
                ASSERT_EQ(bitsAt(pixmap, 0, x, y), 0u);
            }
    }

    documentOf d(CPixelKind::grey, 16, 1, false);
    d.host.lists[layerSelection].colour.push_back(d.host.Make(d.inDocument, 8));
    CMemoryPixmap real({0, 30, 9, 40}, 32, 1);
    ReadMask(d.host, real, layerSelection, 0);
    EXPECT_EQ(real.Plane(0).Row<float>(35)[4],
              static_cast<float>(d.Truth(d.host.lists[layerSelection].colour[0], 4, 35)) / 255.0f);
    d.host.lists.erase(layerSelection);
    ReadMask(d.host, real, layerSelection, 0, 0x3f800000);
    EXPECT_EQ(real.Plane(0).Row<float>(35)[4], 1.0f) << "no selection: the constant";
}

TEST(WriteTarget, ComesBackExactAndTouchesNothingElse)
{
    for (const int depth : {8, 16, 32})
        for (const bool withTransparency : {false, true})
        {
            documentOf from(CPixelKind::rgb, depth, 3, true), to(CPixelKind::rgb, depth, 3, true);
            // Other samples than in the source: channels are filled by the order in which they are made.
            to.host.lists.clear();
            CChannelList list;
            for (int p = 0; p < 3; ++p)
                list.colour.push_back(to.host.Make(to.inDocument, depth));
            list.transparency.push_back(to.host.Make(to.inDocument, depth));
            to.host.lists[layerTarget] = list;

            CMemoryPixmap pixmap({-20, 25, 50, 40}, depth, 4), before(to.inPicture, depth, 4),
                after(to.inPicture, depth, 4);
            ReadLayer(from.host, pixmap, layerTarget, layerNone, CFillMode::replicate);
            ReadLayer(to.host, before, layerTarget, layerNone, CFillMode::constant);
            const CRect written{-50, 27, 30, 90}, seen{-7, 27, 30, 40};
            WriteTarget(to.host, pixmap, written, withTransparency);
            ReadLayer(to.host, after, layerTarget, layerNone, CFillMode::constant);
            for (int p = 0; p < 4; ++p)
                for (std::int32_t y = 20; y < 61; ++y)
                    for (std::int32_t x = -7; x < 36; ++x)
                    {
                        const bool changed = seen.Contains({x, y, x + 1, y + 1}) && (p < 3 || withTransparency);
                        ASSERT_EQ(bitsAt(after, p, x, y), bitsAt(changed ? pixmap : before, p, x, y));
                    }
        }

    documentOf d(CPixelKind::rgb, 8, 3, false);
    CMemoryPixmap pixmap(d.inPicture, 8, 3);
    d.host.failCallAt = 2;
    d.host.failCode = -34;
    EXPECT_THROW(WriteTarget(d.host, pixmap, d.inPicture, false), CTintorelError);
    d.host.failCallAt = 3;
    d.host.failCode = 1;
    EXPECT_THROW(WriteTarget(d.host, pixmap, d.inPicture, false), CAbort);
}

} // namespace
