#pragma once

#include <cstddef>
#include <functional>
#include <string>

namespace Sarnik
{

/// Finds entries of a list by the first letters of their texts, as they are typed. Letters that follow within a second
/// make one word; one letter again and again goes through all entries that begin with it.
class CTypeAhead
{
public:
    static constexpr double pause = 1; ///< seconds
    static constexpr std::size_t none = static_cast<std::size_t>(-1);

    /// The entry to go to after `typed`, from the one that is current (none for none) on and around the end. An entry
    /// that cannot be chosen has an empty text.
    std::size_t Find(char32_t typed, std::size_t count, std::size_t current,
                     const std::function<std::string(std::size_t)> &textOf);
    /// Whether letters have been typed so shortly before that a space is one of them.
    bool IsUnderWay() const;

private:
    std::u32string word;
    double last = -pause;
};

} // namespace Sarnik
