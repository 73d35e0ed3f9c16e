#pragma once

#include <cstddef>
#include <cstdint>

namespace Stillmark
{

/// How a picture's codes lie in a document; hostDocument tells the values.
struct sampleForm
{
    int depth = 8;         ///< 8, 16 or 32
    bool inverted = false; ///< the largest sample stands for the code 0; not with 32
};

// A row of n samples between packed codes and a plug-in's memory, whose samples lie columnBytes apart. No pointer need
// be aligned.

void samplesFromCodes(const sampleForm &form, std::size_t n, const std::byte *codes, std::byte *samples,
                      std::size_t columnBytes);

/// was: the picture's codes of these pixels; not looked at, and may be null, for 8 and 32 bits without weights.
/// weights: blends, 0 leaves the code as it was and 255 takes the sample; null takes all the samples.
void codesFromSamples(const sampleForm &form, std::size_t n, const std::byte *samples, std::size_t columnBytes,
                      const std::byte *was, const std::uint8_t *weights, std::byte *codes);

/// Whether codesFromSamples looks at the picture's codes.
inline bool needsOldCodes(const sampleForm &form, bool weighted)
{
    return form.depth == 16 || weighted;
}

} // namespace Stillmark
