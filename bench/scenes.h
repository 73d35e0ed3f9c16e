#pragma once

#include "deblur/deconv/cellRenderer.h"
#include "deblur/estimate/floatArray.h"

#include <cstddef>
#include <mutex>
#include <vector>

/// Made-up photographs, the same for the same seed: speed depends on the picture where gradients are skipped or
/// selected, so noise or a flat field would not do.
namespace Bench
{

/// A sharp scene in 0..1, one array a colour plane: opaque leaves on top of one another, their radii spread as 1 / r^3,
/// which gives the statistics of natural pictures at every scale (A. Lee, D. Mumford and J. Huang, "Occlusion models
/// for natural images", Int. J. Computer Vision 41, 2001); each leaf shaded and with a 1/f texture.
std::vector<CorvaneDeblur::floatArray> naturalScene(int rows, int cols, int planes, unsigned seed);

/// naturalScene through the path of a shaken hand of at most size x size pixels, with noise of one 8-bit level.
std::vector<CorvaneDeblur::floatArray> shakenScene(int rows, int cols, int planes, int size, unsigned seed);

/// The kernel in shakenScene of the same size and seed.
CorvaneDeblur::floatArray shake(int size, unsigned seed);

/// A photograph in memory, planar, 8 bits a sample.
class memoryPhoto final : public CorvaneDeblur::planeReader, public CorvaneDeblur::planeWriter
{
public:
    memoryPhoto(int photoCols, int photoRows, int photoPlanes);
    explicit memoryPhoto(const std::vector<CorvaneDeblur::floatArray> &planes);

    void read(const CorvaneDeblur::pixelRect &area, std::byte *planes, std::ptrdiff_t rowBytes) override;
    void write(const CorvaneDeblur::pixelRect &area, const std::byte *planes, std::ptrdiff_t rowBytes) override;

    /// The areas read since the last call.
    std::vector<CorvaneDeblur::pixelRect> takeReads();

    const int cols, rows, planes;
    double pixels() const { return static_cast<double>(cols) * rows; }
    std::byte *data() { return samples.data(); }

private:
    std::byte *at(int plane, int y, int x)
    {
        return samples.data() + (static_cast<std::ptrdiff_t>(plane) * rows + y) * cols + x;
    }

    std::vector<std::byte> samples;
    std::mutex lock; ///< guards reads
    std::vector<CorvaneDeblur::pixelRect> reads;
};

} // namespace Bench
