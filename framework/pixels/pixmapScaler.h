#pragma once

#include "framework/pixels/memoryPixmap.h"

#include <cstdint>

namespace Sarnik
{

/// One axis of a scaling: which samples of the larger side a pixel of the own side is made from. Positions count from
/// the first pixel of either side.
///
/// Where it reduces, pixel i is the mean over [i * from / to, (i + 1) * from / to), border samples by the part of them
/// that lies inside. Where it enlarges, it is interpolated between the two samples whose middles lie around its own,
/// and the edge samples repeat. Equal sizes copy.
class CScaleAxis
{
public:
    CScaleAxis() = default;
    /// Both at least 1.
    CScaleAxis(std::int64_t fromSize, std::int64_t toSize) : from(fromSize), to(toSize) {}

    bool Reduces() const { return from > to; }
    /// from / to
    double Factor() const { return static_cast<double>(from) / static_cast<double>(to); }

    struct Range
    {
        std::int64_t first = 0, end = 0; ///< half open
    };
    /// The samples that pixels first..end-1 are made from.
    Range Needed(Range pixels) const;
    /// The pixels that samples first..end-1 take part in.
    Range Touched(Range samples) const;

    /// Weights of pixel i, which sum to 1, for the samples from Needed({i, i + 1}).first on; answers how many.
    /// `weights` has MostWeights() places.
    int Weights(std::int64_t i, float *weights) const;
    std::size_t MostWeights() const { return static_cast<std::size_t>(Reduces() ? from / to + 2 : 2); }

private:
    std::int64_t from = 1, to = 1;
};

/// Resamples pictures of 8, 16 or 32 bits. Sums are in single precision; whole samples are rounded to the nearest. A
/// pixel comes out the same whatever the rectangle that it is computed with.
class CPixmapScaler
{
public:
    CPixmapScaler() = default;
    /// The whole of both pictures; neither is empty.
    CPixmapScaler(const CRect &larger, const CRect &own);

    const CScaleAxis &X() const { return x; }
    const CScaleAxis &Y() const { return y; }

    /// What an area of the own picture is made from.
    CRect SourceOf(const CRect &area) const;
    /// What an area of the source takes part in.
    CRect AreaOf(const CRect &source) const;

    /// Fills the planes of `to` over its whole rectangle, which lies within the own picture. `from` covers SourceOf(it)
    /// and has the same depth.
    void Scale(CBasicPixmap &from, int firstFrom, CBasicPixmap &to, int firstTo, int count) const;

private:
    CRect larger, own;
    CScaleAxis x, y;
};

/// A scaling that is done in steps: how the cells of the own picture are cut so that a step stays short however strong
/// the reduction. Along an axis that reduces, the cell's side is cut into as many parts as the reduction, rounded up to
/// a power of two, at most 128.
class CPixScaler : public CPixmapScaler
{
public:
    CPixScaler() = default;
    CPixScaler(const CRect &larger, const CRect &own);

    /// Steps of a cell.
    std::uint32_t Steps() const { return factorX * factorY; }
    std::uint32_t FactorX() const { return factorX; }
    std::uint32_t FactorY() const { return factorY; }
    /// The part of a cell that step 0..Steps()-1 fills, by rows of parts; `side` is that of a whole cell. Cells that
    /// are cut off have steps without pixels.
    CRect Part(const CRect &cell, std::int64_t side, std::uint32_t step) const;

private:
    std::uint32_t factorX = 1, factorY = 1;
};

} // namespace Sarnik
