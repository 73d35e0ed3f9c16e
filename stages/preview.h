#pragma once

#include "framework/pixels/pixmapScaler.h"
#include "stages/notice.h"
#include "stages/stage.h"

namespace Project
{

/// What the preview pane displays, in one of three qualities: packed pixels 0xAARRGGBB over the view's rectangle. A
/// cell stands behind the stages that it is made from, and is done in one step once they are.
class PPreview final : public PStage
{
public:
    enum class Level
    {
        rough = 0,   ///< Wiener at preview size
        fast = 1,    ///< the chosen method at preview size
        accurate = 2 ///< the full-resolution result, reduced
    };
    PPreview(PImageHub &owner, Level quality);

    void Reset() override;
    void LookAhead(const Sarnik::CRect &area) override;
    /// viewRect: the whole picture at the view's zoom. Moved only, the pixels stay. Wires the stages that this level
    /// is made from.
    void SetTarget(const Sarnik::CRect &viewRect, const Sarnik::CRect &imageRect);
    std::uint64_t ProcessCell(std::int64_t column, std::int64_t row, bool force) override;

    /// A notice that is none of this level's business is dropped.
    void Invalidate(const Sarnik::CRect &changed, PNotice from);
    void InvalidateAll();
    /// The sizes of the stages between are in use.
    bool UsesScaled() const { return HasPixmap() && !Direct(); }

    /// The view's picture is not of the image's size.
    bool DifferentSize() const { return differentSize; }

    /// Whether a checkerboard shows through where the picture is transparent; on at first.
    void SetComposeMask(bool compose);
    /// Shows the source in place of the result, and marks every pixel with a colour byte above `limit`.
    void SetShowOriginal(bool show, std::uint8_t limit);

    /// Copies what the rectangles share into a pixmap of one plane of 32 bits; overflow marks are put in here.
    void Draw(Sarnik::CMemoryPixmap &to, const Sarnik::CRect &area);

private:
    /// Made straight from stages in picture coordinates, without any of preview size.
    bool Direct() const;
    /// The result that this level shows is smaller than the view.
    bool Enlarges() const;
    PStage &SourceStage() const;
    PStage &ResultStage() const;
    /// A rectangle of the view in the source's or the result's coordinates.
    Sarnik::CRect InSource(const Sarnik::CRect &area) const;
    Sarnik::CRect InResult(const Sarnik::CRect &area) const;
    bool ShowsResult() const;
    void Convert(const Sarnik::CRect &cell);

    const Level level;
    bool differentSize = false;
    bool composeMask = true;
    bool showOriginal = false;
    std::uint8_t overflowLimit = 0;
    Sarnik::CRect imageRect, reducedRect;
    Sarnik::CPixmapScaler enlarger; ///< from the reduced result to the view
};

} // namespace Project
