#include "framework/controls/fields/textLines.h"

#include "platform/utf8.h"

#include <algorithm>
#include <string_view>

namespace Sarnik
{
namespace
{

constexpr std::string_view dot = "\xE2\x80\xA2";
constexpr double farRight = 1e6;

} // namespace

void CTextLines::Set(const std::string &newText, const shape &newShape)
{
    if (form == newShape && made && text == newText)
        return;
    form = newShape;
    text = newText;
    made = true;
    std::string dots;
    if (form.dotted)
        for (std::size_t n = Platform::characterCount(text); n > 0; --n)
            dots += dot;
    pieces.Set(form.dotted ? dots : text, form.font,
               Platform::textOptions{.width = form.lines ? form.width : 0,
                                     .lines = form.lines,
                                     .align = form.lines ? form.align : Platform::textAlign::left});
}

std::size_t CTextLines::Shown(std::size_t offset) const
{
    if (!form.dotted)
        return offset;
    return dot.size() * Platform::characterCount(std::string_view(text).substr(0, offset));
}

std::size_t CTextLines::FromShown(std::size_t offset) const
{
    return form.dotted ? Platform::bytesOfCharacters(text, offset / dot.size()) : offset;
}

Platform::rectangle CTextLines::Caret(std::size_t offset) const
{
    return pieces.Caret(Shown(offset));
}

std::vector<Platform::rectangle> CTextLines::Covered(std::size_t from, std::size_t to,
                                                     const CTextPieces::span &sight) const
{
    return pieces.Covered(Shown(from), Shown(to), sight);
}

std::size_t CTextLines::OffsetAt(CPoint p) const
{
    // In one line, above and below are no directions.
    return FromShown(pieces.OffsetAt({p.x, form.lines ? p.y : LineHeight() / 2}));
}

std::size_t CTextLines::Next(std::size_t offset) const
{
    return FromShown(pieces.NextCharacter(Shown(offset)));
}

std::size_t CTextLines::Previous(std::size_t offset) const
{
    return FromShown(pieces.PreviousCharacter(Shown(offset)));
}

std::size_t CTextLines::NextWord(std::size_t offset) const
{
    return form.dotted ? text.size() : pieces.NextWord(offset);
}

std::size_t CTextLines::PreviousWord(std::size_t offset) const
{
    return form.dotted ? 0 : pieces.PreviousWord(offset);
}

std::size_t CTextLines::LineStart(std::size_t offset) const
{
    if (!form.lines)
        return 0;
    const Platform::rectangle at = Caret(offset);
    return OffsetAt({-1, (at.top + at.bottom) / 2});
}

std::size_t CTextLines::LineEnd(std::size_t offset) const
{
    if (!form.lines)
        return text.size();
    const Platform::rectangle at = Caret(offset);
    const std::size_t end = OffsetAt({farRight, (at.top + at.bottom) / 2});
    // The end of a line that was broken is the beginning of the next one.
    return Caret(end).top > at.top + at.height() / 2 ? std::max(Previous(end), offset) : end;
}

std::size_t CTextLines::Below(std::size_t offset, double x, double by) const
{
    const Platform::rectangle at = Caret(offset);
    const double y = (at.top + at.bottom) / 2 + by;
    if (y < 0)
        return 0;
    return y >= pieces.Height() ? text.size() : OffsetAt({x, y});
}

} // namespace Sarnik
