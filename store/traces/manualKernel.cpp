#include "store/traces/manualKernel.h"

#include "deblur/estimate/straightKernel.h"
#include "framework/base/container.h"
#include "store/traces/kernelCollection.h"
#include "store/traces/squareKernel.h"
#include "store/traces/traceRecord.h"

#include <algorithm>
#include <cmath>
#include <numbers>

namespace Project
{
namespace
{

/// Beyond any picture, and within what a float holds to the pixel's neighbourhood.
int Pixel(double coordinate)
{
    return static_cast<int>(std::clamp(coordinate, -1e9, 1e9));
}

/// Moved, along one axis, to lie within from..to; where it does not fit it begins at `from`.
void MoveWithin(int &first, int &last, int from, int to)
{
    const int before = std::min(to - last, 0);
    const int after = std::max(from - (first + before), 0);
    first += before + after;
    last += before + after;
}

} // namespace

PManualKernel::PManualKernel(PKernelCollection &owner, const PTraceRecord &record)
    : PKernel(owner, record), lineStart(record.lineStart), lineEnd(record.lineEnd)
{
}

void PManualKernel::Offset(int dx, int dy)
{
    PKernel::Offset(dx, dy);
    for (PLinePoint *point : {&lineStart, &lineEnd})
    {
        point->x += static_cast<float>(dx);
        point->y += static_cast<float>(dy);
    }
}

void PManualKernel::Read(Sarnik::CContainer &in)
{
    PTraceRecord record = ReadCommonRecord(in, home.Version());
    ReadLine(in, record);
    TakeRecord(record);
    lineStart = record.lineStart;
    lineEnd = record.lineEnd;
}

void PManualKernel::Write(Sarnik::CContainer &out) const
{
    PKernel::Write(out);
    for (const float number : {lineStart.x, lineStart.y, lineEnd.x, lineEnd.y})
        out.WriteF32(number);
}

void PManualKernel::SetLine(PLinePoint start, PLinePoint end)
{
    for (const float number : {start.x, start.y, end.x, end.y})
        if (!std::isfinite(number))
            return;
    lineStart = start;
    lineEnd = end;
    if (start == end)
        return;

    const double dx = static_cast<double>(end.x) - start.x, dy = static_cast<double>(start.y) - end.y;
    double angle = std::atan2(dy, dx) * 180.0 / std::numbers::pi;
    if (angle < 0.0)
        angle += 180.0;
    const auto line = CorvaneDeblur::straightKernel(std::hypot(dx, dy), angle);

    const int wanted = std::max(10, 2 * std::max(line.rows, line.cols)) | 1;
    const int side = std::min(home.MaxKernelSize(), wanted);
    kernelImage = SquareKernel(line, side);
    settings.size = side;
    previousSettings = settings;
    MarkChanged();

    const Sarnik::CRect bounds = home.Picture().Bounds();
    Sarnik::CRect square;
    square.left = Pixel(static_cast<double>(start.x) + end.x) / 2 - side / 2;
    square.top = Pixel(static_cast<double>(start.y) + end.y) / 2 - side / 2;
    square.right = square.left + side;
    square.bottom = square.top + side;
    MoveWithin(square.left, square.right, bounds.left, bounds.right);
    MoveWithin(square.top, square.bottom, bounds.top, bounds.bottom);
    region = drawnRegion = committedRegion = square;
    home.Events().TraceLooksDifferent(*this);
}

} // namespace Project
