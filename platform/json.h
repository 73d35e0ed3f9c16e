#pragma once

#include <concepts>
#include <initializer_list>
#include <string>
#include <string_view>
#include <utility>
#include <vector>

/// JSON values as text; compose them from the inside out.
namespace Platform
{

/// A string. Bytes that are no UTF-8 (file names may hold any) become U+FFFD.
std::string jsonString(std::string_view text);
/// The shortest text that reads back as the same number; null for NaN and infinities, which JSON has not.
std::string jsonNumber(double value);
std::string jsonNumber(float value);
std::string jsonNumber(std::integral auto value)
{
    return std::to_string(value);
}
std::string jsonBool(bool value);
/// values: JSON texts.
std::string jsonArray(const std::vector<std::string> &values);
/// Keys with JSON texts, in the order given.
std::string jsonObject(std::initializer_list<std::pair<std::string_view, std::string>> members);

} // namespace Platform
