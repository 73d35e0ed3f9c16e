#pragma once

#include "framework/layout/expressionScope.h"
#include "framework/layout/layoutFrame.h"
#include "framework/layout/wyraProperty.h"

#include <cstddef>
#include <memory>
#include <string_view>
#include <vector>

namespace Sarnik
{

/// One view of a layout before it is built: its class, its head, the variables of its body, and the views in it. The
/// variables hold for what follows them in the body and lies inside it, not for the view itself.
class CExpressViewScope final : public CExpressionScope
{
public:
    /// The outermost scope of a text, which is no view.
    CExpressViewScope(CStringPool &stringPool, const CExpressionScope &constants)
        : CExpressionScope(stringPool, &constants)
    {
    }
    /// A view that stands at a position of the text, in another's body.
    CExpressViewScope(const CExpressViewScope &enclosing, std::string_view viewClassName, std::size_t at)
        : CExpressionScope(enclosing.Pool(), &enclosing), className(viewClassName), position(at)
    {
    }

    bool LogicAllowed() const override { return true; }

    /// The head's properties, before and behind the class's defaults and the variables that the view sees. Of views
    /// only; the answer lives no longer than the scope.
    CWyraVariablePropertyList Properties() const { return {head, builder, *Parent(), position}; }

    std::string_view className;
    CWyraPropertyList head;
    const CViewBuilderBase *builder = nullptr; ///< null until the generator has looked, and for unknown classes
    CLayoutFrame frame;
    std::vector<std::unique_ptr<CExpressViewScope>> children;

private:
    std::size_t position = 0;
};

} // namespace Sarnik
