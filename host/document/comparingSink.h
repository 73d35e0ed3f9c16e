#pragma once

#include "host/document/pictureResult.h"

#include <cstdint>

namespace Stillmark
{

/// Keeps nothing of a result: compares it with the source while it comes in. For pictures too large to be kept.
class comparingSink final : public pictureResult
{
public:
    /// The source may be the document's own.
    explicit comparingSink(pictureSource &like) : source(like) {}

    void write(int plane, const rectangle &area, const planeSamples &codes) override;

    std::uint64_t samplesWritten() const { return written; } ///< as often as they came
    std::uint64_t samplesDiffering() const { return differing; }
    /// Written pixels, if the planes were written alike: samples of the first plane.
    std::uint64_t pixelsWritten() const { return pixels; }

private:
    pictureSource &source;
    std::uint64_t written = 0, differing = 0, pixels = 0;
};

} // namespace Stillmark
