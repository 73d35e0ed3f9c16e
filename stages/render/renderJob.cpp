#include "stages/render/renderJob.h"

#include "framework/pixels/maskBlend.h"
#include "stages/render/renderRectangle.h"

namespace Project
{

void PRenderJob::Run()
{
    destination = std::make_unique<Sarnik::CMemoryPixmap>(cell, layout.depth, layout.ResultPlanes());
    {
        PEstimatorPool::Loan loan(pool);
        renderRectangle(settings, loan.Estimator(), *destination, *source, originX, originY, layout.colours);
    }
    if (layout.MaskPlane() >= 0)
    {
        blendByMask(*destination, *source, layout.colours, layout.MaskPlane());
        // Mixing a sample with itself may cost a level.
        for (int plane = 0; plane < layout.colours; ++plane)
            if (!settings.Deconvolves(plane))
                copyPlanes(*destination, plane, *source, plane, 1, cell);
    }
    source.reset();
}

} // namespace Project
