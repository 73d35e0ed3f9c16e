#pragma once

#include "framework/pixels/rect.h"

#include <span>
#include <utility>
#include <vector>

namespace Sarnik
{

/// What of a window waits to be drawn again: a few rectangles that together cover everything that was added and little
/// else. They may overlap.
class CDamage
{
public:
    /// Beyond this many the two that waste least are made one.
    static constexpr std::size_t mostParts = 12;

    void Add(const CRect &rect);
    void Clear() { parts.clear(); }
    bool Empty() const { return parts.empty(); }
    std::span<const CRect> Parts() const { return parts; }
    /// Around all parts.
    CRect Bounds() const;
    /// The parts, leaving none.
    std::vector<CRect> Take() { return std::exchange(parts, {}); }

private:
    std::vector<CRect> parts;
};

/// The smallest rectangle around both; an empty one does not count.
CRect joined(const CRect &a, const CRect &b);

} // namespace Sarnik
