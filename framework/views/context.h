#pragma once

#include "framework/messages/messenger.h"
#include "framework/messages/objectId.h"
#include "framework/pixels/rect.h"

#include <cstddef>
#include <memory>
#include <utility>
#include <vector>

namespace Sarnik
{

class CView;
class CWindow;

/// Holds views: a window, or a view with others in it. Later children lie in front of earlier ones. Owns them.
class CContext : public virtual CMessenger
{
public:
    ~CContext() override;

    const std::vector<std::unique_ptr<CView>> &Children() const { return children; }
    /// Puts a view in front of the first `index` children, in front of all by default.
    CView &Add(std::unique_ptr<CView> view, std::size_t index = SIZE_MAX);
    template <class T, class... Arguments> T &Make(Arguments &&...arguments)
    {
        auto made = std::make_unique<T>(std::forward<Arguments>(arguments)...);
        T &view = *made;
        Add(std::move(made));
        return view;
    }
    /// Hands a child out; focus and pointer leave it first. Null where it is no child.
    std::unique_ptr<CView> Remove(CView &view);

    /// The first view of this id among the children, or among all descendants; null for none. Views have no other
    /// names.
    CView *FindView(CObjID id, bool recursive = true) const;
    /// The same, of a class; null where the view is of another one.
    template <class T> T *Find(CObjID id) const { return dynamic_cast<T *>(FindView(id)); }

    /// The window that this is in or is; null outside of any.
    virtual CWindow *Window() const { return nullptr; }
    virtual CRect Bounds() const = 0;
    /// Null for a window.
    virtual CView *AsView() { return nullptr; }

protected:
    CContext() = default;
    void DeleteChildren() noexcept;
    /// A child was handed out. Not told of those that go with this.
    virtual void ChildLeft(const CView &) {}
    /// The bounds have changed from these: children follow by their bindings.
    void BoundsChanged(const CRect &old);

private:
    std::vector<std::unique_ptr<CView>> children;
};

} // namespace Sarnik
