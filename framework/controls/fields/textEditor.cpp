#include "framework/controls/fields/textEditor.h"

#include "platform/utf8.h"

#include <algorithm>
#include <utility>

namespace Sarnik
{
namespace
{

/// What may be undone: steps, and bytes in them.
constexpr std::size_t mostSteps = 500, mostKept = 1'000'000;

enum class sort
{
    space,
    letter,
    sign
};

/// Of a byte; all bytes of characters beyond ASCII are those of letters.
sort sortOf(char c)
{
    const auto byte = static_cast<unsigned char>(c);
    if (byte <= ' ')
        return sort::space;
    const bool letter = byte >= 0x80 || (byte >= '0' && byte <= '9') || (byte >= 'A' && byte <= 'Z') ||
                        (byte >= 'a' && byte <= 'z') || byte == '_';
    return letter ? sort::letter : sort::sign;
}

} // namespace

void CTextEditor::SetRules(bool linesAllowed, std::size_t mostCharacters)
{
    lines = linesAllowed;
    characters = mostCharacters;
}

std::string CTextEditor::Cleaned(std::string_view utf8) const
{
    const std::string clean = Platform::cleanText(utf8);
    std::string result;
    result.reserve(clean.size());
    for (std::size_t i = 0; i < clean.size(); ++i)
    {
        const std::string_view rest = std::string_view(clean).substr(i);
        // Windows line ends, U+0085, U+2028 and U+2029.
        const std::size_t end = rest.starts_with("\r\n") || rest.starts_with("\xC2\x85")                   ? 2
                                : rest.starts_with("\xE2\x80\xA8") || rest.starts_with("\xE2\x80\xA9")     ? 3
                                : rest[0] == '\n' || rest[0] == '\r' || rest[0] == '\v' || rest[0] == '\f' ? 1
                                                                                                           : 0;
        if (end > 0)
        {
            result += lines ? '\n' : ' ';
            i += end - 1;
        }
        else if (rest[0] == '\t')
            result += lines ? '\t' : ' ';
        else if (static_cast<unsigned char>(rest[0]) >= ' ' && rest[0] != 127)
            result += rest[0];
    }
    return result;
}

std::size_t CTextEditor::Snapped(std::size_t offset) const
{
    return Platform::characterStart(text, offset);
}

void CTextEditor::CutToRules(std::string &incoming, std::size_t replacedBytes, std::size_t replacedCharacters) const
{
    std::size_t most = mostBytes - std::min(mostBytes, text.size() - replacedBytes);
    if (characters > 0)
    {
        const std::size_t standing = Platform::characterCount(text) - replacedCharacters;
        const std::size_t left = characters - std::min(characters, standing);
        most = std::min(most, Platform::bytesOfCharacters(incoming, left));
    }
    if (incoming.size() > most)
        incoming.resize(Platform::characterStart(incoming, most));
}

void CTextEditor::SetText(std::string_view utf8)
{
    ForgetHistory();
    text.clear();
    std::string incoming = Cleaned(utf8);
    CutToRules(incoming, 0, 0);
    text = std::move(incoming);
    anchor = caret = text.size();
}

void CTextEditor::Select(std::size_t from, std::size_t to)
{
    anchor = Snapped(from);
    caret = Snapped(to);
    mayMerge = false;
}

bool CTextEditor::Insert(std::string_view utf8, change kind)
{
    std::string incoming = Cleaned(utf8);
    CutToRules(incoming, To() - From(), Platform::characterCount(Selected()));
    if (incoming.empty() && !HasSelection())
        return false;
    Apply({From(), std::string(Selected()), std::move(incoming), anchor, caret, kind});
    return true;
}

bool CTextEditor::Erase(std::size_t from, std::size_t to, change kind)
{
    from = Snapped(from);
    to = Snapped(to);
    if (from >= to)
        return false;
    Apply({from, text.substr(from, to - from), {}, anchor, caret, kind});
    return true;
}

void CTextEditor::Apply(step made)
{
    text.replace(made.at, made.removed.size(), made.inserted);
    anchor = caret = made.at + made.inserted.size();
    while (CanRedo())
    {
        kept -= steps.back().removed.size() + steps.back().inserted.size();
        steps.pop_back();
    }
    kept += made.removed.size() + made.inserted.size();
    const bool joins = mayMerge && Merge(made);
    mayMerge = made.kind != change::whole;
    if (!joins)
        steps.push_back(std::move(made));
    while (steps.size() > mostSteps || (kept > mostKept && steps.size() > 1))
    {
        kept -= steps.front().removed.size() + steps.front().inserted.size();
        steps.pop_front();
    }
    done = steps.size();
}

bool CTextEditor::Merge(const step &made)
{
    if (steps.empty() || steps.back().kind != made.kind)
        return false;
    step &last = steps.back();
    if (made.kind == change::typed)
    {
        const bool nextWord = !last.inserted.empty() && !made.inserted.empty() &&
                              sortOf(last.inserted.back()) == sort::space && sortOf(made.inserted[0]) != sort::space;
        if (nextWord || !made.removed.empty() || made.at != last.at + last.inserted.size())
            return false;
        last.inserted += made.inserted;
        return true;
    }
    if (!last.inserted.empty() || !made.inserted.empty())
        return false;
    if (made.at + made.removed.size() == last.at) // backwards
        last.removed.insert(0, made.removed);
    else if (made.at == last.at)
        last.removed += made.removed;
    else
        return false;
    last.at = made.at;
    return true;
}

bool CTextEditor::Undo()
{
    if (!CanUndo())
        return false;
    const step &last = steps[--done];
    text.replace(last.at, last.inserted.size(), last.removed);
    anchor = last.anchorBefore;
    caret = last.caretBefore;
    mayMerge = false;
    return true;
}

bool CTextEditor::Redo()
{
    if (!CanRedo())
        return false;
    const step &next = steps[done++];
    text.replace(next.at, next.removed.size(), next.inserted);
    anchor = caret = next.at + next.inserted.size();
    mayMerge = false;
    return true;
}

void CTextEditor::ForgetHistory()
{
    steps.clear();
    done = kept = 0;
    mayMerge = false;
}

CTextEditor::range CTextEditor::WordAt(std::size_t offset) const
{
    if (text.empty())
        return {0, 0};
    offset = Snapped(std::min(offset, text.size() - 1));
    const sort wanted = sortOf(text[offset]);
    const auto belongs = [&](std::size_t i) { return text[i] != '\n' && sortOf(text[i]) == wanted; };
    range word{offset, offset};
    while (word.from > 0 && belongs(word.from - 1))
        --word.from;
    while (word.to < text.size() && belongs(word.to))
        ++word.to;
    return word;
}

} // namespace Sarnik
