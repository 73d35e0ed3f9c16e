#pragma once

#include <initializer_list>
#include <string>
#include <string_view>

namespace Sarnik
{

/// The text that a user sees for a string of the program. Texts stand in the code as "$$$/Key/Of/It=The text": what
/// follows the first '=' is the default text, which is shown unless the CStringTable has another one for the key.
/// Anything that does not begin with "$$$" is a text as it stands; a key without '=' has an empty default.
///
/// In such a text "^" and a sign stand for a character that is hard to write there: "^n" a new line, "^]" a closing
/// quotation mark, "^+20AC" the UTF-16 unit of that hexadecimal number, "^^" the "^" itself (localisedString.cpp has
/// all of them). "^0" to "^9" are places for parameters and stay. So does a "^" before any other sign.
std::string Localize(std::string_view keyAndText);

/// The same with parameters: every "^0" becomes the first of them, "^1" the second, up to "^9". Parameters are put in
/// as they are, a "^" within them means nothing; a place without a parameter stays.
std::string Localize(std::string_view keyAndText, std::initializer_list<std::string_view> parameters);

/// Puts a parameter into every place of that number, 0 to 9, in a text that is localised already. Where a value may
/// hold a "^" itself, the function above is the safe one.
void ReplaceParam(std::string &text, int index, std::string_view value);

} // namespace Sarnik
