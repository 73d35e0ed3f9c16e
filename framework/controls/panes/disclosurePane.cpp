#include "framework/controls/panes/disclosurePane.h"

#include "framework/controls/focusOrder.h"
#include "framework/messages/messages.h"
#include "framework/views/window.h"

#include <algorithm>

namespace Sarnik
{

const CObjID CDisclosurePane::Changed("Sarnik/DisclosurePane/Changed");

std::int32_t CDisclosurePane::HeadingHeight() const
{
    if (Children().empty())
        return 0;
    const CRect &heading = Children().front()->Frame();
    return CRect::Clamped(std::int64_t{heading.bottom} + std::max(0, heading.top));
}

void CDisclosurePane::Disclose(bool show)
{
    if (show == disclosed)
        return;
    disclosed = show;
    const bool moves = !show && HoldsFocus() && !Children().empty() &&
                       !Window()->Focus()->IsWithin(*Children().front()) && Window()->Focus() != this;
    if (moves)
        focusFirst(*Children().front());
    CRect frame = Frame();
    if (!show)
        fullHeight = Bounds().bottom;
    for (std::size_t i = 1; i < Children().size(); ++i)
        Children()[i]->Show(show);
    frame.bottom = CRect::Clamped(std::int64_t{frame.top} + (show ? fullHeight : HeadingHeight()));
    SetFrame(frame);
    CMessageEvent message(Changed, Id());
    Dispatch(message);
}

} // namespace Sarnik
