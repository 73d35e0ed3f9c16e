#pragma once

#include "deblur/estimate/floatArray.h"

#include <cstdint>
#include <vector>

/// Reference arrays under tests/data/vectors: one folder a case, one .npy file an array. They come from an independent
/// computation; README.md there lists them.
///
/// The reader takes what the files are: format version 1.0, little-endian, C order, one or two dimensions (a single
/// dimension reads as one row). A missing file, another type or a short one throws std::runtime_error with its path.
namespace TestSupport
{

/// float32 or float64 samples, the latter rounded to single precision.
CorvaneDeblur::floatArray readFloats(const char *caseName, const char *arrayName);
/// uint8 samples.
CorvaneDeblur::byteArray readBytes(const char *caseName, const char *arrayName);
/// int64 samples in file order, whatever the shape.
std::vector<std::int64_t> readInts(const char *caseName, const char *arrayName);

} // namespace TestSupport
