#pragma once

#include <cstddef>
#include <string>
#include <string_view>

namespace Platform
{

/// Bytes of the character at the front; 0 where there is none: a zero byte, or bytes that are no UTF-8. The text is not
/// empty.
std::size_t characterLength(std::string_view utf8);

// Of texts that are UTF-8; of others, whatever the bytes look like.
std::size_t characterCount(std::string_view utf8);
/// Bytes of the first `count` characters, or of all where there are fewer.
std::size_t bytesOfCharacters(std::string_view utf8, std::size_t count);
/// Where the character begins that the byte at an offset belongs to; the text's size for the end and what lies behind.
std::size_t characterStart(std::string_view utf8, std::size_t offset);

// Of texts that are UTF-8; bytes that are none do no harm.
std::size_t characterCount(std::string_view utf8);
/// Bytes of the first `count` characters; of all where there are no more.
std::size_t bytesOfCharacters(std::string_view utf8, std::size_t count);
/// Where the character begins that an offset lies in; at most the end.
std::size_t characterStart(std::string_view utf8, std::size_t offset);

/// Any bytes made into UTF-8: zero bytes, and bytes that are none, become U+FFFD.
std::string cleanText(std::string_view utf8);

/// The characters of a text, as cleanText would have it.
std::u32string codePoints(std::string_view utf8);
/// A character as bytes; U+FFFD for what is none.
std::string utf8Of(char32_t character);

} // namespace Platform
