#pragma once

#include "stages/stage.h"

namespace Project
{

/// The picture as the host gives it, at full resolution, and the selection. A cell is one read of the host, and happens
/// once.
class PSource final : public PStage
{
public:
    explicit PSource(PImageHub &owner) : PStage(owner, 1) {}

    void SetBounds(const Sarnik::CRect &newRect);
    /// The host's pixels have changed there.
    void Invalidate(const Sarnik::CRect &area);
    std::uint64_t ProcessCell(std::int64_t column, std::int64_t row, bool force) override;
};

} // namespace Project
