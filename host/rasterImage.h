#pragma once

#include "host/sampleRaster.h"
#include "host/vipsHandle.h"

#include <exception>
#include <memory>
#include <mutex>
#include <vector>

namespace Stillmark
{

/// Lets libvips draw the pixels of a raster, converted row by row on the way, so that a picture is saved without ever
/// being in memory as a whole. Must outlive the images it made.
class rasterImage
{
public:
    /// What libvips is to get.
    enum class form
    {
        bytes,    ///< 0..255, rounded from more
        shorts,   ///< 0..65535, rounded from floats
        floats,   ///< as 0..1 from codes
        labBytes, ///< libvips' Lab of 8 bits, from 8-bit codes
        labShorts ///< libvips' Lab of 16 bits, from 16-bit codes
    };

    /// progress is called while pixels are drawn; when it returns false drawing fails.
    rasterImage(const sampleRaster &pixels, const progressCheck &progress);
    rasterImage(const rasterImage &) = delete;
    rasterImage &operator=(const rasterImage &) = delete;
    ~rasterImage();

    /// An image of `planes` planes from `first` on. Throws std::runtime_error if libvips cannot make one.
    vipsImage make(int first, int planes, form samples, VipsInterpretation meaning);

    /// Throws what stopped the drawing, Platform::cancelled among others; nothing if it was not stopped here.
    void rethrow() const;

private:
    struct view;

    static int draw(VipsRegion *region, void *sequence, void *image, void *picture, gboolean *stop) noexcept;
    void drawArea(VipsRegion *region, const view &what);
    void advance(const VipsRect &area);

    const sampleRaster &raster;
    const progressCheck &report;
    std::vector<std::unique_ptr<view>> views;
    mutable std::mutex lock; ///< guards the rest, and calls of report
    std::exception_ptr failure;
    double drawn = 0;
};

} // namespace Stillmark
