#pragma once

#include "framework/pixels/imageMode.h"
#include "framework/pixels/memoryPixmap.h"
#include "framework/pixels/pageStore.h"

#include <cstdint>

namespace Sarnik
{
class CQuadConverter;
}

namespace Project
{

class PKernelCollection;
struct PParams;

/// What the stages want of the run they belong to: the picture, where it goes, and what steers it. The filter fills it;
/// it outlives the hub. All rectangles are in picture coordinates. Called on the main thread only.
class PStageHost
{
public:
    /// Samples of 8, 16 (0..32768) or 32 bits. Fixed for the run, as are the bounds and the next three answers.
    virtual Sarnik::CImageFormat Format() const = 0;
    virtual Sarnik::CRect ImageBounds() const = 0;
    /// What may change: the selection's bounds within the picture, or the picture where nothing is selected.
    virtual Sarnik::CRect SelectionBounds() const = 0;
    virtual bool HasSelection() const = 0;
    virtual bool HasTransparency() const = 0;

    /// Fills the colour planes over the pixmap's rectangle, which lies within the picture, and the transparency plane
    /// where the pixmap has a plane after them (opaque where the picture has none). Throws CException.
    virtual void ReadSource(Sarnik::CBasicPixmap &pixmap) = 0;
    /// Fills one plane of the pixmap with the selection: 0 nothing .. 255, 32768 or 1.0 all. Throws CException.
    virtual void ReadSelection(Sarnik::CBasicPixmap &pixmap, int plane) = 0;
    /// Takes finished pixels: the colour planes, then transparency if HasTransparency. Throws CException.
    virtual void Write(Sarnik::CBasicPixmap &pixmap, const Sarnik::CRect &rect) = 0;

    /// From CMYK for the display; null where the host cannot.
    virtual Sarnik::CQuadConverter *CmykConverter() { return nullptr; }

    virtual Sarnik::CPageStore &PageStore() = 0;
    virtual PParams &Params() = 0;
    virtual PKernelCollection &Kernels() = 0;

    /// How far a render is; not called more often than every 0.2 seconds, but once more at its end.
    virtual void Progress(std::uint64_t done, std::uint64_t total) = 0;
    /// Whether the user wants it to end.
    virtual bool Abort() = 0;

protected:
    ~PStageHost() = default;
};

} // namespace Project
