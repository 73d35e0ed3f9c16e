#pragma once

namespace Sarnik
{

class CContext;
class CView;

/// Gives the focus to the first view within that the tab key would stop at. Whether there is one.
bool focusFirst(CContext &within);
/// The same of what follows a view in its window, in the order of the tab key, around the end; the view itself and
/// what lies in it do not count.
bool focusNext(const CView &after);

} // namespace Sarnik
