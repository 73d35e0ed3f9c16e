#pragma once

#include "store/traces/kernel.h"

namespace Project
{

/// A trace drawn by hand: a straight motion between two points.
class PManualKernel final : public PKernel
{
public:
    using PKernel::PKernel;
    PManualKernel(PKernelCollection &home, const PTraceRecord &record);

    void Offset(int dx, int dy) override;
    void Read(Sarnik::CContainer &in) override;
    void Write(Sarnik::CContainer &out) const override;
    PKernelKind KernelType() const override { return PKernelKind::Manual; }
    std::unique_ptr<PKernel> Copy() const override { return std::make_unique<PManualKernel>(*this); }

    PLinePoint LineStart() const { return lineStart; }
    PLinePoint LineEnd() const { return lineEnd; }
    /// Makes the kernel of the line, and the region and the size that go with it. Equal points are stored and change
    /// nothing else; points that are not finite change nothing at all.
    void SetLine(PLinePoint start, PLinePoint end);
    /// The points alone, for undoing: their kernel, region and size are restored by themselves.
    void RestoreLine(PLinePoint start, PLinePoint end)
    {
        lineStart = start;
        lineEnd = end;
    }

private:
    PLinePoint lineStart, lineEnd;
};

} // namespace Project
