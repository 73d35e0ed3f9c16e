#include "framework/layout/wyraParser.h"

#include "framework/layout/layoutConstants.h"
#include "framework/layout/wyraExpression.h"

#include <algorithm>
#include <string>
#include <vector>

namespace Sarnik
{
namespace
{

class parser
{
public:
    parser(std::string_view layoutText, CGenerator *generator, CWyraListener *listener)
        : text(layoutText, listener), values(text, generator)
    {
    }

    void File(CExpressViewScope &scope);

private:
    void Items(CExpressViewScope &scope);
    void Variable(CExpressViewScope &scope);
    void Step(CExpressViewScope &scope);
    void AlignCenters(CExpressViewScope &scope);
    void View(CExpressViewScope &enclosing);

    std::vector<std::string_view> Outputs();
    void EndStatement(std::size_t from);
    void Define(CExpressViewScope &scope, std::string_view name, const CExpressionValue &value, std::size_t at);

    CWyraText text;
    CWyraExpression values;
    int viewCount = 0, depth = 0, variableCount = 0;
};

void parser::File(CExpressViewScope &scope)
{
    const std::size_t from = text.Start();
    Items(scope);
    if (text.Next() != '\0')
        text.Fail(text.Start(), "expected a view, a variable, a statement or the end of the text");
    if (scope.children.size() != 1)
        text.Fail(text.Start(),
                  "a layout has one outermost view, this one has " + std::to_string(scope.children.size()),
                  "viewProxyList->size() == 1");
    text.Report(CWyraRule::Definition, from);
}

void parser::Items(CExpressViewScope &scope)
{
    const std::size_t from = text.Start();
    for (;;)
    {
        const std::string_view name = text.NameAhead();
        if (name.empty())
            break;
        if (text.AssignmentAhead())
            Variable(scope);
        else if (name == "step")
            Step(scope);
        else if (name == "align_centers")
            AlignCenters(scope);
        else
            View(scope);
    }
    if (text.LastEnd() > from) // a list without items has no text
        text.Report(CWyraRule::Items, from);
}

void parser::Define(CExpressViewScope &scope, std::string_view name, const CExpressionValue &value, std::size_t at)
{
    if (++variableCount > CWyraLimits::variables)
        text.Fail(at, "too many variables");
    scope.Define(name, value, at);
}

void parser::Variable(CExpressViewScope &scope)
{
    const std::size_t from = text.Start();
    const std::string_view name = text.TakeName("a variable");
    text.Expect('=', "after a variable's name");
    const CExpressionValue value = values.Value(scope, ';');
    text.Expect(';', "after a variable's value");
    Define(scope, name, value, from);
    text.Report(CWyraRule::Variable, from);
}

/// The rest of a statement from its first `&` to the closing parenthesis.
std::vector<std::string_view> parser::Outputs()
{
    std::vector<std::string_view> names;
    do
    {
        text.Expect('&', "before an output variable");
        names.push_back(text.TakeName("an output variable"));
    } while (text.TakePunctuation(','));
    text.Expect(')', "after the output variables");
    return names;
}

void parser::EndStatement(std::size_t from)
{
    text.Report(CWyraRule::Statement, from);
    text.Expect(';', "after a statement");
}

void parser::Step(CExpressViewScope &scope)
{
    const std::size_t from = text.Start();
    text.TakeName("a statement");
    text.Expect('(', "after 'step'");
    std::int32_t value = values.Evaluate(scope);
    text.Expect(',', "after the first value");
    const std::int32_t increment = values.Evaluate(scope);
    text.Expect(',', "after the increment");
    const bool defined = value != undefinedInteger && increment != undefinedInteger;
    for (const std::string_view name : Outputs())
    {
        Define(scope, name, {defined ? value : undefinedInteger, {}}, from);
        value = static_cast<std::int32_t>(static_cast<std::uint32_t>(value) + static_cast<std::uint32_t>(increment));
    }
    EndStatement(from);
}

void parser::AlignCenters(CExpressViewScope &scope)
{
    const std::size_t from = text.Start();
    text.TakeName("a statement");
    text.Expect('(', "after 'align_centers'");
    std::vector<std::int32_t> sizes;
    do
    {
        sizes.push_back(values.Evaluate(scope));
        text.Expect(',', "between values");
    } while (sizes.size() < 2 || text.Next() != '&');

    const std::size_t outputsAt = text.Start();
    const std::vector<std::string_view> names = Outputs();
    if (names.size() > sizes.size())
        text.Fail(outputsAt, "more output variables than values", "size() > 0");
    // Undefined is the smallest of integers: it is the largest only where all are.
    const std::int64_t largest = *std::max_element(sizes.begin(), sizes.end());
    for (std::size_t i = 0; i < names.size(); ++i)
    {
        CExpressionValue offset;
        if (sizes[i] != undefinedInteger)
            offset.integer = static_cast<std::int32_t>((largest - sizes[i]) / 2);
        Define(scope, names[i], offset, from);
    }
    EndStatement(from);
}

void parser::View(CExpressViewScope &enclosing)
{
    const std::size_t from = text.Start();
    const std::string_view name = text.TakeName("a class");
    if (++viewCount > CWyraLimits::views)
        text.Fail(from, "too many views");
    if (depth == CWyraLimits::depth)
        text.Fail(from, "views nested too deeply");

    auto view = std::make_unique<CExpressViewScope>(enclosing, enclosing.Pool().Copy(name), from);
    const std::size_t headFrom = text.Start();
    text.Expect('(', "or '=' after a name");
    view->head = values.Properties(enclosing);
    text.Report(CWyraRule::ViewHead, headFrom);

    const std::size_t bodyFrom = text.Start();
    if (text.TakePunctuation('{'))
    {
        ++depth;
        Items(*view);
        --depth;
        text.Expect('}', "or an item in a view's body");
        text.Report(CWyraRule::ViewBody, bodyFrom);
    }
    else
        text.Expect(';', "or '{' after a view's head");
    text.Report(CWyraRule::View, from);
    enclosing.children.push_back(std::move(view));
}

} // namespace

const CExpressionScope &CWyraDefinition::Constants()
{
    struct filledScope
    {
        filledScope()
        {
            for (const CLayoutConstant &constant : LayoutConstants())
                scope.Define(constant.name, {constant.value, {}});
        }
        CStringPool pool;
        CExpressionScope scope{pool};
    };
    static const filledScope constants;
    return constants.scope;
}

std::unique_ptr<CWyraDefinition> ParseLayout(std::string_view text, CGenerator *generator, CWyraListener *listener)
{
    if (text.size() > CWyraLimits::bytes)
        CWyraText(text, nullptr).Fail(CWyraLimits::bytes, "a text larger than any layout");
    auto definition = std::make_unique<CWyraDefinition>();
    parser(text, generator, listener).File(definition->File());
    return definition;
}

} // namespace Sarnik
