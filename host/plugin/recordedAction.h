#pragma once

#include <cstddef>
#include <cstdint>
#include <span>
#include <stdexcept>
#include <string>
#include <variant>
#include <vector>

namespace Stillmark
{

/// What a run recorded for playing it again: values by four-character key, in the order in which they were first put.
/// The byte form is told in docs/files/recordedAction.md.
class recordedAction
{
public:
    using value = std::variant<std::int32_t, bool, std::vector<std::uint8_t>>;
    struct entry
    {
        std::uint32_t key;
        value content;

        bool operator==(const entry &) const = default;
    };

    /// A plug-in or a file cannot make an action larger.
    static constexpr std::size_t mostKeys = 4096;
    static constexpr std::size_t mostBytes = std::size_t{256} << 20; ///< of data, all keys together

    /// Bytes that are no recorded action; what() says why.
    class formatError : public std::runtime_error
    {
    public:
        using std::runtime_error::runtime_error;
    };

    /// Throws std::length_error, and leaves the action as it was, where it would grow beyond its limits.
    void put(std::uint32_t key, value content);
    /// Null where there is no such key. Good until the next put.
    const value *find(std::uint32_t key) const;
    const std::vector<entry> &entries() const { return list; }
    bool operator==(const recordedAction &other) const { return list == other.list; }

    std::vector<std::uint8_t> bytes() const;
    /// Throws formatError. Takes no more memory than the bytes themselves.
    static recordedAction fromBytes(std::span<const std::uint8_t> bytes);

    /// Throw Platform::fileError with a line that names the file. A new version replaces the old one whole.
    static recordedAction read(const std::string &path);
    void write(const std::string &path) const;

private:
    std::vector<entry> list;
    std::size_t dataBytes = 0;
};

/// "imgW", or hexadecimal for bytes that are not printable.
std::string keyText(std::uint32_t key);

} // namespace Stillmark
