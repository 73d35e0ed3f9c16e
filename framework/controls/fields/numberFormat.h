#pragma once

#include <cstdint>
#include <optional>
#include <string>
#include <string_view>

namespace Sarnik
{

/// How a number is written; values are those of kNumber_... in layouts.
enum ENumberFormat : std::uint32_t
{
    kNumber_Integer = 0,
    kNumber_Decimal = 1,      ///< with a fraction, without zeros at its end
    kNumber_FixedDecimal = 2, ///< with a fraction, always of the same length
    kNumber_PadInteger = 4,   ///< zeros in front, up to `digits`
    kNumber_ShowPlus = 8,     ///< a sign before positive numbers
    kNumber_WrapAround = 16   ///< values beyond an end of the range come in again at the other
};

/// Numbers as text, the same in all languages: a point before the fraction, no exponents.
struct CNumberFormat
{
    /// Beyond them a number is cut: as many digits as a double holds.
    static constexpr double largest = 1e15;

    std::uint32_t bits = kNumber_Integer;
    std::int32_t decimals = 1; ///< digits of a fraction, 0 to 9
    std::int32_t digits = 0;   ///< of a padded integer

    bool HasFraction() const { return (bits & (kNumber_Decimal | kNumber_FixedDecimal)) != 0; }
    bool Wraps() const { return (bits & kNumber_WrapAround) != 0; }
    /// The distance of neighbours among the numbers that can be written.
    double Quantum() const;
    /// The nearest number that can be written; 0 for what is no number.
    double Rounded(double value) const;
    /// What is no number is written as 0.
    std::string Text(double value) const;
    /// Spaces around it, a leading plus, the real minus sign and a comma in the place of the point are understood.
    /// Nothing for what is no number.
    static std::optional<double> Parse(std::string_view utf8);
    /// The characters of a text that a number may have.
    static std::string Filtered(std::string_view utf8);
};

/// What numbers are allowed.
struct CNumberRange
{
    double least = -CNumberFormat::largest, most = CNumberFormat::largest;

    bool Contains(double value) const { return value >= least && value <= most; }
    double Length() const { return most - least; }
    double Cut(double value) const { return !(value >= least) ? least : value > most ? most : value; }
    /// An end stands for itself; what is beyond comes in again at the other end.
    double Wrapped(double value) const;
};

} // namespace Sarnik
