#include "platform/keys.h"

namespace Platform
{
namespace
{

struct sign
{
    key k;
    char32_t character;
    std::string_view name;
};

constexpr sign signs[] = {
    {key::space, ' ', "Space"},
    {key::backspace, 8, "Backspace"},
    {key::tab, 9, "Tab"},
    {key::enter, 13, "Enter"},
    {key::escape, 27, "Esc"},
    {key::minus, '-', "-"},
    {key::equals, '=', "="},
    {key::leftBracket, '[', "["},
    {key::rightBracket, ']', "]"},
    {key::semicolon, ';', ";"},
    {key::quote, '\'', "'"},
    {key::comma, ',', ","},
    {key::period, '.', "."},
    {key::slash, '/', "/"},
    {key::backslash, '\\', "\\"},
    {key::grave, '`', "`"},
    {key::plus, '+', "+"},
    {key::left, 0, "Left"},
    {key::right, 0, "Right"},
    {key::up, 0, "Up"},
    {key::down, 0, "Down"},
    {key::home, 0, "Home"},
    {key::end, 0, "End"},
    {key::pageUp, 0, "PgUp"},
    {key::pageDown, 0, "PgDn"},
    {key::insert, 0, "Ins"},
    {key::del, 127, "Del"},
    {key::menu, 0, "Menu"},
    {key::keypadPlus, '+', "Num +"},
    {key::keypadMinus, '-', "Num -"},
    {key::keypadTimes, '*', "Num *"},
    {key::keypadDivide, '/', "Num /"},
    {key::keypadPoint, '.', "Num ."},
    {key::keypadEnter, 13, "Enter"},
};

constexpr std::string_view letters = "ABCDEFGHIJKLMNOPQRSTUVWXYZ", digits = "0123456789";
constexpr std::string_view functions[] = {"F1",  "F2",  "F3",  "F4",  "F5",  "F6",  "F7",  "F8",
                                          "F9",  "F10", "F11", "F12", "F13", "F14", "F15", "F16",
                                          "F17", "F18", "F19", "F20", "F21", "F22", "F23", "F24"};

/// How far a key lies into a run of keys; -1 outside.
int within(key k, key first, key last)
{
    return k >= first && k <= last ? static_cast<int>(k) - static_cast<int>(first) : -1;
}

key plus(key first, char32_t n)
{
    return static_cast<key>(static_cast<char32_t>(first) + n);
}

} // namespace

key keyOf(char32_t character)
{
    if (character >= 'a' && character <= 'z')
        return plus(key::a, character - 'a');
    if (character >= 'A' && character <= 'Z')
        return plus(key::a, character - 'A');
    if (character >= '0' && character <= '9')
        return plus(key::digit0, character - '0');
    for (const sign &s : signs)
        if (s.character != 0 && s.character == character)
            return s.k;
    return key::none;
}

char32_t characterOf(key k)
{
    if (const int n = within(k, key::a, key::z); n >= 0)
        return U'a' + static_cast<char32_t>(n);
    for (const key zero : {key::digit0, key::keypad0})
        if (const int n = within(k, zero, plus(zero, 9)); n >= 0)
            return U'0' + static_cast<char32_t>(n);
    for (const sign &s : signs)
        if (s.k == k)
            return s.character;
    return 0;
}

std::string_view keyName(key k)
{
    if (const int n = within(k, key::a, key::z); n >= 0)
        return letters.substr(static_cast<std::size_t>(n), 1);
    for (const key zero : {key::digit0, key::keypad0})
        if (const int n = within(k, zero, plus(zero, 9)); n >= 0)
            return digits.substr(static_cast<std::size_t>(n), 1);
    if (const int n = within(k, key::f1, key::f24); n >= 0)
        return functions[n];
    for (const sign &s : signs)
        if (s.k == k)
            return s.name;
    return {};
}

} // namespace Platform
