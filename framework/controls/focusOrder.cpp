#include "framework/controls/focusOrder.h"

#include "framework/views/view.h"
#include "framework/views/window.h"

namespace Sarnik
{
namespace
{

bool stops(const CView &view)
{
    return view.IsTabStop() && view.CanFocus();
}

/// The first stop of a tree, and the first one after a view of it.
struct search
{
    const CView *after;
    CView *first = nullptr, *next = nullptr;
    bool passed = false;

    void Walk(const CContext &context)
    {
        for (const auto &child : context.Children())
        {
            passed = passed || child.get() == after;
            if (child.get() == after || child->HasOption(kView_NoTabNavigate))
                continue;
            if (stops(*child))
            {
                first = first == nullptr ? child.get() : first;
                next = next == nullptr && passed ? child.get() : next;
            }
            Walk(*child);
        }
    }
};

} // namespace

bool focusFirst(CContext &within)
{
    search all{nullptr};
    all.Walk(within);
    return all.first != nullptr && all.first->SetFocus();
}

bool focusNext(const CView &after)
{
    const CWindow *const window = after.Window();
    if (window == nullptr)
        return false;
    search all{&after};
    all.Walk(*window);
    CView *const found = all.next != nullptr ? all.next : all.first;
    return found != nullptr && found->SetFocus();
}

} // namespace Sarnik
