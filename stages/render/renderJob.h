#pragma once

#include "framework/pixels/memoryPixmap.h"
#include "stages/planeLayout.h"
#include "stages/render/estimatorPool.h"
#include "stages/render/jobLine.h"

#include <memory>

namespace Project
{

/// One cell on its way through the deconvolution. The main thread fills in what it is made from and takes the result;
/// in between it belongs to the thread that runs it.
class PRenderJob final : public PLineJob
{
public:
    /// source: over the cell and its margin, planes as layout.JobPlanes(). The render outlives the job.
    PRenderJob(const renderSettings &what, PEstimatorPool &with, const PPlaneLayout &planes, const Sarnik::CRect &area,
               std::unique_ptr<Sarnik::CMemoryPixmap> from, int x, int y)
        : settings(what), pool(with), layout(planes), cell(area), source(std::move(from)), originX(x), originY(y)
    {
    }

    /// Deconvolves, then mixes with the source by the mask.
    void Run() override;

    const Sarnik::CRect &Cell() const { return cell; }
    /// After Run: over the cell, planes as layout.ResultPlanes().
    Sarnik::CMemoryPixmap &Result() { return *destination; }

private:
    const renderSettings &settings;
    PEstimatorPool &pool;
    const PPlaneLayout layout;
    const Sarnik::CRect cell;
    std::unique_ptr<Sarnik::CMemoryPixmap> source, destination;
    const int originX, originY;
};

} // namespace Project
