#pragma once

#include <cstdint>
#include <memory>
#include <vector>

namespace Stillmark
{

/// CMYK to sRGB in place, on pixels of four samples as the plug-in's interface has them: the largest value is no ink.
/// By a photo's ICC profile (relative colorimetric with black point compensation), or, without one and where it is no
/// usable CMYK profile, plainly as the product of what ink and black let through, R = C * K, which knows nothing of
/// real inks. The fourth sample stays as it is. Any threads at once.
class colourConverter
{
public:
    /// The bytes may be anything.
    explicit colourConverter(const std::vector<std::uint8_t> &profile = {});
    colourConverter(colourConverter &&) noexcept;
    colourConverter &operator=(colourConverter &&) noexcept;
    ~colourConverter();

    bool usesProfile() const { return transforms != nullptr; }

    void cmykToRgb(std::uint8_t *quads, std::uint64_t pixels) const;
    void cmykToRgb(std::uint16_t *quads, std::uint64_t pixels) const; ///< 0..32768; what is beyond counts as 32768

private:
    struct profileTransforms;
    std::unique_ptr<const profileTransforms> transforms;
};

} // namespace Stillmark
