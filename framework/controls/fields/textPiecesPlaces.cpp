#include "framework/controls/fields/textPieces.h"

#include <algorithm>
#include <iterator>

namespace Sarnik
{
namespace
{

Platform::rectangle moved(const Platform::rectangle &r, double down)
{
    return {r.left, r.top + down, r.right, r.bottom + down};
}

} // namespace

/// The piece that an offset is in; between pieces the first one's end.
CTextPieces::place CTextPieces::At(std::size_t offset) const
{
    return std::prev(std::upper_bound(std::next(pieces.begin()), pieces.end(), offset,
                                      [](std::size_t at, const piece &p) { return at < p.start; }));
}

CTextPieces::place CTextPieces::AtHeight(double y) const
{
    return std::prev(std::upper_bound(std::next(pieces.begin()), pieces.end(), y,
                                      [](double at, const piece &p) { return at < p.top; }));
}

double CTextPieces::Width() const
{
    double width = 0;
    for (const piece &p : pieces)
        width = std::max(width, p.block.width());
    return width;
}

double CTextPieces::Height() const
{
    return pieces.back().top + pieces.back().height;
}

double CTextPieces::LineHeight() const
{
    return pieces.front().block.caret(0).height();
}

Platform::rectangle CTextPieces::Caret(std::size_t offset) const
{
    const auto p = At(offset);
    return moved(p->block.caret(offset - p->start), p->top);
}

std::size_t CTextPieces::OffsetAt(Platform::point at) const
{
    const auto p = AtHeight(at.y);
    return p->start + p->block.offsetAt({at.x, at.y - p->top});
}

std::size_t CTextPieces::NextCharacter(std::size_t offset) const
{
    const auto p = At(offset);
    if (offset < p->End())
        return p->start + p->block.nextCharacter(offset - p->start);
    return std::next(p) == pieces.end() ? p->End() : std::next(p)->start;
}

std::size_t CTextPieces::PreviousCharacter(std::size_t offset) const
{
    const auto p = At(offset);
    if (offset > p->start)
        return p->start + p->block.previousCharacter(offset - p->start);
    if (p == pieces.begin())
        return 0;
    const auto before = std::prev(p);
    // Where nothing lies between the pieces, the end of the one is the beginning of the other.
    return before->End() < p->start ? before->End() : before->start + before->block.previousCharacter(before->length);
}

std::size_t CTextPieces::NextWord(std::size_t offset) const
{
    auto p = At(offset);
    std::size_t found = offset < p->End() ? p->block.nextWord(offset - p->start) : p->length;
    while (found >= p->length && std::next(p) != pieces.end())
    {
        ++p;
        found = p->block.beginsWithWord() ? 0 : p->block.nextWord(0);
        if (found < p->length)
            break;
    }
    return p->start + std::min(found, p->length);
}

std::size_t CTextPieces::PreviousWord(std::size_t offset) const
{
    auto p = At(offset);
    for (std::size_t from = offset - p->start;; from = p->length)
    {
        const std::size_t found = from > 0 ? p->block.previousWord(from) : 0;
        if (found > 0 || (from > 0 && p->block.beginsWithWord()) || p == pieces.begin())
            return p->start + found;
        --p;
    }
}

std::vector<Platform::rectangle> CTextPieces::Covered(std::size_t from, std::size_t to, const span &sight) const
{
    std::vector<Platform::rectangle> result;
    for (auto p = AtHeight(sight.top); p != pieces.end() && p->top < sight.bottom && p->start < to; ++p)
        if (from < p->End())
            for (const Platform::rectangle &r : p->block.covered(from < p->start ? 0 : from - p->start, to - p->start))
                result.push_back(moved(r, p->top));
    return result;
}

void CTextPieces::Draw(Platform::canvas &canvas, Platform::point at, const span &sight, Platform::colour ink) const
{
    for (auto p = AtHeight(sight.top); p != pieces.end() && p->top < sight.bottom; ++p)
        canvas.drawText(p->block, {at.x, at.y + p->top}, ink);
}

} // namespace Sarnik
