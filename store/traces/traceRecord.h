#pragma once

#include "store/traces/kernel.h"

#include <memory>

/// The bytes of one Blur Trace, in trace files, workspaces and recorded actions. All numbers are little-endian and
/// unaligned. Versions: 0 is read as 1, and what is above the newest as the newest; only the newest is written.
///
/// | field    | type                        | versions                                        |
/// | kind     | u32, PKernelKind            | 5; what kind an older record is, its fields tell |
/// | region   | 4 x i32: l, t, r, b         |                                                 |
/// | settings | as WriteSettings has them   |                                                 |
/// | size     | u32, the kernel's side      | 0: no kernel                                    |
/// | samples  | size x size x f32           | rows from the top                               |
/// | readOnly | boolean                     | 2 to 4                                          |
/// | line     | 4 x f32: x1, y1, x2, y2     | 4; from 5 on only for PManualKernel             |
///
/// Settings: mode (u32: 1 to 4), size, estimatorOptions (u32), estimatorTuningA, estimatorTuningB, threadWeight (f32),
/// threadFlag, deconvFlagA, deconvFlagB (booleans), deconvWeight, smoothing (f32), deconvIterations, noiseLevel (u32),
/// two bytes that are dropped (versions below 3), forcedApply (boolean), maskThreshold (u8), anchorX, anchorY (i32,
/// from version 2 on), suppression (f32, from version 3 on).
namespace Project
{

constexpr std::uint16_t kNewestTraceVersion = 5;

/// What a record holds, whatever its kind.
struct PTraceRecord
{
    Sarnik::CRect region;
    KernelSettings settings;
    CorvaneDeblur::floatArray kernel;
    bool readOnly = false;
    PLinePoint lineStart, lineEnd;
};

/// What a record that makes no sense is answered with.
inline constexpr const char *kUnrecognizedFormat =
    "$$$/Deblur/Error/LoadError/UnrecognizedFileFormat=Unrecognized file format.";

/// Settings that a version does not hold keep their defaults; smoothing and suppression are limited to 0..1, a number
/// that is none becomes the default. Throws CError at the end of the data.
KernelSettings ReadSettings(Sarnik::CContainer &in, int version);
void WriteSettings(Sarnik::CContainer &out, const KernelSettings &settings);

/// The part that all kinds share: region, settings, kernel. Throws CError when the data ends before the record, with
/// nothing allocated for what is not there, and when a sample is not finite.
PTraceRecord ReadCommonRecord(Sarnik::CContainer &in, int version);
void WriteCommonRecord(Sarnik::CContainer &out, const PTraceRecord &record);
/// The four numbers of a line. Throws CError when one is not finite.
void ReadLine(Sarnik::CContainer &in, PTraceRecord &record);

/// A whole record of any version (the collection's Version()). Null, with the common record skipped, for a kind that
/// is not known. Throws CError.
std::unique_ptr<PKernel> ReadTrace(PKernelCollection &home, Sarnik::CContainer &in);

} // namespace Project
