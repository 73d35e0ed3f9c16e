#pragma once

#include "framework/messages/objectId.h"

namespace Project
{

class PKernelCollection;
class PTaskStack;

/// What tasks ask of the dialog, to show what they have changed. As it stands nobody looks. An index is a trace's in
/// the collection, which has changed already. Where a call throws, the task takes its change back.
class PTaskView
{
public:
    virtual ~PTaskView() = default;

    /// The tool's running gesture stops.
    virtual void CancelTool() {}

    // The list of thumbnails, one for each trace and in the same order.

    /// A new one for the trace of this index, drawn.
    virtual void InsertThumbnail(int /*index*/) {}
    virtual void RemoveThumbnail(int /*index*/) {}
    virtual void MoveThumbnail(int /*from*/, int /*to*/) {}
    /// All anew from the collection, and selected as there.
    virtual void RebuildThumbnails() {}
    virtual void RedrawThumbnail(int /*index*/) {}
    /// Selected as if the user had clicked it. In the collection it is selected already.
    virtual void SelectThumbnail(int /*index*/) {}
    /// All estimations have been stopped.
    virtual void EstimationsStopped() {}

    /// The controls show the model's values.
    virtual void SyncControls() {}
    virtual void InvalidateDialog() {}
    virtual void InvalidatePreview() {}
    /// The several previews, while they are shown.
    virtual void RefreshMultiPreview() {}
    /// The keyboard goes to a control; to the preview for 0 and for what cannot take it.
    virtual void Focus(Sarnik::CObjID /*control*/) {}
};

/// Where tasks find what they work on. They keep nothing else: between an undo and a redo a trace's place changes, and
/// its object with it. Outlives the stack.
class PTaskHost
{
public:
    virtual PKernelCollection &Traces() = 0;
    virtual PTaskStack &Tasks() = 0;
    virtual PTaskView &View() = 0;

protected:
    ~PTaskHost() = default;
};

} // namespace Project
