#pragma once

#include "stages/render/renderJob.h"
#include "stages/stage.h"

namespace Project
{

/// The deconvolved picture at one scale, cell by cell.
class PResult final : public PStage
{
public:
    /// fastOnly: Wiener whatever the parameters say.
    PResult(PImageHub &owner, bool fastOnly);

    /// The whole picture at the stage's scale: full resolution where it is the hub's image bounds.
    void SetBounds(const Sarnik::CRect &newRect);
    std::uint64_t ProcessCell(std::int64_t column, std::int64_t row, bool force) override;

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
    void RenderNow(const Sarnik::CRect &cell, std::int64_t column, std::int64_t row);

    const bool fastOnly;
    bool scaled = false;
    float scale = 1.0f;
};

} // namespace Project
