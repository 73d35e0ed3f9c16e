#include "framework/views/context.h"

#include "framework/views/binding.h"
#include "framework/views/view.h"
#include "framework/views/window.h"

#include <algorithm>

namespace Sarnik
{

CContext::~CContext()
{
    DeleteChildren();
}

void CContext::DeleteChildren() noexcept
{
    // From the front backwards; a child that looks at its siblings on its way out finds those that still live.
    while (!children.empty())
    {
        const std::unique_ptr<CView> last = std::move(children.back());
        children.pop_back();
    }
}

CView &CContext::Add(std::unique_ptr<CView> view, std::size_t index)
{
    CView &added = *view;
    children.insert(children.begin() + static_cast<std::ptrdiff_t>(std::min(index, children.size())), std::move(view));
    added.container = this;
    added.SetParent(this);
    added.Invalidate();
    return added;
}

std::unique_ptr<CView> CContext::Remove(CView &view)
{
    const auto found =
        std::find_if(children.begin(), children.end(), [&](const auto &child) { return child.get() == &view; });
    if (found == children.end())
        return nullptr;
    view.Invalidate();
    if (CWindow *const window = Window())
        window->Forget(view);
    std::unique_ptr<CView> removed = std::move(*found);
    children.erase(found);
    removed->container = nullptr;
    removed->SetParent(nullptr);
    ChildLeft(*removed);
    return removed;
}

void CContext::BoundsChanged(const CRect &old)
{
    const CRect now = Bounds();
    if (now != old)
        for (const auto &child : children)
            child->SetFrame(boundFrame(child->Frame(), child->Binding(), old.right, old.bottom, now.right, now.bottom));
}

CView *CContext::FindView(CObjID id, bool recursive) const
{
    for (const auto &child : children)
        if (child->Id() == id)
            return child.get();
    if (recursive)
        for (const auto &child : children)
            if (CView *const found = child->FindView(id))
                return found;
    return nullptr;
}

} // namespace Sarnik
