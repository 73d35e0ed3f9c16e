#pragma once

#include "framework/pixels/memoryPixmap.h"
#include "stages/stage.h"

namespace Project
{

class PResult;

/// The pass that writes the result to the host: cells of the area that changes, each of which pulls the full-resolution
/// result up to date and hands its pixels over. It has no pixels of its own.
class PFinal final : public Sarnik::CPixProcess
{
public:
    explicit PFinal(PImageHub &owner) : hub(owner) {}

    /// The area to write, cut along the cells of the result. An empty one resets.
    void SetBounds(const Sarnik::CRect &rect);
    std::uint64_t ProcessCell(std::int64_t column, std::int64_t row, bool force) override;

    /// What a cell is to be is there already: over the result's cell, planes as the layout's ResultPlanes().
    void Write(std::int64_t column, std::int64_t row, Sarnik::CMemoryPixmap &pixels);
    /// It is in a stage's first planes.
    void WriteFrom(std::int64_t column, std::int64_t row, PStage &stage);

private:
    PImageHub &hub;
    Sarnik::CRect bounds;
};

} // namespace Project
