#pragma once

#include "framework/pixels/rect.h"

namespace Project
{

/// What the hub wants of the preview pane. The pane's picture is the whole image at the view's zoom; its pixels have
/// the coordinates that SetView is given. Main thread.
class PStageView
{
public:
    /// There is somebody to look.
    virtual bool Active() const = 0;
    /// What can be seen of the picture.
    virtual Sarnik::CRect Visible() const = 0;
    /// The part that the user looks at most: comes first. The visible part, if there is none.
    virtual Sarnik::CRect Focus() const = 0;

    /// The picture has changed there: draw it again some time (PImageHub::DrawPreview).
    virtual void Redraw(const Sarnik::CRect &area) = 0;
    /// PImageHub::Indicator() has changed.
    virtual void RedrawIndicator() = 0;
    /// How much of the shown work is done, 0..1.
    virtual void ShowProgress(double done) = 0;
    /// Whether PImageHub::Idle is to be called.
    virtual void WantIdle(bool wanted) = 0;

protected:
    ~PStageView() = default;
};

} // namespace Project
