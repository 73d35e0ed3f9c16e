#pragma once

#include "stages/notice.h"
#include "stages/planeLayout.h"
#include "stages/stageHost.h"

#include <cstdint>
#include <memory>

namespace CorvaneDeblur
{
class shrinkageTableStore;
}

namespace Project
{

class PPreview;
class PProgressWindow;
class PResult;
class PResultScaled;
class PSource;
class PSourceScaled;
class PStage;
class PStageView;
class PTaskPool;
class PTimeLogger;

/// The stages that exist; the others have not been asked for. What reads goes before what it reads.
struct PStageSet
{
    PStageSet();
    ~PStageSet();
    std::unique_ptr<PSource> source;               ///< the picture
    std::unique_ptr<PSourceScaled> sourceExtra;    ///< reduced, for whoever looks at the picture as a whole
    std::unique_ptr<PSourceScaled> sourceAccurate; ///< at the view's size
    std::unique_ptr<PSourceScaled> sourceFast;     ///< sourceAccurate reduced further, by the hub's reduction
    std::unique_ptr<PResult> resultFast;           ///< from sourceFast
    std::unique_ptr<PResult> resultFull;           ///< from source
    std::unique_ptr<PResult> resultRough;          ///< from sourceFast, or from source in a view of the picture's size
    std::unique_ptr<PResultScaled> resultFullScaled; ///< resultFull at the view's size
    std::unique_ptr<PPreview> previewAccurate, previewFast, previewRough;
};

/// Owns the graph of image stages and makes it move: previews from coarse to exact, a slice of idle time after another,
/// and the final render. Nothing is computed until something downstream asks. Main thread; the host and its collection
/// of traces outlive the hub.
class PImageHub
{
public:
    /// The picture's bounds are the host's until SetImageBounds.
    explicit PImageHub(PStageHost &stageHost);
    PImageHub(const PImageHub &) = delete;
    PImageHub &operator=(const PImageHub &) = delete;
    ~PImageHub();

    // Stages, made when first asked for.

    PSource &Source();
    PSourceScaled &SourceAccurate();
    PSourceScaled &SourceFast();
    PSourceScaled &SourceExtra();
    PResult &ResultRough();
    PResult &ResultFull();
    PResult &ResultFast();
    PResultScaled &ResultFullScaled();
    PPreview &PreviewRough();
    PPreview &PreviewFast();
    PPreview &PreviewAccurate();
    const PStageSet &Stages() const { return stages; }

    // What the stages stand on.

    PStageHost &Host() const { return host; }
    PPlaneLayout Layout() const;
    CorvaneDeblur::shrinkageTableStore &Tables() const;
    /// For cells that are computed beside the main thread; not the one of the estimations, which take long.
    PTaskPool &TaskPool() { return *taskPool; }
    const Sarnik::CRect &ImageBounds() const { return imageBounds; }
    /// Empties all stages.
    void SetImageBounds(const Sarnik::CRect &rect);
    /// Side of a cell; 512 at first. A new one, limited to 16..8192, empties all stages.
    std::int32_t CellSize() const { return cellSize; }
    void SetCellSize(std::int64_t side);
    /// What may change, at a result stage's scale, rounded outwards.
    Sarnik::CRect SelectionAt(const PResult &stage) const;

    // The view.

    /// rect: the whole picture in view pixels, empty for no view. reduction: how much smaller, at least 1, the pictures
    /// are that the two lower levels work at.
    void SetView(const Sarnik::CRect &rect, double reduction);
    /// Null: nobody looks any more. The view outlives the hub or this call.
    void SetViewObject(PStageView *pane);
    /// The reduction for a view in which a part of that size can be seen: what its smaller side has above previewCap.
    double ReductionFor(const Sarnik::CRect &view, const Sarnik::CRect &visible) const;
    double Reduction() const { return reduction; }
    const Sarnik::CRect &ViewBounds() const { return viewBounds; }
    /// The view's bounds over the reduction, rounded outwards.
    Sarnik::CRect ReducedView() const;
    /// The best that there is of an area of the view, in packed pixels, into a pixmap of one plane of 32 bits.
    void DrawPreview(Sarnik::CMemoryPixmap &to, const Sarnik::CRect &area);

    // Changes.

    /// The results of these stages are to be computed again.
    void InvalidateResults(bool rough, bool scaled, bool full);
    /// What the previews show has changed as a whole (showPreview, another profile): all are made again, the rough one
    /// unless it is kept.
    void Refresh(bool keepRough);
    /// 1 holds the rough level back. SetView clears it.
    void SetSuppressed(int value);
    /// The plan is made anew before the next step.
    void MarkDirty() { dirty = true; }
    void AddAbandoned(int units) { abandoned += units; }
    void TellPreviews(const Sarnik::CRect &area, PNotice from);
    /// A preview has a new cell.
    void CellShown(const Sarnik::CRect &cell);

    // The schedule.

    /// Which levels run, and how much work that is.
    void Rebuild();
    /// Works for about `budget` seconds, or until a cell is under way on another thread. True while work is left.
    bool Idle(double budget);
    /// 0 no preview, 1 to 3 the level that is rendered, 4 complete.
    int Indicator() const { return indicator; }
    /// No lower level is on the way any more.
    bool IsPreviewFinal() const;
    bool RoughEnabled() const { return roughEnabled; }
    bool FastEnabled() const { return fastEnabled; }
    std::uint64_t TotalWork() const { return totalWork; }
    std::uint64_t DoneWork() const { return doneWork; }

    // The final render. While it runs, Idle does nothing.

    void BeginBusy();
    void EndBusy();
    /// Renders the whole result into the host, with its progress and abort callbacks. False where it was aborted.
    bool RenderWithCallbacks();
    /// The same with a window of its own.
    bool RenderWithDialog(PProgressWindow &window);

private:
    struct work;
    void EmptyStages();
    bool ViewActive() const;
    void CountWork();
    std::uint64_t StepVisible(PPreview &preview);
    std::uint64_t StepLevel(PPreview &preview, const PStage *result, int shows);
    std::uint64_t StepStage(PStage *stage);
    std::uint64_t Step();
    void SetIndicator(int value);
    void StopTimer(std::unique_ptr<PTimeLogger> &timer);

    PStageHost &host;
    const std::unique_ptr<PTaskPool> taskPool; ///< before the stages: outlives their jobs
    Sarnik::CRect imageBounds, viewBounds;
    PStageView *view = nullptr;
    std::uint64_t totalWork = 0, doneWork = 0, shownTotal = 0, shownDone = 0;
    std::uint32_t busyDepth = 0;
    bool dirty = true;
    bool hasView = false;
    bool roughEnabled = false, fastEnabled = false;
    double reduction = 1.0;
    std::int32_t cellSize = 512;
    int abandoned = 0;
    std::unique_ptr<PTimeLogger> roughTimer, fastTimer;
    int indicator = 0;
    int suppressed = 0;
    PStageSet stages;
};

} // namespace Project
