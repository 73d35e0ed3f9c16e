#pragma once

#include "framework/icons/iconNames.h"
#include "framework/views/view.h"

#include <cstdint>
#include <string>
#include <utility>

namespace Sarnik
{

class CToolSet;

/// What the pointer does on a view, as long as the user has chosen this for it. The view passes on what happens to it
/// through Hover, Down and CursorAt; a tool answers in its handlers. For one event another tool may stand in, as with a
/// modifier key held. Interface thread.
class CTool
{
public:
    explicit CTool(CObjID id, std::string toolName = {}) : toolId(id), name(std::move(toolName)) {}
    CTool(const CTool &) = delete;
    CTool &operator=(const CTool &) = delete;
    virtual ~CTool() = default;

    CObjID GetId() const { return toolId; }
    void SetId(CObjID id) { toolId = id; }
    const std::string &GetName() const { return name; }
    /// Null outside of any.
    CToolSet *ToolSet() const { return toolSet; }
    void Attach(CToolSet &set) { toolSet = &set; }
    /// The set is going.
    virtual void Detach(CToolSet &set);

    // From the view; points are its own. Each asks ResolveTool first.
    /// A press, the second of a double click and so on included. Whether it was used.
    bool Down(CView &view, const CMouseEvent &event);
    /// The pointer's shape with the modifiers that are held now.
    Platform::cursor CursorAt(CView &view, CPoint at);
    /// A move while no button is down.
    virtual void MouseHover(CView &, CPoint) {}

    /// Which tool serves an event; null for this one. The copy may be changed, so that the other tool does not pass it
    /// on in its turn: at most a few are asked.
    virtual CTool *ResolveTool(CMouseEvent &) { return nullptr; }
    /// The tool's button was clicked while it was current. Whether that was used.
    virtual bool ButtonClicked(int /*clickCount*/) { return false; }
    /// It became current, or is it no longer.
    virtual void Activated() {}
    virtual void Deactivated() {}
    /// On top of the view's own drawing.
    virtual void DrawOverlay(CView &, CPort &) {}
    /// The running gesture must stop.
    virtual void Cancel() {}
    /// As CView::GetTip.
    virtual bool GetTip(CView &, CPoint, CTip &) { return false; }

protected:
    virtual bool MouseDown(CView &, const CMouseEvent &) { return false; }
    /// The second press of a double click and so on, with the event's count; by default it is a press like the first.
    virtual bool MouseClicks(CView &view, const CMouseEvent &event) { return MouseDown(view, event); }
    /// The number of the cursor (ECursor) inside the view, and outside of it while a tracker has the pointer.
    virtual std::uint32_t UpdateCursor(CView &, const CMouseEvent &) { return kCursor_Arrow; }
    virtual std::uint32_t UpdateCursorOutside(CView &, const CMouseEvent &) { return kCursor_Outside; }

private:
    CTool &Resolved(CMouseEvent &event);

    CToolSet *toolSet = nullptr;
    CObjID toolId;
    std::string name;
};

} // namespace Sarnik
