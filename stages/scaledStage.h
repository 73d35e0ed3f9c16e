#pragma once

#include "framework/pixels/pixmapScaler.h"
#include "stages/stage.h"

namespace Project
{

/// A copy of another stage's picture at another size. A cell is filled in steps, parts of it, so that each stays short
/// however many pixels of the larger stage a cell is made from.
class PScaledStage : public PStage
{
public:
    /// The own rectangle, and that of the stage it is made from. Where only places change, pixels and states stay.
    void SetBounds(const Sarnik::CRect &own, const Sarnik::CRect &larger);
    std::uint64_t ProcessCell(std::int64_t column, std::int64_t row, bool force) override;
    void Reset() override;
    void LookAhead(const Sarnik::CRect &area) override;

    /// Pixels of the larger stage have changed: what is made from them is to be made again.
    void Notify(const Sarnik::CRect &changed);
    /// The cells that a rectangle touches, back to their first step; whoever depends on them is told.
    virtual void Invalidate(const Sarnik::CRect &area) = 0;

protected:
    PScaledStage(PImageHub &owner) : PStage(owner, 1) {}

    virtual PStage &Larger() const = 0;
    virtual int Planes() const = 0;
    /// A plane that nobody fills; -1 for none.
    virtual int UnusedPlane() const { return -1; }

private:
    void FillPart(const Sarnik::CRect &part, const Sarnik::CRect &area);

    Sarnik::CRect largerRect;
    Sarnik::CPixScaler scaler;
};

/// The picture at a preview's size.
class PSourceScaled final : public PScaledStage
{
public:
    enum class From
    {
        accurate = 0, ///< made from the hub's sourceAccurate
        source = 1
    };
    PSourceScaled(PImageHub &owner, From stage) : PScaledStage(owner), from(stage) {}

    void Invalidate(const Sarnik::CRect &area) override;

protected:
    PStage &Larger() const override;
    int Planes() const override;
    int UnusedPlane() const override;

private:
    const From from;
};

/// The full-resolution result at the preview's size.
class PResultScaled final : public PScaledStage
{
public:
    explicit PResultScaled(PImageHub &owner) : PScaledStage(owner) {}

    void Invalidate(const Sarnik::CRect &area) override;

protected:
    PStage &Larger() const override;
    int Planes() const override;
};

} // namespace Project
