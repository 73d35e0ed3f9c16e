#pragma once

#include <initializer_list>
#include <string>
#include <string_view>

namespace Sarnik
{

/// The text that a user sees for a string of the program. Texts stand in the code as "$$$/Key/Of/It=The text": what
/// follows the first '=' is the default text, which is shown as long as nobody has translated the key. Anything that
/// does not begin with "$$$/" is a text as it stands; a key without '=' has an empty text.
std::string localised(std::string_view keyAndText);

/// The same with parameters: every "^0" becomes the first of them, "^1" the second, up to "^9". Parameters are put in
/// as they are, a "^" within them means nothing; a place without a parameter stays.
std::string localised(std::string_view keyAndText, std::initializer_list<std::string_view> parameters);

} // namespace Sarnik
