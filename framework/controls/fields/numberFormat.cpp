#include "framework/controls/fields/numberFormat.h"

#include <algorithm>
#include <charconv>
#include <cmath>

namespace Sarnik
{
namespace
{

constexpr std::string_view minusSign = "\xE2\x88\x92";

double powerOfTen(std::int32_t exponent)
{
    double result = 1;
    for (std::int32_t i = 0; i < exponent; ++i)
        result *= 10;
    return result;
}

} // namespace

double CNumberFormat::Quantum() const
{
    return HasFraction() ? 1 / powerOfTen(std::clamp(decimals, 0, 9)) : 1;
}

double CNumberFormat::Rounded(double value) const
{
    if (std::isnan(value))
        return 0;
    value = std::clamp(value, -largest, largest);
    const double scale = HasFraction() ? powerOfTen(std::clamp(decimals, 0, 9)) : 1;
    const double scaled = value * scale;
    // Larger ones have no digits to lose.
    return std::abs(scaled) < 4e15 ? std::round(scaled) / scale + 0.0 : value;
}

std::string CNumberFormat::Text(double value) const
{
    value = Rounded(value);
    char buffer[64];
    const int places = HasFraction() ? std::clamp(decimals, 0, 9) : 0;
    const auto end = std::to_chars(buffer, buffer + sizeof buffer, std::abs(value), std::chars_format::fixed, places);
    std::string text(buffer, end.ptr);
    if (places > 0 && (bits & kNumber_FixedDecimal) == 0)
    {
        text.erase(text.find_last_not_of('0') + 1);
        if (text.back() == '.')
            text.pop_back();
    }
    const auto whole = static_cast<std::int32_t>(std::min(text.find('.'), text.size()));
    if ((bits & kNumber_PadInteger) != 0 && whole < std::min(digits, 20))
        text.insert(0, static_cast<std::size_t>(std::min(digits, 20) - whole), '0');
    if (value < 0)
        text.insert(0, "-");
    else if (value > 0 && (bits & kNumber_ShowPlus) != 0)
        text.insert(0, "+");
    return text;
}

std::string CNumberFormat::Filtered(std::string_view utf8)
{
    std::string result;
    for (std::size_t i = 0; i < utf8.size(); ++i)
        if (utf8.substr(i).starts_with(minusSign))
        {
            result += minusSign;
            i += minusSign.size() - 1;
        }
        else if ((utf8[i] >= '0' && utf8[i] <= '9') ||
                 std::string_view("+-., ").find(utf8[i]) != std::string_view::npos)
            result += utf8[i];
    return result;
}

std::optional<double> CNumberFormat::Parse(std::string_view utf8)
{
    const auto isSpace = [](char c) { return static_cast<unsigned char>(c) <= ' '; };
    while (!utf8.empty() && isSpace(utf8.front()))
        utf8.remove_prefix(1);
    while (!utf8.empty() && isSpace(utf8.back()))
        utf8.remove_suffix(1);
    std::string plain(utf8);
    bool negative = false;
    if (plain.starts_with(minusSign))
        plain.replace(0, minusSign.size(), "-");
    if (!plain.empty() && (plain[0] == '+' || plain[0] == '-'))
    {
        negative = plain[0] == '-';
        plain.erase(0, 1);
    }
    if (std::count_if(plain.begin(), plain.end(), [](char c) { return c == '.' || c == ','; }) > 1)
        return std::nullopt;
    std::replace(plain.begin(), plain.end(), ',', '.');
    // Neither "inf" nor a second sign.
    if (plain.empty() || plain.find_first_not_of("0123456789.") != std::string::npos)
        return std::nullopt;
    double value = 0;
    const auto [end, failure] =
        std::from_chars(plain.data(), plain.data() + plain.size(), value, std::chars_format::fixed);
    if (end != plain.data() + plain.size())
        return std::nullopt;
    if (failure == std::errc::result_out_of_range)
        value = plain[0] == '0' || plain[0] == '.' ? 0 : largest;
    else if (failure != std::errc())
        return std::nullopt;
    value = std::min(value, largest);
    return negative ? -value + 0.0 : value;
}

double CNumberRange::Wrapped(double value) const
{
    const double length = Length();
    if (Contains(value) || !(length > 0) || !std::isfinite(value))
        return Cut(value);
    const double beyond = std::fmod(value - least, length);
    return Cut(least + (beyond < 0 ? beyond + length : beyond));
}

} // namespace Sarnik
