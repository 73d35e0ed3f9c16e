#pragma once

#include "platform/canvas/canvas.h"
#include "platform/canvas/text.h"

#include <cstddef>
#include <string>
#include <vector>

namespace Sarnik
{

/// A long text laid out in pieces, one below the other, so that a change of the text lays out only what stands around
/// it. After the first Set. Pieces end at line ends, where no layout reaches across; a paragraph that is too long for a
/// piece is cut where one of its lines begins, and each of its pieces finds its own direction of writing. A text of one
/// line is one piece. Offsets are in bytes of the text, which begins at (0, 0). Interface thread.
class CTextPieces
{
public:
    /// Of a piece, in bytes.
    struct sizes
    {
        std::size_t usual = 1000; ///< lines that belong to one piece; up to twice as much where a piece grows
        std::size_t most = 2000;  ///< of one paragraph; at least twice the usual
        /// In a paragraph of many pieces a change moves what follows, mostly not far: a line soon begins where one did
        /// before. After so many pieces without, one line ends early, so that the rest can stay as it is.
        std::size_t patience = 2;
    };
    CTextPieces() = default;
    explicit CTextPieces(const sizes &of) : limits(of) {}

    /// UTF-8.
    void Set(const std::string &newText, const Platform::font &newFont, const Platform::textOptions &newOptions);
    const std::string &Text() const { return text; }
    /// So far, in all: what the changes have cost.
    std::size_t BytesLaidOut() const { return bytesLaidOut; }

    double Width() const;
    double Height() const;
    /// Of one line.
    double LineHeight() const;
    /// From the top of the first line down to its base line.
    double Baseline() const { return pieces.front().block.baseline(); }
    Platform::rectangle Caret(std::size_t offset) const;
    std::size_t OffsetAt(Platform::point p) const;
    std::size_t NextCharacter(std::size_t offset) const;
    std::size_t PreviousCharacter(std::size_t offset) const;
    std::size_t NextWord(std::size_t offset) const;
    std::size_t PreviousWord(std::size_t offset) const;

    /// What can be seen of the text, from a height to another.
    struct span
    {
        double top, bottom;
    };
    /// What a selection covers, of pieces in sight.
    std::vector<Platform::rectangle> Covered(std::size_t from, std::size_t to, const span &sight) const;
    /// The text's (0, 0) goes to a point; pieces out of sight are left out.
    void Draw(Platform::canvas &canvas, Platform::point at, const span &sight, Platform::colour ink) const;

private:
    /// What follows on a piece.
    enum class edge
    {
        lineEnd,   ///< one byte that is in no piece
        brokenLine ///< the rest of its paragraph; a space between them is in no piece
    };
    struct piece
    {
        std::size_t start, length;
        edge after;
        Platform::textBlock block; ///< with the line end that follows, if any
        double top, height;

        std::size_t End() const { return start + length; }
    };
    using place = std::vector<piece>::const_iterator;

    place At(std::size_t offset) const;
    place AtHeight(double y) const;
    std::size_t Following(const piece &p) const;
    piece LayOut(std::size_t start, std::size_t length, edge after);
    piece Piece(std::size_t start, std::size_t preferredEnd);
    piece BrokenPiece(std::size_t start);
    piece BrokenPiece(std::size_t start, std::size_t end);
    std::size_t Kept(std::size_t same) const;
    void Cut(std::vector<piece> before, std::vector<piece> after);

    sizes limits;
    std::string text;
    Platform::font font;
    Platform::textOptions options;
    std::vector<piece> pieces;
    std::size_t bytesLaidOut = 0;
};

} // namespace Sarnik
