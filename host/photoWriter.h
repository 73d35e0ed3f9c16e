#pragma once

#include "host/photo.h"

#include <memory>
#include <string>
#include <vector>

namespace Stillmark
{

/// Receives a result rectangle by rectangle and saves it as a new version of a photo: same size, depth, colour mode,
/// profile, EXIF (orientation included), XMP, IPTC, resolution, and, where it is not replaced, the model's
/// transparency.
///
/// The extension of the file name chooses the format: .jpg .jpeg (quality 95, no colour subsampling), .png, .tif .tiff
/// (LZW or deflate), .webp (quality 95) and .pfm (floats, 0 to 1). Where a format cannot hold what the photo has,
/// commit() converts: samples are rounded to the depth that fits, CMYK and Lab become sRGB, transparency is laid over
/// white; notes() says so, and what metadata is lost. What has been received is kept in memory up to 256 MB, in a
/// scratch file beyond.
class photoWriter
{
public:
    /// Throws Platform::fileError if the extension is unknown, the folder is missing or refuses new files, or path is
    /// something else than a file. To be called before any work is put into a result.
    static void check(const std::string &path);

    /// Checks path as above, and that the format takes a picture of the model's size.
    photoWriter(const photo &model, const std::string &path);
    photoWriter(const photoWriter &) = delete;
    photoWriter &operator=(const photoWriter &) = delete;
    ~photoWriter();

    /// What saving will have to change, one plain sentence each, known from the beginning.
    const std::vector<std::string> &notes() const;

    /// Takes the colour planes of area, laid out as photo::read gives them. Every pixel is to be written exactly once,
    /// in any order; several threads may write at once.
    void write(const rectangle &area, const void *planar, std::size_t rowBytes);

    /// Another way to fill a result: takes all pixels from the model, after which planes of it, extra ones too, may be
    /// replaced, in any order and again. One thread at a time; not together with write.
    void takeModelPixels();
    void replacePlane(int plane, const rectangle &area, const void *samples, std::size_t rowBytes);

    /// Saves beside the target and renames into place; may be called once, after all pixels were written
    /// (std::logic_error if some are missing). When it throws Platform::fileError or Platform::cancelled the old file
    /// is untouched and nothing is left behind. Cancelling takes effect within a fraction of a second, except in WebP,
    /// which libvips encodes in one go once it has all the pixels.
    void commit(const progressCheck &progress = {});

private:
    struct state;
    std::unique_ptr<state> s;
};

} // namespace Stillmark
