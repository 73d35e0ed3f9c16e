#pragma once

#include <cstddef>
#include <cstdint>
#include <optional>
#include <string>
#include <string_view>

namespace Sarnik
{

/// The rules that a listener hears of.
enum class CWyraRule
{
    Statement = 5, ///< a call with output variables, up to its closing parenthesis
    Variable = 12, ///< a variable definition
    Relational = 19,
    Greater = 20,
    GreaterEqual = 21,
    Less = 22,
    LessEqual = 23,
    Equality = 24,
    Unary = 31,
    Primary = 32,     ///< a number, or an expression in parentheses
    NameValue = 33,   ///< a name used as a value
    Parentheses = 34, ///< an expression in parentheses
    Call = 38,        ///< of a built-in or external function
    MinMax = 43,      ///< inside its Call
    Identifier = 45,
    Number = 46,
    Punctuation = 47, ///< ( ) { } , : ; = & '
    Definition = 48,  ///< the whole text
    Items = 49,       ///< a list of statements, variables and views
    View = 51,        ///< with or without a body
    ViewHead = 52,    ///< the properties in their parentheses
    ViewBody = 53     ///< the items in their braces
};

/// Hears of every rule that the parser has finished, inner ones first, so that a tool can colour or check a text.
class CWyraListener
{
public:
    /// ruleCode: a CWyraRule. The rule's text is from..to-1, without blanks around it.
    virtual void Report(int ruleCode, std::size_t from, std::size_t to) = 0;

protected:
    ~CWyraListener() = default;
};

/// A layout text as a row of tokens. Blanks (those of the C locale's isspace) may stand before any of them; there are
/// no comments. The text ends at its first zero byte.
class CWyraText
{
public:
    /// The text outlives this and what Take... answer.
    CWyraText(std::string_view layoutText, CWyraListener *ruleListener);

    /// Where the next token begins, its first character (0 at the end), and its name if it is one (else empty).
    std::size_t Start();
    char Next();
    std::string_view NameAhead();
    /// The first character of the token after the name ahead, and whether it is `=` but not `==`.
    char AfterNameAhead();
    bool AssignmentAhead();

    /// True, and behind it, if the token comes next.
    bool TakePunctuation(char c);
    bool TakeOperator(std::string_view characters);
    /// Fails where it does not come next; `what` says what it would have ended or begun.
    void Expect(char c, std::string_view what);
    /// Fails where no name comes next.
    std::string_view TakeName(std::string_view what);
    /// Decimal digits; fails above 2147483647. To be called at a digit.
    std::int32_t TakeNumber();
    /// The characters between the quotes; there is no escape. To be called at a quote.
    std::string_view TakeString();

    /// The end of the last token that was taken.
    std::size_t LastEnd() const { return lastEnd; }
    /// `to` is LastEnd.
    void Report(CWyraRule rule, std::size_t from);

    /// Throws CLayoutError. The text was not understood there, or (with an assertion) not accepted.
    [[noreturn]] void Fail(std::size_t at, std::string_view reason) const;
    [[noreturn]] void Fail(std::size_t at, std::string_view reason, std::string_view assertion) const;

    /// Remembers a name without a definition that gave an undefined value: should the text fail later, the error tells.
    void NoteUndefined(std::string_view name, std::size_t at);

private:
    std::size_t SkipBlanks(std::size_t from) const;

    std::string_view text;
    CWyraListener *listener;
    std::size_t position = 0, lastEnd = 0;
    std::string_view undefinedName;
    std::size_t undefinedAt = 0;
};

} // namespace Sarnik
