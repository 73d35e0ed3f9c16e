#include "framework/views/damage.h"

#include <algorithm>

namespace Sarnik
{
namespace
{

double area(const CRect &r)
{
    return static_cast<double>(r.Width()) * static_cast<double>(r.Height());
}

/// Pixels that a joined rectangle draws in vain.
double waste(const CRect &a, const CRect &b)
{
    return area(joined(a, b)) - area(a) - area(b) + area(a.Intersected(b));
}

} // namespace

CRect joined(const CRect &a, const CRect &b)
{
    if (a.Empty())
        return b;
    if (b.Empty())
        return a;
    return {std::min(a.left, b.left), std::min(a.top, b.top), std::max(a.right, b.right), std::max(a.bottom, b.bottom)};
}

void CDamage::Add(const CRect &rect)
{
    if (rect.Empty())
        return;
    // Whatever joins without waste is joined: neighbours of one edge, and what lies within.
    CRect added = rect;
    for (std::size_t i = 0; i < parts.size();)
    {
        if (parts[i].Contains(added))
            return;
        if (waste(parts[i], added) > 0)
        {
            ++i;
            continue;
        }
        added = joined(parts[i], added);
        parts.erase(parts.begin() + static_cast<std::ptrdiff_t>(i));
        i = 0;
    }
    parts.push_back(added);
    if (parts.size() <= mostParts)
        return;

    std::size_t first = 0, second = 1;
    for (std::size_t i = 0; i < parts.size(); ++i)
        for (std::size_t j = i + 1; j < parts.size(); ++j)
            if (waste(parts[i], parts[j]) < waste(parts[first], parts[second]))
                first = i, second = j;
    parts[first] = joined(parts[first], parts[second]);
    parts.erase(parts.begin() + static_cast<std::ptrdiff_t>(second));
}

CRect CDamage::Bounds() const
{
    CRect all;
    for (const CRect &part : parts)
        all = joined(all, part);
    return all;
}

} // namespace Sarnik
