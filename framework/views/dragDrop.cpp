#include "framework/views/dragDrop.h"

#include "framework/views/view.h"
#include "framework/views/window.h"

#include <cmath>

namespace Sarnik
{
namespace
{

CDropTarget &asTarget(CView *view)
{
    return dynamic_cast<CDropTarget &>(*view);
}

} // namespace

CDragSession::CDragSession(CWindow &over, CDragData dragged) : window(&over), data(std::move(dragged))
{
    window->SetDrag(this);
}

CDragSession::~CDragSession()
{
    Leave();
    if (window != nullptr)
        window->SetDrag(nullptr);
}

void CDragSession::Forget(const CView &view) noexcept
{
    for (CView **const kept : {&target, &asked, &data.source})
        if (*kept != nullptr && (*kept)->IsWithin(view))
            *kept = nullptr;
}

/// The target at a point, which has been entered if it is another one than before.
CView *CDragSession::Offered(CPoint inWindow)
{
    CView *const front = window == nullptr ? nullptr : window->ViewAt(inWindow);
    if (front == asked && front != nullptr)
        return target;
    asked = front;
    for (CView *view = front; view != nullptr; view = view->ParentView())
    {
        auto *const candidate = dynamic_cast<CDropTarget *>(view);
        if (candidate == nullptr || !view->IsEnabled())
            continue;
        if (view == target || candidate->DragEnter(data, view->FromWindow(inWindow)))
            return view;
    }
    return nullptr;
}

bool CDragSession::Over(CPoint inWindow)
{
    CView *const at = Offered(inWindow);
    if (at != target)
    {
        if (target != nullptr)
            asTarget(target).DragLeave();
        target = at;
    }
    return target != nullptr && asTarget(target).DragOver(data, target->FromWindow(inWindow));
}

void CDragSession::Leave()
{
    asked = nullptr;
    if (CView *const left = std::exchange(target, nullptr))
        asTarget(left).DragLeave();
}

bool CDragSession::Drop(CPoint inWindow)
{
    if (!Over(inWindow))
    {
        Leave();
        return false;
    }
    CView *const at = std::exchange(target, nullptr);
    asked = nullptr;
    asTarget(at).Drop(data, at->FromWindow(inWindow));
    return true;
}

CDragTracker::CDragTracker(CView &sourceView, CObjID kind, int item)
    : CTracker(sourceView), session(*sourceView.Window(), {{}, kind, item, &sourceView})
{
}

void CDragTracker::Track()
{
    const CPoint from = StartPoint(), to = CurrentPoint();
    dragging = dragging || std::abs(to.x - from.x) >= threshold || std::abs(to.y - from.y) >= threshold;
    if (dragging)
        session.Over(CurrentInWindow());
}

void CDragTracker::End(bool wasAborted)
{
    if (dragging && !wasAborted)
        dropped = session.Drop(CurrentInWindow());
    else
        session.Leave();
}

} // namespace Sarnik
