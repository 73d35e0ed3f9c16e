#pragma once

#include <cstddef>
#include <deque>
#include <string>
#include <string_view>
#include <vector>

namespace Sarnik
{

/// The text of a field, what is selected in it, and its changes, to be undone. UTF-8; offsets are in bytes, and those
/// that lie within a character count as its beginning, those past the end as the end.
class CTextEditor
{
public:
    /// The longest text; what goes beyond is cut off. A text block can lay out as much in every font of the interface.
    static constexpr std::size_t mostBytes = 100'000;

    /// Whether line ends may stand in the text, and how many characters at most, 0 for no such limit. For what comes
    /// in from now on.
    void SetRules(bool linesAllowed, std::size_t mostCharacters);
    bool Lines() const { return lines; }

    const std::string &Text() const { return text; }
    /// By the program: nothing is left to undo, and the caret goes to the end.
    void SetText(std::string_view utf8);
    /// What would become of a text here: bytes that are no UTF-8 become U+FFFD, line ends of all kinds "\n" or, in a
    /// field of one line, spaces; control characters go.
    std::string Cleaned(std::string_view utf8) const;

    /// Where a selection began, and where the caret stands; the same for no selection.
    std::size_t Anchor() const { return anchor; }
    std::size_t Caret() const { return caret; }
    std::size_t From() const { return anchor < caret ? anchor : caret; }
    std::size_t To() const { return anchor < caret ? caret : anchor; }
    bool HasSelection() const { return anchor != caret; }
    std::string_view Selected() const { return std::string_view(text).substr(From(), To() - From()); }
    void Select(std::size_t from, std::size_t to);
    void SelectAll() { Select(0, text.size()); }

    /// How a change came about. Typed characters of one word, and characters erased one after the other, are undone
    /// together, unless the caret was moved in between.
    enum class change
    {
        typed,
        erased,
        whole
    };
    /// Puts a text in the place of the selection, as much of it as there is room for. Whether anything changed.
    bool Insert(std::string_view utf8, change kind = change::whole);
    /// Takes out a part. Whether there was any.
    bool Erase(std::size_t from, std::size_t to, change kind = change::erased);

    bool CanUndo() const { return done > 0; }
    bool CanRedo() const { return done < steps.size(); }
    /// False where there is nothing to do. The selection comes back as well.
    bool Undo();
    bool Redo();
    void ForgetHistory();

    /// The run of letters, of spaces or of signs around an offset.
    struct range
    {
        std::size_t from, to;
    };
    range WordAt(std::size_t offset) const;

private:
    struct step
    {
        std::size_t at;
        std::string removed, inserted;
        std::size_t anchorBefore, caretBefore;
        change kind;
    };

    std::size_t Snapped(std::size_t offset) const;
    void CutToRules(std::string &incoming, std::size_t replacedBytes, std::size_t replacedCharacters) const;
    void Apply(step made);
    bool Merge(const step &made);

    bool lines = false;
    std::size_t characters = 0;
    std::string text;
    std::size_t anchor = 0, caret = 0;
    std::deque<step> steps;
    std::size_t done = 0;  ///< steps before this one are in the text, those from it on were undone
    std::size_t kept = 0;  ///< bytes in all steps
    bool mayMerge = false; ///< with the last step
};

} // namespace Sarnik
