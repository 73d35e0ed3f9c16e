#pragma once

#include "framework/layout/expressionScope.h"
#include "framework/layout/generator.h"
#include "framework/layout/wyraText.h"

#include <cstddef>

namespace Sarnik
{

/// The largest nesting of parentheses, signs and calls in an expression.
constexpr int largestExpressionDepth = 100;

/// Reads values and evaluates them on the way, in 32-bit integers that wrap around.
///
/// Undefined operands: a comparison with one is 0, and it counts as false in `&&` and `||`; sums, products, `min` and
/// `max` with one are undefined, as is a division by zero; `dim` with one is 0; `!` of one is 0.
class CWyraExpression
{
public:
    /// generator: null where external calls are not possible. All outlive this.
    CWyraExpression(CWyraText &layoutText, CGenerator *externalCalls) : text(layoutText), generator(externalCalls) {}

    /// An expression in a scope; comparisons and logic only where the scope allows them.
    std::int32_t Evaluate(const CExpressionScope &scope);

    /// The value of a variable, of a property, or of an argument. `closing` is what may follow it beside, for
    /// properties, a comma: a lone name before either of them must be defined, and hands on its text too. Texts live in
    /// the layout's text or in the scope's pool.
    CExpressionValue Value(const CExpressionScope &scope, char closing);

    /// `name: value, ...` up to and with the closing parenthesis. Names are copied into the scope's pool.
    CWyraPropertyList Properties(const CExpressionScope &scope);

private:
    std::int32_t Or(const CExpressionScope &scope);
    std::int32_t And(const CExpressionScope &scope);
    std::int32_t Equality(const CExpressionScope &scope);
    std::int32_t Relational(const CExpressionScope &scope);
    std::int32_t Additive(const CExpressionScope &scope);
    std::int32_t Multiplicative(const CExpressionScope &scope);
    std::int32_t Unary(const CExpressionScope &scope);
    std::int32_t Primary(const CExpressionScope &scope);
    std::int32_t Name(const CExpressionScope &scope);
    std::int32_t Call(const CExpressionScope &scope);
    std::int32_t MinMax(const CExpressionScope &scope, bool largest);
    std::int32_t Dim(const CExpressionScope &scope);
    std::int32_t In(const CExpressionScope &scope);
    std::int32_t External(const CExpressionScope &scope, std::string_view name, std::size_t from);

    /// The last call that the generator answered, and where it stands: a value that is nothing but the call keeps the
    /// text of the answer.
    struct answer
    {
        std::size_t from = CExpressionScope::anywhere, end = 0;
        CExpressionValue value;
    };

    CWyraText &text;
    CGenerator *generator;
    answer external;
    int depth = 0;
};

} // namespace Sarnik
