#pragma once

#include "framework/pixels/pixProcess.h"
#include "framework/pixels/virtualPixmap.h"

#include <memory>

namespace Project
{

class PImageHub;

/// What the stages of the graph have in common: a rectangle cut into the hub's square cells from its top left corner
/// on, and a paged pixmap over it. Main thread.
class PStage : public Sarnik::CPixProcess
{
public:
    void Reset() override;
    const Sarnik::CRect &Rect() const { return rect; }
    /// Only while the rectangle is not empty.
    Sarnik::CVirtualPixmap &Pixmap() const { return *pixmap; }
    bool HasPixmap() const { return pixmap != nullptr; }

    /// The cells that a rectangle touches are all finished.
    bool Finished(const Sarnik::CRect &area) const { return RemainingRegion(Touched(area)) == 0; }

    /// All of this area will be asked for, from now until the next call: what is computed beside the main thread may
    /// begin before its turn.
    virtual void LookAhead(const Sarnik::CRect &) {}

protected:
    PStage(PImageHub &owner, std::uint32_t steps) : CPixProcess(steps), hub(owner) {}

    /// A new rectangle. Of the same size and planes: pixels and states move along, and the answer is false; otherwise
    /// all is lost.
    bool Place(const Sarnik::CRect &newRect, int depth, int planes);

    PImageHub &hub;

private:
    Sarnik::CRect rect;
    std::unique_ptr<Sarnik::CVirtualPixmap> pixmap;
};

} // namespace Project
