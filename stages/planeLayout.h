#pragma once

namespace Project
{

/// Which planes the stages' pixmaps have. Source stages carry the colours, transparency and the selection where there
/// is one; results carry the colours, and transparency only where the picture has it. Where the picture has none the
/// source's plane is there all the same, since the grey conversion counts planes; nobody fills or reads it, and it
/// costs no memory.
struct PPlaneLayout
{
    int depth = 8;
    int colours = 1;
    bool transparency = false;
    bool selection = false;

    int SourcePlanes() const { return colours + 1 + (selection ? 1 : 0); }
    int SelectionPlane() const { return colours + 1; } ///< of source stages
    int ResultPlanes() const { return colours + (transparency ? 1 : 0); }

    // What a cell is rendered from: a result's planes, then the selection where there is one.
    int JobPlanes() const { return ResultPlanes() + (selection ? 1 : 0); }
    /// By which of these a result is mixed with its source: the selection, else transparency; -1 for neither.
    int MaskPlane() const { return selection ? ResultPlanes() : transparency ? colours : -1; }

    friend bool operator==(const PPlaneLayout &, const PPlaneLayout &) = default;
};

} // namespace Project
