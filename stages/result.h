#pragma once

#include "stages/render/renderJob.h"
#include "stages/stage.h"

#include <memory>
#include <vector>

namespace Project
{

class PCtrlThread;

/// The deconvolved picture at one scale, cell by cell.
class PResult final : public PStage
{
public:
    enum class Role
    {
        rough, ///< at preview size, Wiener whatever the parameters say
        fast,  ///< at preview size, by the chosen method
        full   ///< at full resolution
    };
    PResult(PImageHub &owner, Role what);
    ~PResult() override;

    void Reset() override;
    /// The whole picture at the stage's scale: full resolution where it is the hub's image bounds. Where only the place
    /// changes, pixels and states stay.
    void SetBounds(const Sarnik::CRect &newRect);
    std::uint64_t ProcessCell(std::int64_t column, std::int64_t row, bool force) override;

    /// The source stage has changed there, and with it all cells that read it.
    void Notify(const Sarnik::CRect &changed);
    /// The cells that a rectangle touches are to be computed again; a job under way is worth nothing any more, and the
    /// dependents are told.
    void Invalidate(const Sarnik::CRect &area);
    void InvalidateAll() { Invalidate(Rect()); }
    void LookAhead(const Sarnik::CRect &area) override { ahead = area; }
    /// Whether cells are computed beside the main thread, on the hub's task pool: so at first. A cell that is under way
    /// stays behind and shows its source; meanwhile others that will be asked for are begun, as many as there are
    /// threads, and when there is no more to begin it reports itself to the hub as abandoned. Otherwise ProcessCell
    /// computes it.
    void SetUseWorker(bool use) { useWorker = use; }
    /// Drops the jobs under way; they end soon.
    void CancelJobs();

    bool Scaled() const { return scaled; }
    float Scale() const { return scale; }

    // A cell in parts, for a final render that has many of them under way.

    /// Whether there is something to deconvolve in a cell: a trace that is ready and not too small at this scale, and
    /// a part of the selection.
    bool NeedsRender(const Sarnik::CRect &cell) const;
    /// The cell and the margin that its deconvolution reads.
    Sarnik::CRect SourceRect(const Sarnik::CRect &cell) const;
    /// False where no trace is ready.
    bool CollectSettings(renderSettings &settings) const;
    /// The source is up to date over SourceRect(cell).
    std::unique_ptr<PRenderJob> MakeJob(const Sarnik::CRect &cell, const renderSettings &settings,
                                        PEstimatorPool &pool) const;
    /// A job that has run becomes the cell's content; the cell is finished.
    void TakeOver(std::int64_t column, std::int64_t row, PRenderJob &job);
    /// The same for a cell that needs no render; the source is up to date over it.
    void TakeSource(std::int64_t column, std::int64_t row);

private:
    PStage &SourceStage() const;
    void CopySource(const Sarnik::CRect &area);
    std::int64_t Margin() const;
    void RenderNow(const Sarnik::CRect &cell, std::int64_t column, std::int64_t row);
    bool RenderBeside(const Sarnik::CRect &cell, std::int64_t column, std::int64_t row);
    std::uint64_t WorkAhead();
    void Begin(const Sarnik::CRect &cell);
    bool RoomInLine();

    const Role role;
    bool scaled = false;
    float scale = 1.0f;
    bool useWorker = true;

    /// A cell that is computed beside the main thread, with all that it needs. The worker alone touches it until
    /// `finished`.
    struct PPendingCell;
    using Cells = std::vector<std::shared_ptr<PPendingCell>>;
    Cells::iterator FindPending(const Sarnik::CRect &cell);
    Cells pending; ///< under way, or done and not asked for since; the oldest first
    Cells ending;  ///< dropped while they ran
    Sarnik::CRect ahead;
    std::unique_ptr<PCtrlThread> control; ///< after the cells: its end waits for the workers
};

} // namespace Project
