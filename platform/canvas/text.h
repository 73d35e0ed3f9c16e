#pragma once

#include "platform/canvas/geometry.h"

#include <cstddef>
#include <memory>
#include <string>
#include <string_view>
#include <vector>

namespace Platform
{

struct font
{
    double size = 12; ///< of the em, in view units; cut to 1 to 1000
    bool bold = false, italic = false;
    std::string family = "Sans"; ///< a name that the system's font setup knows or replaces

    friend bool operator==(const font &, const font &) = default;
};

enum class textAlign
{
    left,
    centre,
    right
};

/// Where letters make room for an ellipsis when the text is too wide.
enum class textTrim
{
    none,
    start,
    middle,
    end
};

struct textOptions
{
    double width = 0;   ///< room in view units, for lines, alignment and trimming; 0: as wide as the text
    bool lines = false; ///< line ends count, and lines that are too wide are broken between words
    textAlign align = textAlign::left;
    textTrim trim = textTrim::none;
    std::ptrdiff_t underlined = -1; ///< byte offset of one character to underline; -1 none

    friend bool operator==(const textOptions &, const textOptions &) = default;
};

/// A text laid out, ready to be drawn. Measures do not depend on the scale that it is drawn at. Offsets are in bytes of
/// text(). One thread at a time.
class textBlock
{
public:
    /// UTF-8. Bytes that are none, and zero bytes, stand as U+FFFD. What goes past some 100,000 letters of size 12
    /// (fewer of a larger size) is left out of the layout.
    explicit textBlock(std::string_view utf8, const font &f = {}, const textOptions &options = {});
    ~textBlock();
    textBlock(textBlock &&) noexcept;
    textBlock &operator=(textBlock &&) noexcept;

    /// As laid out.
    const std::string &text() const;

    /// Of the advance boxes: from the first line's top to the last line's bottom.
    double width() const;
    double height() const;
    /// From the top of the first line down to its base line.
    double baseline() const;
    int lineCount() const;
    /// Where the last line begins.
    std::size_t lastLine() const;

    /// Where the caret stands before the character at the offset: a rectangle of no width. Offsets past the end are the
    /// end's.
    rectangle caret(std::size_t offset) const;
    /// The caret place nearest to a point.
    std::size_t offsetAt(point p) const;
    /// What a selection covers: one rectangle or more for each line that it touches.
    std::vector<rectangle> covered(std::size_t from, std::size_t to) const;

    /// The next place where a caret can stand, or a word begins, in the direction; the text's ends where there is none.
    std::size_t nextCharacter(std::size_t offset) const;
    std::size_t previousCharacter(std::size_t offset) const;
    std::size_t nextWord(std::size_t offset) const;
    std::size_t previousWord(std::size_t offset) const;
    bool beginsWithWord() const;

private:
    friend class canvas;
    struct layout;
    std::unique_ptr<layout> made;
};

} // namespace Platform
