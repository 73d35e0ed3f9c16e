#pragma once

#include "framework/controls/fields/textPieces.h"
#include "framework/views/port.h"

#include <cstddef>
#include <string>
#include <vector>

namespace Sarnik
{

/// Where the characters of a field's text lie. Offsets are those of the text, also where dots stand for it. The text
/// begins at (0, 0). Interface thread.
class CTextLines
{
public:
    struct shape
    {
        Platform::font font = {};
        bool lines = false;  ///< several, broken at the width
        bool dotted = false; ///< a dot for each character
        double width = 0;    ///< view units, of a text of several lines
        Platform::textAlign align = Platform::textAlign::left;

        friend bool operator==(const shape &, const shape &) = default;
    };

    void Set(const std::string &newText, const shape &newShape);

    /// The same text and shape cost no more than a comparison, a change what is to be laid out again for it.
    const CTextPieces &Pieces() const { return pieces; }
    double Width() const { return pieces.Width(); }
    double Height() const { return pieces.Height(); }
    /// Of one line.
    double LineHeight() const { return pieces.LineHeight(); }
    Platform::rectangle Caret(std::size_t offset) const;
    /// What can be seen of a selection.
    std::vector<Platform::rectangle> Covered(std::size_t from, std::size_t to, const CTextPieces::span &sight) const;
    std::size_t OffsetAt(CPoint p) const;

    std::size_t Next(std::size_t offset) const;
    std::size_t Previous(std::size_t offset) const;
    /// Words of a dotted text are not told.
    std::size_t NextWord(std::size_t offset) const;
    std::size_t PreviousWord(std::size_t offset) const;
    std::size_t LineStart(std::size_t offset) const;
    std::size_t LineEnd(std::size_t offset) const;
    /// The place nearest to x, `by` units below the offset's line; the text's ends where there is no such line.
    std::size_t Below(std::size_t offset, double x, double by) const;

private:
    std::size_t Shown(std::size_t offset) const;
    std::size_t FromShown(std::size_t offset) const;

    std::string text;
    shape form;
    bool made = false;  ///< Set was called
    CTextPieces pieces; ///< of what is shown of the text
};

} // namespace Sarnik
