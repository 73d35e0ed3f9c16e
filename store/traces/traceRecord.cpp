#include "store/traces/traceRecord.h"

#include "framework/base/container.h"
#include "framework/base/exceptions.h"
#include "store/traces/estimatedKernel.h"
#include "store/traces/kernelCollection.h"
#include "store/traces/manualKernel.h"
#include "store/traces/readOnlyKernel.h"
#include "store/traces/squareKernel.h"

#include <algorithm>
#include <array>
#include <cmath>

namespace Project
{
namespace
{

using CorvaneDeblur::floatArray;
using Sarnik::CContainer;
using Sarnik::CError;

constexpr std::uint32_t largestSide = 0xFFFF; ///< of a kernel; larger ones would be beyond any file

std::uint8_t ReadU8(CContainer &in)
{
    std::byte value[1];
    in.ReadBytes(value);
    return std::to_integer<std::uint8_t>(value[0]);
}

float ReadShare(CContainer &in, float standard)
{
    const float value = in.ReadF32();
    return std::isnan(value) ? standard : std::clamp(value, 0.0f, 1.0f);
}

/// In files the modes are 1 to 4, and whatever is unknown is the last.
std::uint32_t ModeOfCode(std::uint32_t code)
{
    return code >= 1 && code <= 3 ? code - 1 : 3;
}

std::uint32_t CodeOfMode(std::uint32_t mode)
{
    return mode <= 2 ? mode + 1 : 4;
}

floatArray ReadKernel(CContainer &in)
{
    const std::uint32_t side = in.ReadU32();
    if (side == 0)
        return {};
    if (side > largestSide || std::uint64_t{side} * side * 4 > in.Remaining())
        throw CError(kUnrecognizedFormat);
    const floatArray kernel = floatArray::allocate(static_cast<int>(side), static_cast<int>(side));
    bool finite = true;
    for (int y = 0; y < kernel.rows; ++y)
    {
        float *row = kernel.row(y);
        for (int x = 0; x < kernel.cols; ++x)
        {
            row[x] = in.ReadF32();
            finite = finite && std::isfinite(row[x]);
        }
    }
    if (!finite)
        throw CError(kUnrecognizedFormat);
    return kernel;
}

std::unique_ptr<PKernel> EmptyTrace(PKernelCollection &home, PKernelKind kind)
{
    switch (kind)
    {
    case PKernelKind::Estimated:
        return std::make_unique<PEstimatedKernel>(home, Sarnik::CRect{}, KernelSettings{});
    case PKernelKind::Manual:
        return std::make_unique<PManualKernel>(home, Sarnik::CRect{}, KernelSettings{});
    case PKernelKind::ReadOnly:
        return std::make_unique<PReadOnlyKernel>(home, Sarnik::CRect{}, KernelSettings{});
    }
    return nullptr;
}

/// Before version 5 a record does not say what it is: one with a line is a manual trace, even if it is read-only too.
std::unique_ptr<PKernel> ReadOldTrace(PKernelCollection &home, CContainer &in, int version)
{
    PTraceRecord record = ReadCommonRecord(in, version);
    if (version > 1)
        record.readOnly = in.ReadBool();
    if (version > 3)
        ReadLine(in, record);
    if (record.lineStart != record.lineEnd)
        return std::make_unique<PManualKernel>(home, record);
    if (record.readOnly)
        return std::make_unique<PReadOnlyKernel>(home, record);
    return std::make_unique<PEstimatedKernel>(home, record);
}

} // namespace

KernelSettings ReadSettings(CContainer &in, int version)
{
    KernelSettings s;
    s.mode = ModeOfCode(in.ReadU32());
    s.size = in.ReadI32();
    s.estimatorOptions = in.ReadU32();
    s.estimatorTuningA = in.ReadF32();
    s.estimatorTuningB = in.ReadF32();
    s.threadWeight = in.ReadF32();
    s.threadFlag = in.ReadBool();
    s.deconvFlagA = in.ReadBool();
    s.deconvFlagB = in.ReadBool();
    s.deconvWeight = in.ReadF32();
    s.smoothing = ReadShare(in, s.smoothing);
    s.deconvIterations = in.ReadU32();
    s.noiseLevel = in.ReadU32();
    if (version < 3)
        in.ReadU16();
    s.forcedApply = in.ReadBool();
    s.maskThreshold = ReadU8(in);
    if (version >= 2)
    {
        s.anchorX = in.ReadI32();
        s.anchorY = in.ReadI32();
    }
    if (version >= 3)
        s.suppression = ReadShare(in, s.suppression);
    return s;
}

void WriteSettings(CContainer &out, const KernelSettings &s)
{
    out.WriteU32(CodeOfMode(s.mode));
    out.WriteI32(s.size);
    out.WriteU32(s.estimatorOptions);
    out.WriteF32(s.estimatorTuningA);
    out.WriteF32(s.estimatorTuningB);
    out.WriteF32(s.threadWeight);
    out.WriteBool(s.threadFlag);
    out.WriteBool(s.deconvFlagA);
    out.WriteBool(s.deconvFlagB);
    out.WriteF32(s.deconvWeight);
    out.WriteF32(s.smoothing);
    out.WriteU32(s.deconvIterations);
    out.WriteU32(s.noiseLevel);
    out.WriteBool(s.forcedApply);
    const std::byte threshold[1] = {static_cast<std::byte>(s.maskThreshold)};
    out.WriteBytes(threshold);
    out.WriteI32(s.anchorX);
    out.WriteI32(s.anchorY);
    out.WriteF32(s.suppression);
}

PTraceRecord ReadCommonRecord(CContainer &in, int version)
{
    PTraceRecord record;
    record.region.left = in.ReadI32();
    record.region.top = in.ReadI32();
    record.region.right = in.ReadI32();
    record.region.bottom = in.ReadI32();
    record.settings = ReadSettings(in, version);
    record.kernel = ReadKernel(in);
    return record;
}

void WriteCommonRecord(CContainer &out, const PTraceRecord &record)
{
    for (const std::int32_t edge : {record.region.left, record.region.top, record.region.right, record.region.bottom})
        out.WriteI32(edge);
    WriteSettings(out, record.settings);
    const floatArray kernel = SquareKernel(record.kernel, std::max(record.kernel.rows, record.kernel.cols));
    out.WriteU32(static_cast<std::uint32_t>(kernel.cols));
    for (int y = 0; y < kernel.rows; ++y)
        for (int x = 0; x < kernel.cols; ++x)
            out.WriteF32(kernel.row(y)[x]);
}

void ReadLine(CContainer &in, PTraceRecord &record)
{
    std::array<float, 4> line;
    for (float &number : line)
        number = in.ReadF32();
    if (!std::all_of(line.begin(), line.end(), [](float number) { return std::isfinite(number); }))
        throw CError(kUnrecognizedFormat);
    record.lineStart = {line[0], line[1]};
    record.lineEnd = {line[2], line[3]};
}

std::unique_ptr<PKernel> ReadTrace(PKernelCollection &home, CContainer &in)
{
    const int version = std::min<int>(home.Version(), kNewestTraceVersion);
    if (version < 5)
        return ReadOldTrace(home, in, version);
    auto trace = EmptyTrace(home, static_cast<PKernelKind>(in.ReadU32()));
    if (trace)
        trace->Read(in);
    else
        ReadCommonRecord(in, version);
    return trace;
}

} // namespace Project
