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
    a = 10,
    b,
    c,
    d,
    e,
    f,
    g,
    h,
    i,
    j,
    k,
    l,
    m,
    n,
    o,
    p,
    q,
    r,
    s,
    t,
    u,
    v,
    w,
    x,
    y,
    z = 35,
    digit0 = 40,
    digit1,
    digit2,
    digit3,
    digit4,
    digit5,
    digit6,
    digit7,
    digit8,
    digit9,
    f1 = 50,
    f2,
    f3,
    f4,
    f5,
    f6,
    f7,
    f8,
    f9,
    f10,
    f11,
    f12,
    f13,
    f14,
    f15,
    f16,
    f17,
    f18,
    f19,
    f20,
    f21,
    f22,
    f23,
    f24,
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
    keypad0 = 140,
    keypad1,
    keypad2,
    keypad3,
    keypad4,
    keypad5,
    keypad6,
    keypad7,
    keypad8,
    keypad9,
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
