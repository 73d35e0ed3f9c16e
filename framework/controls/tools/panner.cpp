#include "framework/controls/tools/panner.h"

#include "framework/controls/scrolling/scroller.h"

namespace Sarnik
{

bool CPanner::Begin()
{
    const CScroller *const scroller = CScroller::Around(*View());
    if (scroller == nullptr)
        return false;
    const CPoint at = scroller->Position(), from = CurrentInWindow();
    position = {at.x + from.x, at.y + from.y};
    return true;
}

void CPanner::Track()
{
    // The content moves under the pointer, so only the window's coordinates stay.
    const CPoint to = CurrentInWindow();
    if (CScroller *const scroller = View() == nullptr ? nullptr : CScroller::Around(*View()))
        scroller->UserScrollTo({position.x - to.x, position.y - to.y});
}

} // namespace Sarnik
