#pragma once

#include "framework/layout/generator.h"
#include "framework/layout/stringPool.h"
#include "framework/layout/viewScope.h"
#include "framework/layout/wyraText.h"

#include <memory>
#include <string_view>

namespace Sarnik
{

/// What a layout text may be at most. The largest dialogs are a tenth of it; whatever lies within costs less than a
/// second and some ten megabytes.
struct CWyraLimits
{
    static constexpr std::size_t bytes = 256 * 1024;
    static constexpr int views = 4000, depth = 64, variables = 4000;
};

/// A parsed layout: the scope of the text with its one view, and all its strings.
class CWyraDefinition
{
public:
    CWyraDefinition() : file(pool, Constants()) {}

    /// The scope of the constants, outermost of all; the same for every layout. Any thread.
    static const CExpressionScope &Constants();
    CExpressViewScope &File() { return file; }
    /// The outermost view.
    CExpressViewScope &Root() { return *file.children.front(); }
    const CExpressViewScope &Root() const { return *file.children.front(); }

private:
    CStringPool pool;
    CExpressViewScope file;
};

/// Reads a layout text and evaluates all its expressions. One pass, without going back: the time is that of the text's
/// length. Throws CLayoutError.
///
/// generator: null where external calls are not possible. listener may be null.
std::unique_ptr<CWyraDefinition> ParseLayout(std::string_view text, CGenerator *generator = nullptr,
                                             CWyraListener *listener = nullptr);

} // namespace Sarnik
