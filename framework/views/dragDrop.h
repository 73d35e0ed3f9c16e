#pragma once

#include "framework/messages/objectId.h"
#include "framework/views/tracker.h"

#include <string>
#include <vector>

namespace Sarnik
{

/// What is being dragged: files of other programs, or an item of a view of ours.
struct CDragData
{
    std::vector<std::string> files;
    CObjID kind;             ///< of an item; none for files
    int item = -1;           ///< its index in the source
    CView *source = nullptr; ///< null for files
};

/// A view that also derives from this takes what is dragged over it. Every enter is followed by a leave or a drop, and
/// by nothing else but overs. Files of other programs enter and drop in one go: where they are before that nobody
/// tells us.
class CDropTarget
{
public:
    /// Whether it would take this at all.
    virtual bool DragEnter(const CDragData &data, CPoint at) = 0;
    /// Whether it would take it here.
    virtual bool DragOver(const CDragData &, CPoint) { return true; }
    virtual void DragLeave() {}
    virtual void Drop(const CDragData &data, CPoint at) = 0;

protected:
    ~CDropTarget() = default;
};

/// Leads what is dragged from target to target: the front-most view under a point, or the nearest of its ancestors,
/// that is a target, is enabled and takes it.
class CDragSession
{
public:
    CDragSession(CWindow &over, CDragData dragged);
    ~CDragSession();
    CDragSession(const CDragSession &) = delete;
    CDragSession &operator=(const CDragSession &) = delete;

    /// Whether a drop here would be taken.
    bool Over(CPoint inWindow);
    void Leave();
    /// Over, and then a drop where it is taken, or a leave. Whether it was dropped.
    bool Drop(CPoint inWindow);
    const CDragData &Data() const { return data; }
    /// A view is about to go.
    void Forget(const CView &view) noexcept;
    void WindowGone() noexcept { window = nullptr; }

private:
    CView *Offered(CPoint inWindow);

    CWindow *window;
    CDragData data;
    CView *target = nullptr; ///< entered
    CView *asked = nullptr;  ///< the front-most view when targets were last looked for
};

/// The drag of an item from its source: a tracker that begins to drag once the pointer has moved a few units.
class CDragTracker : public CTracker
{
public:
    static constexpr double threshold = 4;

    CDragTracker(CView &sourceView, CObjID kind, int item);

    bool Dragged() const { return dragging; }
    bool Dropped() const { return dropped; }

protected:
    void Track() override;
    void End(bool wasAborted) override;

private:
    CDragSession session;
    bool dragging = false, dropped = false;
};

} // namespace Sarnik
