#include "stages/scaledStage.h"

#include "stages/imageHub.h"
#include "stages/result.h"
#include "stages/source.h"

namespace Project
{

using Sarnik::CMemoryPixmap;
using Sarnik::CRect;

void PScaledStage::Reset()
{
    PStage::Reset();
    largerRect = {};
}

void PScaledStage::SetBounds(const CRect &own, const CRect &larger)
{
    if (own.Empty() || larger.Empty())
        return Reset();
    if (larger.Width() != largerRect.Width() || larger.Height() != largerRect.Height())
        Reset();
    largerRect = larger;
    scaler = Sarnik::CPixScaler(larger, own);
    targetState = scaler.Steps();
    Place(own, hub.Layout().depth, Planes());
}

std::uint64_t PScaledStage::ProcessCell(std::int64_t column, std::int64_t row, bool force)
{
    if (CellRemaining(column, row) == 0)
        return 0;
    const CRect part = scaler.Part(TileRect(column, row), hub.CellSize(), CellState(column, row));
    std::uint64_t count = 0;
    if (!part.Empty())
    {
        const CRect area = scaler.SourceOf(part);
        PStage &larger = Larger();
        if (force)
        {
            count = larger.ForceRect(area);
            if (!larger.Finished(area))
                return count;
        }
        else if ((count = larger.StepRect(area)) != 0)
            return count;
        FillPart(part, area);
    }
    ++State(column, row);
    return count + 1;
}

void PScaledStage::LookAhead(const CRect &area)
{
    Larger().LookAhead(scaler.SourceOf(area));
}

void PScaledStage::FillPart(const CRect &part, const CRect &area)
{
    const int planes = Planes(), unused = UnusedPlane();
    CMemoryPixmap from(area, hub.Layout().depth, planes), to(part, hub.Layout().depth, planes);
    const auto scalePlanes = [&](int first, int count) {
        copyPlanes(from, first, Larger().Pixmap(), first, count, area);
        scaler.Scale(from, first, to, first, count);
        copyPlanes(Pixmap(), first, to, first, count, part);
    };
    if (unused < 0)
        return scalePlanes(0, planes);
    scalePlanes(0, unused);
    if (unused + 1 < planes)
        scalePlanes(unused + 1, planes - unused - 1);
}

void PScaledStage::Notify(const CRect &changed)
{
    if (HasPixmap())
        Invalidate(scaler.AreaOf(changed));
}

void PSourceScaled::Invalidate(const CRect &wanted)
{
    const CRect area = wanted.Intersected(Rect());
    if (area.Empty())
        return;
    LowerState(area, 0);
    const PStageSet &stages = hub.Stages();
    if (stages.sourceFast && stages.sourceFast.get() != this && stages.sourceAccurate.get() == this)
        stages.sourceFast->Notify(area);
    if (stages.sourceFast.get() == this)
        for (PResult *result : {stages.resultRough.get(), stages.resultFast.get()})
            if (result != nullptr && result->Scaled())
                result->Notify(area);
    if (stages.sourceAccurate.get() == this)
        hub.TellPreviews(area, PNotice::sourceScaled);
    hub.MarkDirty();
}

PStage &PSourceScaled::Larger() const
{
    if (from == From::accurate)
        return hub.SourceAccurate();
    return hub.Source();
}

int PSourceScaled::Planes() const
{
    return hub.Layout().SourcePlanes();
}

int PSourceScaled::UnusedPlane() const
{
    return hub.Layout().transparency ? -1 : hub.Layout().colours;
}

void PResultScaled::Invalidate(const CRect &wanted)
{
    const CRect area = wanted.Intersected(Rect());
    if (area.Empty())
        return;
    LowerState(area, 0);
    hub.TellPreviews(area, PNotice::resultFullScaled);
    hub.MarkDirty();
}

PStage &PResultScaled::Larger() const
{
    return hub.ResultFull();
}

int PResultScaled::Planes() const
{
    return hub.Layout().ResultPlanes();
}

} // namespace Project
