#pragma once

#include "host/photo.h"
#include "host/vipsHandle.h"
#include "tests/support/temporaryFolder.h"

#include <cstdint>
#include <gtest/gtest.h>
#include <string>
#include <vector>

namespace Stillmark
{

/// A kind of picture to make for a test.
struct pictureKind
{
    std::string name; ///< for the test's listing, and of the file
    std::string extension;
    int bands;
    VipsBandFormat format;
    VipsInterpretation meaning;
};

void PrintTo(const pictureKind &kind, std::ostream *out);

/// Tests with a folder of their own, which is gone afterwards.
class hostTest : public ::testing::Test
{
protected:
    hostTest() { startVips(); }

    std::string file(const std::string &name) const { return folder.file(name); }

    /// Saves a picture of seeded noise with libvips, losslessly where the format can. Its path.
    std::string make(const pictureKind &kind, int width, int height) const;
    /// Saves an image by the extension of its name, with libvips' own defaults. Its path.
    std::string save(VipsImage *image, const std::string &name) const;

    /// Nothing but these names is in the folder.
    void expectOnly(std::vector<std::string> names) const;

    TestSupport::temporaryFolder folder;
};

/// Seeded noise; any bits, but floats lie between -0.5 and 1.5.
vipsImage noiseImage(const pictureKind &kind, int width, int height);

using TestSupport::bytesOf;
using TestSupport::writeBytes;

/// All planes of an area, extra ones included, without gaps.
std::vector<std::uint8_t> planesOf(const photo &picture, const rectangle &area);
std::vector<std::uint8_t> planesOf(const photo &picture);

/// The message that opening ends with; empty if it succeeds.
std::string refusal(const std::string &path);

} // namespace Stillmark
