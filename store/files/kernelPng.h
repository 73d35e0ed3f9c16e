#pragma once

#include "deblur/estimate/floatArray.h"

#include <string>

namespace Sarnik
{
class CContainer;
}

/// Kernels as PNG pictures, for paint programs and for the exchange with other programs. docs/files/png-traces.md tells
/// which pictures are read and what is written.
namespace Project
{

/// Smallest side of a picture that is read.
inline constexpr int kSmallestKernelPng = 10;

/// Reads a picture from the stream's position on: its grey values or its luma, row by row from the top left, scaled to
/// a sum of 1. An even side grows by one row and column of zeros at the end, since the engine's kernels have a centre.
///
/// maxSize: largest side of a picture in pixels. Memory follows maxSize, whatever the file promises.
///
/// False if it is no such picture: `message` then tells the user why, in the user's language, or stays as it was where
/// the file is broken rather than of the wrong kind. `destination` is replaced on success only. Throws CError where the
/// stream ends within the first eight bytes.
bool ReadKernelPng(CorvaneDeblur::floatArray &destination, int maxSize, Sarnik::CContainer &in, std::string &message);

/// Writes a 16-bit grey picture, scaled so that the largest sample becomes 65535; what is negative or no number becomes
/// 0. The sum is not kept. False where the library fails, which means that memory ran out; `message` is left alone.
bool WriteKernelPng(const CorvaneDeblur::floatArray &source, Sarnik::CContainer &out, std::string &message);

} // namespace Project
