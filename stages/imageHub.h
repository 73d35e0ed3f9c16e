#pragma once

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

class PResult;
class PSource;
class PStage;

/// Owns the graph of image stages. Main thread.
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
    PResult &ResultFull();

    PStageHost &Host() const { return host; }
    PPlaneLayout Layout() const;
    CorvaneDeblur::shrinkageTableStore &Tables() const;
    const Sarnik::CRect &ImageBounds() const { return imageBounds; }
    /// Side of a cell; 512 at first. A new one empties the stages. Limited to 16..8192.
    std::int32_t CellSize() const { return cellSize; }
    void SetCellSize(std::int64_t side);
    /// What may change, at a result stage's scale, rounded outwards.
    Sarnik::CRect SelectionAt(const PResult &stage) const;

    /// Renders the whole result into the host, with its progress and abort callbacks. False where it was aborted.
    bool RenderWithCallbacks();

private:
    PStageHost &host;
    Sarnik::CRect imageBounds;
    std::int32_t cellSize = 512;
    std::uint32_t busyDepth = 0;
    std::unique_ptr<PSource> source;
    std::unique_ptr<PResult> resultFull;
};

} // namespace Project
