#include "host/document/colourConverter.h"

#include <algorithm>
#include <array>
#include <lcms2.h>
#include <limits>

namespace Stillmark
{
namespace
{

struct freeContext
{
    void operator()(void *context) const { cmsDeleteContext(static_cast<cmsContext>(context)); }
};
struct freeProfile
{
    void operator()(void *profile) const { cmsCloseProfile(profile); }
};
struct freeTransform
{
    void operator()(void *transform) const { cmsDeleteTransform(transform); }
};
template <typename Free> using owned = std::unique_ptr<void, Free>;

constexpr std::uint32_t largest16 = 32768;

std::uint16_t toFullRange(std::uint16_t sample)
{
    const std::uint32_t s = std::min<std::uint32_t>(sample, largest16);
    return static_cast<std::uint16_t>((s * 65535 + largest16 / 2) / largest16);
}

template <typename Sample> void plainly(Sample *quads, std::uint64_t pixels, std::uint32_t largest)
{
    for (std::uint64_t i = 0; i < pixels; ++i, quads += 4)
    {
        const std::uint32_t black = std::min<std::uint32_t>(quads[3], largest);
        for (int c = 0; c < 3; ++c)
            quads[c] =
                static_cast<Sample>((std::min<std::uint32_t>(quads[c], largest) * black + largest / 2) / largest);
    }
}

} // namespace

/// The library's conversions for both depths. Without its one-pixel cache they may be used by several threads.
struct colourConverter::profileTransforms
{
    owned<freeContext> context; ///< outlives the rest
    owned<freeTransform> of8, of16;

    /// Null if the bytes are no profile of CMYK that the library can work with.
    static std::unique_ptr<const profileTransforms> make(const std::vector<std::uint8_t> &bytes)
    {
        if (bytes.empty() || bytes.size() > std::numeric_limits<cmsUInt32Number>::max())
            return nullptr;
        auto made = std::make_unique<profileTransforms>();
        made->context.reset(cmsCreateContext(nullptr, nullptr));
        const auto context = static_cast<cmsContext>(made->context.get());
        if (!context)
            return nullptr;
        const owned<freeProfile> from(
            cmsOpenProfileFromMemTHR(context, bytes.data(), static_cast<cmsUInt32Number>(bytes.size())));
        if (!from || cmsGetColorSpace(from.get()) != cmsSigCmykData)
            return nullptr;
        const owned<freeProfile> to(cmsCreate_sRGBProfileTHR(context));
        if (!to)
            return nullptr;

        // The interface's samples say how much light is left, the library's "reverse" flavour of CMYK.
        const auto transform = [&](int bytesEach) {
            const cmsUInt32Number input = COLORSPACE_SH(PT_CMYK) | CHANNELS_SH(4) | BYTES_SH(bytesEach) | FLAVOR_SH(1);
            const cmsUInt32Number output = COLORSPACE_SH(PT_RGB) | CHANNELS_SH(3) | EXTRA_SH(1) | BYTES_SH(bytesEach);
            return cmsCreateTransformTHR(context, from.get(), input, to.get(), output, INTENT_RELATIVE_COLORIMETRIC,
                                         cmsFLAGS_NOCACHE | cmsFLAGS_BLACKPOINTCOMPENSATION);
        };
        made->of8.reset(transform(1));
        made->of16.reset(transform(2));
        return made->of8 && made->of16 ? std::move(made) : nullptr;
    }
};

colourConverter::colourConverter(const std::vector<std::uint8_t> &profile)
    : transforms(profileTransforms::make(profile))
{
}

colourConverter::colourConverter(colourConverter &&) noexcept = default;
colourConverter &colourConverter::operator=(colourConverter &&) noexcept = default;
colourConverter::~colourConverter() = default;

void colourConverter::cmykToRgb(std::uint8_t *quads, std::uint64_t pixels) const
{
    if (!transforms)
        return plainly(quads, pixels, 255);
    for (std::uint64_t done = 0; done < pixels;) // the library counts in 32 bits
    {
        const auto count = static_cast<cmsUInt32Number>(std::min<std::uint64_t>(pixels - done, 1 << 20));
        cmsDoTransform(transforms->of8.get(), quads + done * 4, quads + done * 4, count);
        done += count;
    }
}

void colourConverter::cmykToRgb(std::uint16_t *quads, std::uint64_t pixels) const
{
    if (!transforms)
        return plainly(quads, pixels, largest16);
    constexpr std::uint64_t atOnce = 512;
    std::array<std::uint16_t, atOnce * 4> block;
    for (std::uint64_t done = 0; done < pixels; done += atOnce)
    {
        const std::uint64_t count = std::min(pixels - done, atOnce);
        std::uint16_t *const samples = quads + done * 4;
        std::transform(samples, samples + count * 4, block.begin(), toFullRange);
        cmsDoTransform(transforms->of16.get(), block.data(), block.data(), static_cast<cmsUInt32Number>(count));
        for (std::uint64_t i = 0; i < count * 4; ++i)
            if (i % 4 != 3)
                samples[i] = static_cast<std::uint16_t>((block[i] + 1) >> 1);
    }
}

} // namespace Stillmark
