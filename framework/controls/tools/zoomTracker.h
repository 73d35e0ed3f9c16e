#pragma once

#include "framework/views/tracker.h"

namespace Sarnik
{

/// Draws a rectangle to zoom to. What is smaller than `threshold` in both directions is a click. The view draws the
/// rectangle, by Draw, on top of all else as long as the tracker runs; it is marked for redraw with each change.
///
///     CZoomTracker tracker(view);
///     if (tracker.Run(event))
///         tracker.IsMarquee() ? zoomTo(tracker.Marquee()) : zoomAt(event.at);
class CZoomTracker : public CTracker
{
public:
    static constexpr double threshold = 5; ///< view units

    explicit CZoomTracker(CView &inView) : CTracker(inView, confine) {}

    /// In the view's coordinates.
    Platform::rectangle Marquee() const;
    bool IsMarquee() const;
    void Draw(CPort &port) const;

protected:
    void Track() override;
    void End(bool wasAborted) override;

private:
    void Mark();

    CRect marked; ///< what was last drawn or is to be
};

} // namespace Sarnik
