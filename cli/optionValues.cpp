#include "cli/optionValues.h"

#include <array>
#include <charconv>
#include <cmath>
#include <optional>
#include <string_view>
#include <vector>

namespace Stillmark
{
namespace
{

std::string quoted(std::string_view text)
{
    return "'" + std::string(text) + "'";
}

template <typename Number> std::optional<Number> wholeText(std::string_view text)
{
    Number value{};
    const auto [end, error] = std::from_chars(text.data(), text.data() + text.size(), value);
    if (error != std::errc() || end != text.data() + text.size())
        return std::nullopt;
    return value;
}

/// The whole numbers between the commas, or none if there are not `count` of them.
template <std::size_t count> std::optional<std::array<int, count>> commaSeparated(std::string_view text)
{
    std::array<int, count> values{};
    for (std::size_t i = 0; i < count; ++i)
    {
        const auto comma = text.find(',');
        if ((comma == std::string_view::npos) != (i + 1 == count))
            return std::nullopt;
        const auto value = wholeText<int>(text.substr(0, comma));
        if (!value)
            return std::nullopt;
        values[i] = *value;
        text.remove_prefix(comma == std::string_view::npos ? text.size() : comma + 1);
    }
    return values;
}

template <typename Value>
Value oneOf(const std::string &text, const std::vector<std::pair<std::string_view, Value>> &choices)
{
    std::string names;
    for (const auto &[name, value] : choices)
    {
        if (text == name)
            return value;
        names += (names.empty() ? "" : ", ") + std::string(name);
    }
    throw usageError(quoted(text) + " is none of " + names);
}

std::string plain(double value)
{
    std::array<char, 32> text{};
    const auto end = std::to_chars(text.data(), text.data() + text.size(), value).ptr;
    return {text.data(), end};
}

} // namespace

int parseInt(const std::string &text, int least, int most)
{
    const auto value = wholeText<int>(text);
    if (!value || *value < least || *value > most)
        throw usageError(quoted(text) + " is not a whole number from " + std::to_string(least) + " to " +
                         std::to_string(most));
    return *value;
}

double parseReal(const std::string &text, double least, double most)
{
    const auto value = wholeText<double>(text);
    if (!value || !(*value >= least && *value <= most))
        throw usageError(quoted(text) + " is not a number from " + plain(least) + " to " + plain(most));
    return *value;
}

float parsePercent(const std::string &text)
{
    return static_cast<float>(parseReal(text, 0, 100) / 100);
}

int parseBlurSize(const std::string &text)
{
    const auto value = wholeText<int>(text);
    if (!value || *value < smallestBlurSize || *value > largestBlurSize || *value % 2 == 0)
        throw usageError(quoted(text) + " is not an odd number from " + std::to_string(smallestBlurSize) + " to " +
                         std::to_string(largestBlurSize));
    return *value;
}

rectangle parseRectangle(const std::string &text)
{
    const auto v = commaSeparated<4>(text);
    if (!v || (*v)[0] < 0 || (*v)[1] < 0 || (*v)[2] < 1 || (*v)[3] < 1)
        throw usageError(quoted(text) + " is not a rectangle x,y,width,height in pixels");
    return {(*v)[0], (*v)[1], (*v)[2], (*v)[3]};
}

std::pair<int, int> parsePoint(const std::string &text)
{
    const auto v = commaSeparated<2>(text);
    if (!v || (*v)[0] < 0 || (*v)[1] < 0)
        throw usageError(quoted(text) + " is not a point x,y in pixels");
    return {(*v)[0], (*v)[1]};
}

std::pair<int, int> parseSize(const std::string &text)
{
    const std::size_t cross = text.find('x');
    if (cross == std::string::npos)
        throw usageError("'" + text + "' is no size (WxH)");
    return {parseInt(text.substr(0, cross), 1, 2000000), parseInt(text.substr(cross + 1), 1, 2000000)};
}

std::pair<int, int> parseShard(const std::string &text)
{
    const std::size_t slash = text.find('/');
    if (slash == std::string::npos)
        throw usageError("'" + text + "' is no part of a whole (i/n)");
    const int count = parseInt(text.substr(slash + 1), 1, 100000);
    return {parseInt(text.substr(0, slash), 1, count), count};
}

CorvaneDeblur::noiseMode parseNoiseMode(const std::string &text)
{
    using enum CorvaneDeblur::noiseMode;
    return oneOf<CorvaneDeblur::noiseMode>(text,
                                           {{"auto", automatic}, {"low", low}, {"medium", medium}, {"high", high}});
}

CorvaneDeblur::deconvolutionMethod parseMethod(const std::string &text)
{
    using enum CorvaneDeblur::deconvolutionMethod;
    return oneOf<CorvaneDeblur::deconvolutionMethod>(text, {{"wiener", wiener}, {"classic", classic}, {"fast", fast}});
}

} // namespace Stillmark
