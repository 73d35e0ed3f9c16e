#pragma once

#include <cstdint>
#include <string_view>

namespace Platform
{

/// Keys by what they mean, not by where they lie. The numbers are kept in shortcuts: they never change.
enum class key : std::uint8_t
{
    none = 0,
    space = 1,
    backspace = 2,
    tab = 3,
    enter = 4,
    escape = 5,
    a = 10, // and the other letters up to
    z = 35,
    digit0 = 40, // and the other digits up to
    digit9 = 49,
    f1 = 50, // and the others up to
    f24 = 73,
    minus = 80,
    equals = 81,
    leftBracket = 82,
    rightBracket = 83,
    semicolon = 84,
    quote = 85,
    comma = 86,
    period = 87,
    slash = 88,
    backslash = 89,
    grave = 90,
    plus = 91,
    left = 120,
    right = 121,
    up = 122,
    down = 123,
    home = 124,
    end = 125,
    pageUp = 126,
    pageDown = 127,
    insert = 130,
    del = 131,
    menu = 132,
    keypad0 = 140, // and the other digits up to
    keypad9 = 149,
    keypadPlus = 150,
    keypadMinus = 151,
    keypadTimes = 152,
    keypadDivide = 153,
    keypadPoint = 154,
    keypadEnter = 167
};

/// Of a letter of either case, a digit or a sign that has a key of its own; none for others.
key keyOf(char32_t character);
/// What the key writes without modifiers; 0 for those that write nothing.
char32_t characterOf(key k);
/// As a menu shows it: "S", "F5", "Del".
std::string_view keyName(key k);

/// Modifiers as bits of a word; bit 0 is not used.
enum modifier : std::uint32_t
{
    altModifier = 1u << 1,
    ctrlModifier = 1u << 2,
    shiftModifier = 1u << 3
};

} // namespace Platform
