#pragma once

#include <cstddef>
#include <string>
#include <string_view>

namespace Platform
{

/// Bytes of the character at the front; 0 where there is none: a zero byte, or bytes that are no UTF-8. The text is not
/// empty.
std::size_t characterLength(std::string_view utf8);

/// Any bytes made into UTF-8: zero bytes, and bytes that are none, become U+FFFD.
std::string cleanText(std::string_view utf8);

/// The characters of a text, as cleanText would have it.
std::u32string codePoints(std::string_view utf8);
/// A character as bytes; U+FFFD for what is none.
std::string utf8Of(char32_t character);

} // namespace Platform
