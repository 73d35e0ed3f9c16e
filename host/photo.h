#pragma once

#include "platform/error.h"

#include <cstddef>
#include <cstdint>
#include <functional>
#include <memory>
#include <string>
#include <vector>

namespace Stillmark
{

/// In pixels, from the top left corner of the picture.
struct rectangle
{
    int x = 0, y = 0, width = 0, height = 0;
};

/// What the colour planes of a photo mean. 8 and 16-bit samples are codes from 0 to 255 or 65535; 32-bit ones are
/// floats where 0 to 1 is black to white, though any value may occur, NaN and infinity too.
enum class colourMode
{
    grey, ///< one plane
    rgb,  ///< red, green, blue
    cmyk, ///< cyan, magenta, yellow, black; 0 is no ink; 8 or 16 bits
    lab   ///< L* from 0 (0) to 100 (full code); a* and b* offset by half the codes (128 or 32768); 8 or 16 bits
};

/// Called now and then during long work with the part that is done, 0 to 1. Returning false stops the work, which then
/// throws Platform::cancelled. May come from another thread than the caller's, but only one call at a time.
using progressCheck = std::function<bool(double done)>;

/// The number of threads the picture library may use; 0 for one per core. Before the first photo is opened.
void setPhotoThreads(int count);

/// An opened photograph: its samples, readable by region, and everything else of the file that a result must carry on.
///
/// Reads JPEG, PNG, TIFF, WebP, HEIF and AVIF (where the picture library was built with them) and portable float maps
/// (.pfm), told apart by content. The picture is stored as in the file: an orientation tag is kept as metadata, not
/// applied. Palettes and less than 8 bits arrive as 8; CMYK and Lab floats as 16. Of a file of several pages the first
/// is read.
///
/// Opening decodes the whole file, once, in memory up to 256 MB and in a scratch file on disk beyond, so that
/// afterwards any region is read in any order. A photo is a handle: copies share the picture. Safe from any thread.
class photo
{
public:
    /// Throws Platform::fileError with one line that names the file and the cause: it is missing, a folder, empty, no
    /// picture, of an unsupported kind, cut short or damaged, too large. Throws Platform::cancelled.
    static photo open(const std::string &path, const progressCheck &progress = {});

    int width() const;
    int height() const;
    int depth() const; ///< bits of a sample: 8 (uint8), 16 (uint16) or 32 (float)
    int sampleBytes() const { return depth() / 8; }
    colourMode mode() const;
    int colourPlanes() const; ///< 1, 3, 4, 3
    int extraPlanes() const;  ///< planes after the colours: transparency, then further masks; all pass unchanged
    bool hasTransparency() const { return extraPlanes() > 0; }
    const std::string &path() const;

    /// The embedded ICC profile as it stands in the file, which may be anything; empty if there is none.
    std::vector<std::uint8_t> profile() const;

    /// Sentences for the user about what opening could not keep, such as further pages.
    const std::vector<std::string> &notes() const;

    /// Copies area, which must lie within the picture, as planes one after the other: sample (plane p, row r, column c
    /// of the area) goes to byte (p * area.height + r) * rowBytes + c * sampleBytes() of planar. Planes are numbered
    /// colours first; the given range is read, by default all the colours. Throws Platform::fileError if the scratch
    /// file cannot be read.
    void read(const rectangle &area, void *planar, std::size_t rowBytes) const;
    void readPlanes(const rectangle &area, int firstPlane, int planes, void *planar, std::size_t rowBytes) const;

    struct content; ///< the picture library's side, for photoWriter

private:
    friend class photoWriter;
    explicit photo(std::shared_ptr<const content> picture) : opened(std::move(picture)) {}

    std::shared_ptr<const content> opened;
};

} // namespace Stillmark
