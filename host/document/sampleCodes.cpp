#include "host/document/sampleCodes.h"

#include <algorithm>
#include <cstring>

namespace Stillmark
{
namespace
{

template <typename Sample> Sample load(const std::byte *from)
{
    Sample sample;
    std::memcpy(&sample, from, sizeof sample);
    return sample;
}

template <typename Sample> void store(std::byte *to, Sample sample)
{
    std::memcpy(to, &sample, sizeof sample);
}

struct bytes
{
    using sample = std::uint8_t;
    sample turn; ///< 255 where the form is inverted

    sample fromCode(sample code) const { return code ^ turn; }
    sample toCode(sample value, sample) const { return value ^ turn; }
    static sample blend(sample old, sample value, int weight)
    {
        return static_cast<sample>((value * weight + old * (255 - weight) + 127) / 255);
    }
};

struct shorts
{
    using sample = std::uint16_t;
    static constexpr sample largest = 32768, middle = 16384;
    sample turn; ///< 65535 where the form is inverted

    sample fromCode(sample code) const
    {
        const sample c = code ^ turn;
        return static_cast<sample>((c >> 1) + (c & 1));
    }
    sample toCode(sample value, sample was) const
    {
        const sample v = std::min(value, largest);
        const auto nearest = static_cast<sample>(2 * v - (v > middle ? 1 : 0));
        return v == fromCode(was) ? was : static_cast<sample>(nearest ^ turn);
    }
    static sample blend(sample old, sample value, int weight)
    {
        return static_cast<sample>((std::min(value, largest) * weight + old * (255 - weight) + 127) / 255);
    }
};

struct floats
{
    using sample = std::uint32_t; ///< the bits: a signalling NaN passes unchanged too

    sample fromCode(sample code) const { return code; }
    sample toCode(sample value, sample) const { return value; }
    static sample blend(sample old, sample value, int weight)
    {
        if (weight == 0 || weight == 255)
            return weight == 0 ? old : value;
        float from, to;
        std::memcpy(&from, &old, sizeof from);
        std::memcpy(&to, &value, sizeof to);
        const float mixed = from + (to - from) * (static_cast<float>(weight) / 255);
        sample result;
        std::memcpy(&result, &mixed, sizeof result);
        return result;
    }
};

template <typename Form>
void toSamples(Form form, std::size_t n, const std::byte *codes, std::byte *samples, std::size_t columnBytes)
{
    using sample = typename Form::sample;
    for (std::size_t i = 0; i < n; ++i)
        store(samples + i * columnBytes, form.fromCode(load<sample>(codes + i * sizeof(sample))));
}

template <typename Form>
void toCodes(Form form, std::size_t n, const std::byte *samples, std::size_t columnBytes, const std::byte *was,
             std::byte *codes)
{
    using sample = typename Form::sample;
    for (std::size_t i = 0; i < n; ++i)
    {
        const auto value = load<sample>(samples + i * columnBytes);
        const sample old = was ? load<sample>(was + i * sizeof(sample)) : sample{};
        store(codes + i * sizeof(sample), form.toCode(value, old));
    }
}

template <typename Form>
void toBlendedCodes(Form form, std::size_t n, const std::byte *samples, std::size_t columnBytes, const std::byte *was,
                    const std::uint8_t *weights, std::byte *codes)
{
    using sample = typename Form::sample;
    for (std::size_t i = 0; i < n; ++i)
    {
        const auto value = load<sample>(samples + i * columnBytes);
        const auto old = load<sample>(was + i * sizeof(sample));
        store(codes + i * sizeof(sample), form.toCode(Form::blend(form.fromCode(old), value, weights[i]), old));
    }
}

/// Calls use with the form; packed samples get a loop of their own, which vectorises.
template <typename Use> void withForm(const sampleForm &form, const Use &use)
{
    if (form.depth == 8)
        use(bytes{static_cast<std::uint8_t>(form.inverted ? 0xff : 0)});
    else if (form.depth == 16)
        use(shorts{static_cast<std::uint16_t>(form.inverted ? 0xffff : 0)});
    else
        use(floats{});
}

} // namespace

void samplesFromCodes(const sampleForm &form, std::size_t n, const std::byte *codes, std::byte *samples,
                      std::size_t columnBytes)
{
    const std::size_t bytesEach = static_cast<std::size_t>(form.depth / 8);
    if (columnBytes == bytesEach && form.depth != 16 && !form.inverted)
    {
        std::memcpy(samples, codes, n * bytesEach);
        return;
    }
    withForm(form, [&](auto each) {
        constexpr std::size_t packed = sizeof(typename decltype(each)::sample);
        if (columnBytes == packed)
            toSamples(each, n, codes, samples, packed);
        else
            toSamples(each, n, codes, samples, columnBytes);
    });
}

void codesFromSamples(const sampleForm &form, std::size_t n, const std::byte *samples, std::size_t columnBytes,
                      const std::byte *was, const std::uint8_t *weights, std::byte *codes)
{
    withForm(form, [&](auto each) {
        constexpr std::size_t packed = sizeof(typename decltype(each)::sample);
        if (weights)
            toBlendedCodes(each, n, samples, columnBytes, was, weights, codes);
        else if (columnBytes == packed)
            toCodes(each, n, samples, packed, was, codes);
        else
            toCodes(each, n, samples, columnBytes, was, codes);
    });
}

} // namespace Stillmark
