#include "framework/controls/fields/textPieces.h"

#include "platform/utf8.h"

#include <algorithm>
#include <iterator>
#include <string_view>
#include <utility>

namespace Sarnik
{
void CTextPieces::Set(const std::string &newText, const Platform::font &newFont,
                      const Platform::textOptions &newOptions)
{
    std::vector<piece> before, after;
    if (font == newFont && options == newOptions && !pieces.empty())
    {
        if (text == newText)
            return;
        const std::size_t shorter = std::min(text.size(), newText.size());
        const auto same = static_cast<std::size_t>(
            std::mismatch(text.begin(), text.begin() + static_cast<std::ptrdiff_t>(shorter), newText.begin()).first -
            text.begin());
        const auto sameEnd = static_cast<std::size_t>(
            std::mismatch(text.rbegin(), text.rbegin() + static_cast<std::ptrdiff_t>(shorter - same), newText.rbegin())
                .first -
            text.rbegin());
        const auto move = [&](std::size_t from, std::size_t to, std::vector<piece> &into) {
            into.assign(std::move_iterator(pieces.begin() + static_cast<std::ptrdiff_t>(from)),
                        std::move_iterator(pieces.begin() + static_cast<std::ptrdiff_t>(to)));
        };
        const std::size_t kept = Kept(same);
        const auto tail =
            std::max(kept, static_cast<std::size_t>(
                               std::partition_point(pieces.begin(), pieces.end(),
                                                    [&](const piece &p) { return p.start < text.size() - sameEnd; }) -
                               pieces.begin()));
        move(tail, pieces.size(), after);
        move(0, kept, before);
        for (piece &p : after)
            p.start += newText.size() - text.size(); // wraps round where it becomes less
    }
    text = newText;
    font = newFont;
    options = newOptions;
    Cut(std::move(before), std::move(after));
}

/// How many pieces do not depend on anything behind the first bytes.
std::size_t CTextPieces::Kept(std::size_t same) const
{
    std::size_t kept = 0;
    while (kept + 1 < pieces.size())
    {
        const piece &p = pieces[kept];
        if (same < (p.after == edge::lineEnd ? p.End() + 1 : p.start + limits.most + 1))
            break;
        ++kept;
    }
    return kept;
}

/// Lays out what stands between pieces that are still good, and what of the latter no piece meets any more.
void CTextPieces::Cut(std::vector<piece> before, std::vector<piece> after)
{
    pieces = std::move(before);
    std::size_t start = pieces.empty() ? 0 : Following(pieces.back());
    std::size_t missed = 0;
    for (auto next = after.begin();;)
    {
        for (; next != after.end() && next->start < start; ++next)
            ++missed;
        if (next != after.end() && next->start == start)
        {
            pieces.insert(pieces.end(), std::move_iterator(next), std::move_iterator(after.end()));
            break;
        }
        // Up to a piece that is still good, or to a later one where this one would be small.
        std::size_t preferred = std::string::npos;
        for (auto good = next; good != after.end() && text[good->start - 1] == '\n'; ++good)
        {
            const std::size_t bytes = good->start - 1 - start;
            if (bytes <= limits.usual || (preferred == std::string::npos && bytes <= 2 * limits.usual))
                preferred = good->start - 1;
            else
                break;
        }
        const bool early = missed >= limits.patience && preferred == std::string::npos && next != after.end() &&
                           next->start - start <= limits.most;
        pieces.push_back(early ? BrokenPiece(start, next->start) : Piece(start, preferred));
        if (pieces.back().End() == text.size())
            break;
        start = Following(pieces.back());
    }
    double top = 0;
    for (piece &p : pieces)
    {
        p.top = top;
        top += p.height;
    }
}

CTextPieces::piece CTextPieces::LayOut(std::size_t start, std::size_t length, edge after)
{
    // With the line end: whether spaces before it need room depends on it.
    const bool endsLine = after == edge::lineEnd && start + length < text.size();
    const std::size_t bytes = length + (endsLine ? 1 : 0);
    bytesLaidOut += bytes;
    Platform::textBlock block(std::string_view(text).substr(start, bytes), font, options);
    piece made{start, length, after, std::move(block), 0, 0};
    made.height = endsLine ? made.block.caret(bytes).top : made.block.height();
    return made;
}

CTextPieces::piece CTextPieces::Piece(std::size_t start, std::size_t preferredEnd)
{
    std::size_t end = preferredEnd;
    if (end == std::string::npos && options.lines && text.size() - start > limits.usual)
    {
        end = text.rfind('\n', start + limits.usual);
        if (end == std::string::npos || end < start)
            end = text.find('\n', start);
    }
    end = std::min(end, text.size());
    if (options.lines && end - start > limits.most)
        return BrokenPiece(start);
    return LayOut(start, end - start, edge::lineEnd);
}

/// The lines before the one in which the longest piece would end.
CTextPieces::piece CTextPieces::BrokenPiece(std::size_t start)
{
    std::size_t end = Platform::characterStart(text, start + limits.most);
    const Platform::textBlock tried = LayOut(start, end - start, edge::brokenLine).block;
    if (tried.lastLine() > 0)
        end = start + tried.lastLine();
    else if (tried.previousCharacter(end - start) > 0) // one line that is as long as that
        end = start + tried.previousCharacter(end - start);
    return BrokenPiece(start, end);
}

CTextPieces::piece CTextPieces::BrokenPiece(std::size_t start, std::size_t end)
{
    return LayOut(start, end - start - (text[end - 1] == ' ' ? 1 : 0), edge::brokenLine);
}

std::size_t CTextPieces::Following(const piece &p) const
{
    return p.after == edge::lineEnd || text[p.End()] == ' ' ? p.End() + 1 : p.End();
}

} // namespace Sarnik
