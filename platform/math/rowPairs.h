#pragma once

#include "platform/math/complexSample.h"

#include <cstddef>

/// A real line transforms as fast as half a complex one when two of them travel as the real and the imaginary part of
/// one complex line (and, unlike FFTW's own real transforms, at any length: those are slow at odd ones). These loops
/// put two real rows into a complex line and take the two half spectra out again, and back.
///
/// A half spectrum is stored in pieces of columnLanes samples: sample k of a row lies at
/// (k / columnLanes) * pieceStride + k % columnLanes from the row's first sample, so that the columns of a piece lie
/// together for the column transforms (realTransform2d.h).
namespace CorvaneDeblur
{

/// line[k] = (a[k], b[k]) for k < count, 0 from there to cols; a null b counts as zeros.
void packRows(const float *a, const float *b, int count, complexSample *line, int cols);

/// From the transform of a packed line (cols samples) to the half spectra of its two rows; halfB may be null.
/// Samples between the half spectrum's end and the end of its last piece are set to 0.
void splitSpectra(const complexSample *line, int cols, complexSample *halfA, complexSample *halfB,
                  std::ptrdiff_t pieceStride);

/// The inverse of splitSpectra: line receives cols samples. The imaginary parts at frequency 0 (and cols / 2 when cols
/// is even), which a real row does not have, are taken as 0. A null halfB counts as zeros.
void joinSpectra(const complexSample *halfA, const complexSample *halfB, std::ptrdiff_t pieceStride, int cols,
                 complexSample *line);

/// a[k] = line[k].re * scale, b[k] = line[k].im * scale for the first `count` samples; b may be null.
void unpackRows(const complexSample *line, float *a, float *b, int count, float scale);

} // namespace CorvaneDeblur
