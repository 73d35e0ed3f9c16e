#pragma once

#include <algorithm>
#include <cstdint>

namespace Sarnik
{

/// Pixels left..right-1, top..bottom-1. Any four numbers are allowed: one that ends before it begins is empty, and
/// sizes are 64 bits wide, so that a rectangle over the whole range of coordinates has a size.
struct CRect
{
    std::int32_t left = 0, top = 0, right = 0, bottom = 0;

    std::int64_t Width() const { return std::max<std::int64_t>(0, std::int64_t{right} - left); }
    std::int64_t Height() const { return std::max<std::int64_t>(0, std::int64_t{bottom} - top); }
    bool Empty() const { return right <= left || bottom <= top; }
    bool Contains(const CRect &other) const
    {
        return left <= other.left && top <= other.top && right >= other.right && bottom >= other.bottom;
    }
    /// What both have; an empty rectangle (not always all 0) where they share nothing.
    CRect Intersected(const CRect &other) const
    {
        return {std::max(left, other.left), std::max(top, other.top), std::min(right, other.right),
                std::min(bottom, other.bottom)};
    }
    /// Moved; edges stop at the ends of the coordinate range.
    CRect Moved(std::int64_t dx, std::int64_t dy) const
    {
        return {Clamped(left + dx), Clamped(top + dy), Clamped(right + dx), Clamped(bottom + dy)};
    }

    friend bool operator==(const CRect &, const CRect &) = default;

    static std::int32_t Clamped(std::int64_t v)
    {
        return static_cast<std::int32_t>(std::clamp<std::int64_t>(v, INT32_MIN, INT32_MAX));
    }
};

} // namespace Sarnik
