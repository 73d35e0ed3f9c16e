#pragma once

#include <cstddef>
#include <cstdint>

/// Rows of the grey conversion, one function a sample type: plain loops that vectorise.
///
/// Grey is (0.299 R + 0.587 G + 0.114 B) / range in double, the weights being single-precision numbers widened; range
/// is 255, 65535 (16-bit samples are expanded first) and 1. A mask sample is 1 where a channel's raw sample exceeds the
/// limit, else 0; NaN exceeds nothing. Rows do not overlap.
namespace Sarnik
{

void greyOfRgb(std::size_t n, const std::uint8_t *r, const std::uint8_t *g, const std::uint8_t *b, double *grey);
void greyOfRgb(std::size_t n, const std::uint16_t *r, const std::uint16_t *g, const std::uint16_t *b, double *grey);
void greyOfRgb(std::size_t n, const float *r, const float *g, const float *b, double *grey);
/// The first three of four interleaved samples a pixel.
void greyOfRgbQuads(std::size_t n, const std::uint8_t *quads, double *grey);
void greyOfRgbQuads(std::size_t n, const std::uint16_t *quads, double *grey);
/// A plane that is grey already.
void greyOfPlane(std::size_t n, const std::uint8_t *plane, double *grey);
void greyOfPlane(std::size_t n, const std::uint16_t *plane, double *grey);
void greyOfPlane(std::size_t n, const float *plane, double *grey);

/// mask = mask | (plane > limit): a channel at a time, over a row that starts as 0.
void markAbove(std::size_t n, const std::uint8_t *plane, std::uint8_t limit, std::uint8_t *mask);
void markAbove(std::size_t n, const std::uint16_t *plane, std::uint16_t limit, std::uint8_t *mask);
void markAbove(std::size_t n, const float *plane, float limit, std::uint8_t *mask);
void markAboveQuads(std::size_t n, const std::uint8_t *quads, std::uint8_t limit, std::uint8_t *mask);
void markAboveQuads(std::size_t n, const std::uint16_t *quads, std::uint16_t limit, std::uint8_t *mask);

/// Four planes to interleaved pixels.
void interleave(std::size_t n, const std::uint8_t *const planes[4], std::uint8_t *quads);
void interleave(std::size_t n, const std::uint16_t *const planes[4], std::uint16_t *quads);

} // namespace Sarnik
