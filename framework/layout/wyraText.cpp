#include "framework/layout/wyraText.h"

#include "framework/layout/layoutError.h"
#include "platform/utf8.h"

#include <algorithm>
#include <utility>

namespace Sarnik
{
namespace
{

/// As in the C locale, whatever locale the host has set.
bool isBlank(char c)
{
    return c == ' ' || (c >= '\t' && c <= '\r');
}

bool isDigit(char c)
{
    return c >= '0' && c <= '9';
}

bool isNameStart(char c)
{
    return (c >= 'a' && c <= 'z') || (c >= 'A' && c <= 'Z') || c == '_';
}

std::pair<std::size_t, std::size_t> lineAndColumn(std::string_view text, std::size_t at)
{
    const std::string_view before = text.substr(0, at), lastLine = before.substr(before.rfind('\n') + 1);
    const auto lineEnds = static_cast<std::size_t>(std::count(before.begin(), before.end(), '\n'));
    return {lineEnds + 1, Platform::characterCount(lastLine) + 1};
}

} // namespace

CWyraText::CWyraText(std::string_view layoutText, CWyraListener *ruleListener)
    : text(layoutText.substr(0, layoutText.find('\0'))), listener(ruleListener)
{
}

std::size_t CWyraText::SkipBlanks(std::size_t from) const
{
    while (from < text.size() && isBlank(text[from]))
        ++from;
    return from;
}

std::size_t CWyraText::Start()
{
    return position = SkipBlanks(position);
}

char CWyraText::Next()
{
    return Start() < text.size() ? text[position] : '\0';
}

std::string_view CWyraText::NameAhead()
{
    if (!isNameStart(Next()))
        return {};
    std::size_t end = position + 1;
    while (end < text.size() && (isNameStart(text[end]) || isDigit(text[end])))
        ++end;
    return text.substr(position, end - position);
}

char CWyraText::AfterNameAhead()
{
    const std::size_t length = NameAhead().size();
    const std::size_t after = SkipBlanks(position + length);
    return after < text.size() ? text[after] : '\0';
}

bool CWyraText::AssignmentAhead()
{
    const std::size_t length = NameAhead().size();
    const std::string_view after = text.substr(SkipBlanks(position + length));
    return length > 0 && after.starts_with('=') && !after.starts_with("==");
}

bool CWyraText::TakePunctuation(char c)
{
    if (Next() != c || position == text.size())
        return false;
    const std::size_t from = position;
    lastEnd = ++position;
    Report(CWyraRule::Punctuation, from);
    return true;
}

bool CWyraText::TakeOperator(std::string_view characters)
{
    if (!text.substr(Start()).starts_with(characters))
        return false;
    position += characters.size();
    lastEnd = position;
    return true;
}

void CWyraText::Expect(char c, std::string_view what)
{
    if (!TakePunctuation(c))
        Fail(Start(), std::string("expected '") + c + "' " + std::string(what));
}

std::string_view CWyraText::TakeName(std::string_view what)
{
    const std::string_view name = NameAhead();
    if (name.empty())
        Fail(Start(), "expected " + std::string(what));
    const std::size_t from = position;
    position += name.size();
    lastEnd = position;
    Report(CWyraRule::Identifier, from);
    return name;
}

std::int32_t CWyraText::TakeNumber()
{
    const std::size_t from = Start();
    std::int64_t number = 0;
    for (; position < text.size() && isDigit(text[position]); ++position)
    {
        number = number * 10 + (text[position] - '0');
        if (number > INT32_MAX)
            Fail(from, "a number above 2147483647");
    }
    lastEnd = position;
    Report(CWyraRule::Number, from);
    return static_cast<std::int32_t>(number);
}

std::string_view CWyraText::TakeString()
{
    const std::size_t open = Start();
    TakePunctuation('\'');
    const std::size_t begin = position;
    const std::size_t close = text.find('\'', begin);
    if (close == std::string_view::npos)
        Fail(open, "a string without its closing quote");
    // Not TakePunctuation, which would take blanks for the way to the quote.
    position = lastEnd = close + 1;
    Report(CWyraRule::Punctuation, close);
    return text.substr(begin, close - begin);
}

void CWyraText::Report(CWyraRule rule, std::size_t from)
{
    if (listener != nullptr)
        listener->Report(static_cast<int>(rule), from, lastEnd);
}

void CWyraText::Fail(std::size_t at, std::string_view reason) const
{
    Fail(at, reason, "*definition == 0");
}

void CWyraText::Fail(std::size_t at, std::string_view reason, std::string_view assertion) const
{
    std::string full(reason);
    if (!undefinedName.empty())
    {
        const auto [line, column] = lineAndColumn(text, undefinedAt);
        full += "; '" + std::string(undefinedName) + "' in line " + std::to_string(line) + ", column " +
                std::to_string(column) + " is not defined";
    }
    const auto [line, column] = lineAndColumn(text, at);
    throw CLayoutError(assertion, full, line, column);
}

void CWyraText::NoteUndefined(std::string_view name, std::size_t at)
{
    if (undefinedName.empty())
    {
        undefinedName = name.substr(0, 60);
        undefinedAt = at;
    }
}

} // namespace Sarnik
