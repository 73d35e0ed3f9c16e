#include "framework/pixels/toGrey.h"

#include "framework/pixels/greyRows.h"

#include <algorithm>
#include <optional>
#include <vector>

namespace Sarnik
{
namespace
{

enum class greyRule
{
    rgb,
    firstPlane,
    cmyk
};

std::optional<greyRule> ruleFor(const CGreySource &about, int planes, int depth)
{
    if (depth != 8 && depth != 16 && depth != 32)
        return std::nullopt;
    const int colourAndAlpha = planes - (about.hasMask ? 1 : 0);
    if (about.kind == CPixelKind::rgb)
        return colourAndAlpha == 4 ? std::optional(greyRule::rgb) : std::nullopt;
    if (about.kind == CPixelKind::lab)
        return colourAndAlpha == 4 && depth != 32 ? std::optional(greyRule::firstPlane) : std::nullopt;
    if (colourAndAlpha == 2)
        return greyRule::firstPlane;
    return colourAndAlpha == 5 && depth != 32 ? std::optional(greyRule::cmyk) : std::nullopt;
}

std::uint8_t limitFor(const CMaskLimits &limits, std::uint8_t)
{
    return limits.byte;
}
std::uint16_t limitFor(const CMaskLimits &limits, std::uint16_t)
{
    return limits.word;
}
float limitFor(const CMaskLimits &limits, float)
{
    return limits.real;
}

template <class Sample> class rowConverter
{
public:
    rowConverter(greyRule greyBy, const CGreySource &source) : rule(greyBy), about(source) {}

    /// One row of a piece; `mask` may be null.
    void Convert(const CPixelLock &piece, std::int32_t y, double *grey, std::uint8_t *mask)
    {
        const auto n = static_cast<std::size_t>(piece.Rect().Width());
        const Sample limit = limitFor(about.limits, Sample());
        if (mask != nullptr)
            std::fill_n(mask, n, std::uint8_t{0});

        if constexpr (!std::is_same_v<Sample, float>)
            if (rule == greyRule::cmyk)
                return ConvertQuads(piece, y, n, limit, grey, mask);

        const int used = rule == greyRule::rgb ? 3 : 1;
        const Sample *planes[3] = {};
        for (int p = 0; p < used; ++p)
            planes[p] = piece[static_cast<std::size_t>(p)].template Row<const Sample>(y);
        if (rule == greyRule::rgb)
            greyOfRgb(n, planes[0], planes[1], planes[2], grey);
        else
            greyOfPlane(n, planes[0], grey);
        if (mask != nullptr)
            for (int p = 0; p < used; ++p)
                markAbove(n, planes[p], limit, mask);
    }

private:
    void ConvertQuads(const CPixelLock &piece, std::int32_t y, std::size_t n, Sample limit, double *grey,
                      std::uint8_t *mask)
    {
        quads.resize(4 * n);
        const Sample *planes[4];
        for (std::size_t p = 0; p < 4; ++p)
            planes[p] = piece[p].template Row<const Sample>(y);
        interleave(n, planes, quads.data());
        if (about.converter != nullptr)
            about.converter->CmykToRgb(quads.data(), n);
        greyOfRgbQuads(n, quads.data(), grey);
        if (mask != nullptr)
            markAboveQuads(n, quads.data(), limit, mask);
    }

    greyRule rule;
    const CGreySource &about;
    std::vector<Sample> quads;
};

template <class Sample>
void convertArea(CPixmap &source, const CRect &area, greyRule rule, const CGreySource &about, CMemoryPixmap &grey,
                 CMemoryPixmap *mask)
{
    rowConverter<Sample> rows(rule, about);
    const int used = rule == greyRule::cmyk ? 4 : rule == greyRule::rgb ? 3 : 1;
    forEachPiece(source, area, 0, used, CPixelAccess::read, [&](const CPixelLock &piece) {
        const CPixelLock out = grey.LockArea(piece.Rect(), 0, CPixelAccess::write);
        CPixelLock marks;
        if (mask != nullptr)
            marks = mask->LockArea(piece.Rect(), 0, CPixelAccess::write);
        for (std::int32_t y = piece.Rect().top; y < piece.Rect().bottom; ++y)
            rows.Convert(piece, y, out[0].Row<double>(y), mask != nullptr ? marks[0].Row<std::uint8_t>(y) : nullptr);
    });
}

} // namespace

bool ToGrey(CPixmap &source, const CRect &area, const CGreySource &about, CMemoryPixmap &grey, CMemoryPixmap *mask)
{
    const std::optional<greyRule> rule = ruleFor(about, source.GetPlaneCount(), source.GetDepth());
    if (!rule || grey.GetDepth() != 64 || grey.GetPlaneCount() < 1 ||
        (mask != nullptr && (mask->GetDepth() != 8 || mask->GetPlaneCount() < 1)))
        return false;
    CRect shared = area.Intersected(grey.Bounds());
    if (mask != nullptr)
        shared = shared.Intersected(mask->Bounds());

    switch (source.GetDepth())
    {
    case 8:
        convertArea<std::uint8_t>(source, shared, *rule, about, grey, mask);
        break;
    case 16:
        convertArea<std::uint16_t>(source, shared, *rule, about, grey, mask);
        break;
    default:
        convertArea<float>(source, shared, *rule, about, grey, mask);
        break;
    }
    return true;
}

} // namespace Sarnik
