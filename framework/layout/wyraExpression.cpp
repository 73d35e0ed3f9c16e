#include "framework/layout/wyraExpression.h"

#include <algorithm>

namespace Sarnik
{
namespace
{

std::int32_t wrapped(std::int64_t value)
{
    return static_cast<std::int32_t>(static_cast<std::uint32_t>(value));
}

bool isTrue(std::int32_t value)
{
    return value != 0 && value != undefinedInteger;
}

bool anyUndefined(std::int32_t a, std::int32_t b)
{
    return a == undefinedInteger || b == undefinedInteger;
}

/// Gives the depth back however its block is left.
class oneDeeper
{
public:
    oneDeeper(int &expressionDepth, CWyraText &text) : depth(expressionDepth)
    {
        if (depth == largestExpressionDepth)
            text.Fail(text.Start(), "an expression nested too deeply");
        ++depth;
    }
    ~oneDeeper() { --depth; }
    oneDeeper(const oneDeeper &) = delete;
    oneDeeper &operator=(const oneDeeper &) = delete;

private:
    int &depth;
};

} // namespace

std::int32_t CWyraExpression::Evaluate(const CExpressionScope &scope)
{
    const oneDeeper deeper(depth, text);
    return scope.LogicAllowed() ? Or(scope) : Additive(scope);
}

std::int32_t CWyraExpression::Or(const CExpressionScope &scope)
{
    std::int32_t value = And(scope);
    while (text.TakeOperator("||"))
    {
        const std::int32_t other = And(scope);
        value = isTrue(value) || isTrue(other);
    }
    return value;
}

std::int32_t CWyraExpression::And(const CExpressionScope &scope)
{
    std::int32_t value = Equality(scope);
    while (text.TakeOperator("&&"))
    {
        const std::int32_t other = Equality(scope);
        value = isTrue(value) && isTrue(other);
    }
    return value;
}

std::int32_t CWyraExpression::Equality(const CExpressionScope &scope)
{
    const std::size_t from = text.Start();
    std::int32_t value = Relational(scope);
    const bool equal = text.TakeOperator("==");
    if (equal || text.TakeOperator("!="))
    {
        const std::int32_t other = Relational(scope);
        value = !anyUndefined(value, other) && (value == other) == equal;
    }
    text.Report(CWyraRule::Equality, from);
    return value;
}

std::int32_t CWyraExpression::Relational(const CExpressionScope &scope)
{
    struct comparison
    {
        std::string_view characters;
        CWyraRule rule;
        bool less, equal, greater;
    };
    // The longer of two that begin alike comes first.
    static constexpr comparison comparisons[] = {{"<=", CWyraRule::LessEqual, true, true, false},
                                                 {"<", CWyraRule::Less, true, false, false},
                                                 {">=", CWyraRule::GreaterEqual, false, true, true},
                                                 {">", CWyraRule::Greater, false, false, true}};
    const std::size_t from = text.Start();
    std::int32_t value = Additive(scope);
    const std::size_t sign = text.Start();
    for (const comparison &c : comparisons)
        if (text.TakeOperator(c.characters))
        {
            text.Report(c.rule, sign);
            const std::int32_t other = Additive(scope);
            const bool holds = value < other ? c.less : value == other ? c.equal : c.greater;
            value = !anyUndefined(value, other) && holds;
            break;
        }
    text.Report(CWyraRule::Relational, from);
    return value;
}

std::int32_t CWyraExpression::Additive(const CExpressionScope &scope)
{
    std::int32_t value = Multiplicative(scope);
    for (;;)
    {
        const bool plus = text.TakeOperator("+");
        if (!plus && !text.TakeOperator("-"))
            return value;
        const std::int64_t other = Multiplicative(scope);
        value = anyUndefined(value, static_cast<std::int32_t>(other)) ? undefinedInteger
                                                                      : wrapped(plus ? value + other : value - other);
    }
}

std::int32_t CWyraExpression::Multiplicative(const CExpressionScope &scope)
{
    std::int32_t value = Unary(scope);
    for (;;)
    {
        const char sign = text.Next();
        if (sign != '*' && sign != '/' && sign != '%')
            return value;
        text.TakeOperator({&sign, 1});
        const std::int32_t other = Unary(scope);
        if (anyUndefined(value, other) || (sign != '*' && other == 0))
            value = undefinedInteger;
        else if (sign == '*')
            value = wrapped(std::int64_t{value} * other);
        else
            value = sign == '/' ? value / other : value % other; // the one quotient that overflows is of undefined
    }
}

std::int32_t CWyraExpression::Unary(const CExpressionScope &scope)
{
    const oneDeeper deeper(depth, text);
    const std::size_t from = text.Start();
    std::int32_t value = 0;
    if (text.TakeOperator("+"))
        value = Unary(scope);
    else if (text.TakeOperator("-"))
        value = wrapped(-std::int64_t{Unary(scope)}); // undefined stays what it is
    else if (text.TakeOperator("!"))
        value = Unary(scope) == 0;
    else
        value = Primary(scope);
    text.Report(CWyraRule::Unary, from);
    return value;
}

std::int32_t CWyraExpression::Primary(const CExpressionScope &scope)
{
    const std::size_t from = text.Start();
    const char next = text.Next();
    if (!text.NameAhead().empty())
        return text.AfterNameAhead() == '(' ? Call(scope) : Name(scope);
    std::int32_t value = 0;
    if (next >= '0' && next <= '9')
        value = text.TakeNumber();
    else if (text.TakePunctuation('('))
    {
        value = Evaluate(scope);
        text.Expect(')', "after an expression");
        text.Report(CWyraRule::Parentheses, from);
    }
    else
        text.Fail(from, "expected a number, a name or '('");
    text.Report(CWyraRule::Primary, from);
    return value;
}

std::int32_t CWyraExpression::Name(const CExpressionScope &scope)
{
    const std::size_t from = text.Start();
    const std::string_view name = text.TakeName("a name");
    text.Report(CWyraRule::NameValue, from);
    const CExpressionValue *const found = scope.Find(name);
    if (found == nullptr)
        text.NoteUndefined(name, from);
    return found != nullptr ? found->integer : undefinedInteger;
}

std::int32_t CWyraExpression::Call(const CExpressionScope &scope)
{
    const std::size_t from = text.Start();
    const std::string_view name = text.TakeName("a function");
    text.Expect('(', "before arguments");
    std::int32_t value = 0;
    if (name == "min" || name == "max")
    {
        value = MinMax(scope, name == "max");
        text.Report(CWyraRule::MinMax, from);
    }
    else if (name == "dim")
        value = Dim(scope);
    else if (name == "in" && scope.LogicAllowed())
        value = In(scope);
    else
        value = External(scope, name, from);
    text.Report(CWyraRule::Call, from);
    return value;
}

std::int32_t CWyraExpression::MinMax(const CExpressionScope &scope, bool largest)
{
    std::int32_t value = Evaluate(scope);
    text.Expect(',', "between arguments");
    do
    {
        const std::int32_t other = Evaluate(scope);
        if (anyUndefined(value, other))
            value = undefinedInteger;
        else
            value = largest ? std::max(value, other) : std::min(value, other);
    } while (text.TakePunctuation(','));
    text.Expect(')', "after arguments");
    return value;
}

std::int32_t CWyraExpression::Dim(const CExpressionScope &scope)
{
    const std::int32_t a = Evaluate(scope);
    text.Expect(',', "between arguments");
    const std::int32_t b = Evaluate(scope);
    text.Expect(')', "after arguments");
    return !anyUndefined(a, b) && a > b ? wrapped(std::int64_t{a} - b) : 0;
}

std::int32_t CWyraExpression::In(const CExpressionScope &scope)
{
    const std::int32_t wanted = Evaluate(scope);
    std::uint32_t set = 0;
    while (text.TakePunctuation(','))
        if (const std::int32_t bit = Evaluate(scope); bit >= 0 && bit < 32)
            set |= 1u << bit;
    text.Expect(')', "after arguments");
    return wanted >= 0 && wanted < 32 ? static_cast<std::int32_t>(set >> wanted & 1u) : 0;
}

std::int32_t CWyraExpression::External(const CExpressionScope &scope, std::string_view name, std::size_t from)
{
    const CWyraPropertyList arguments = Properties(scope);
    if (generator == nullptr)
        text.Fail(from, "'" + std::string(name.substr(0, 60)) + "' is no function of the language", "fGenerator");
    external = {from, text.LastEnd(), generator->External(name, arguments)};
    return external.value.integer;
}

CExpressionValue CWyraExpression::Value(const CExpressionScope &scope, char closing)
{
    if (text.Next() == '\'')
        return CExpressionValue::OfText(scope.Pool().Copy(text.TakeString()));

    const std::size_t from = text.Start();
    const std::string_view name = text.NameAhead();
    const char after = text.AfterNameAhead();
    if (!name.empty() && (after == closing || (closing == ')' && after == ',')))
    {
        text.TakeName("a name");
        text.Report(CWyraRule::NameValue, from);
        const CExpressionValue *const found = scope.Find(name);
        if (found == nullptr)
            text.Fail(from, "no variable is named '" + std::string(name.substr(0, 60)) + "'", "variable != NULL");
        return *found;
    }
    CExpressionValue value;
    value.integer = Evaluate(scope);
    if (external.from == from && external.end == text.LastEnd() && external.value.text)
        value.text = scope.Pool().Copy(*external.value.text);
    return value;
}

CWyraPropertyList CWyraExpression::Properties(const CExpressionScope &scope)
{
    CWyraPropertyList list;
    if (text.TakePunctuation(')'))
        return list;
    const oneDeeper deeper(depth, text);
    do
    {
        const std::string_view name = text.TakeName("a property");
        text.Expect(':', "after a property's name");
        list.Add({scope.Pool().Copy(name), Value(scope, ')')});
    } while (text.TakePunctuation(','));
    text.Expect(')', "or ',' after a property");
    return list;
}

} // namespace Sarnik
