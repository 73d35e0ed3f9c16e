#include "host/plugin/recordedAction.h"

#include "platform/files.h"

#include <algorithm>
#include <cstdio>
#include <string_view>

namespace Stillmark
{
namespace
{

constexpr std::string_view magic = "TNACTION";
constexpr std::uint32_t formatVersion = 1;
/// Magic, version, count; and per key: key, type, length of data.
constexpr std::size_t headBytes = 16, keyBytes = 16;

enum valueType : std::uint32_t
{
    integerType = 1,
    booleanType = 2,
    dataType = 3
};

std::size_t dataSize(const recordedAction::value &content)
{
    const auto *data = std::get_if<std::vector<std::uint8_t>>(&content);
    return data ? data->size() : 0;
}

template <class Number> void append(std::vector<std::uint8_t> &out, Number number)
{
    for (std::size_t i = 0; i < sizeof number; i++)
        out.push_back(static_cast<std::uint8_t>(static_cast<std::uint64_t>(number) >> (8 * i)));
}

/// Reads from the front of the bytes; every read says what it wants, for the message.
class byteReader
{
public:
    explicit byteReader(std::span<const std::uint8_t> all) : rest(all) {}

    std::span<const std::uint8_t> take(std::uint64_t count, const std::string &what)
    {
        if (count > rest.size())
            throw recordedAction::formatError("ends within " + what);
        const auto taken = rest.first(static_cast<std::size_t>(count));
        rest = rest.subspan(static_cast<std::size_t>(count));
        return taken;
    }

    template <class Number> Number number(const std::string &what)
    {
        std::uint64_t result = 0;
        const auto taken = take(sizeof(Number), what);
        for (std::size_t i = 0; i < taken.size(); i++)
            result |= std::uint64_t{taken[i]} << (8 * i);
        return static_cast<Number>(result);
    }

    std::size_t left() const { return rest.size(); }

private:
    std::span<const std::uint8_t> rest;
};

recordedAction::value readValue(byteReader &in, const std::string &name)
{
    const auto type = in.number<std::uint32_t>("the type of " + name);
    const auto word = in.number<std::uint64_t>("the value of " + name);
    switch (type)
    {
    case integerType:
        if (word > UINT32_MAX)
            throw recordedAction::formatError(name + " is no 32-bit number");
        return static_cast<std::int32_t>(static_cast<std::uint32_t>(word));
    case booleanType:
        if (word > 1)
            throw recordedAction::formatError(name + " is neither true nor false");
        return word == 1;
    case dataType:
    {
        const auto data = in.take(word, "the data of " + name);
        return std::vector<std::uint8_t>(data.begin(), data.end());
    }
    default:
        throw recordedAction::formatError(name + " has the unknown type " + std::to_string(type));
    }
}

} // namespace

void recordedAction::put(std::uint32_t key, value content)
{
    const auto place = std::find_if(list.begin(), list.end(), [key](const entry &e) { return e.key == key; });
    const std::size_t old = place == list.end() ? 0 : dataSize(place->content);
    const std::size_t added = dataSize(content);
    if (added > mostBytes - (dataBytes - old))
        throw std::length_error("a recorded action holds too much data");
    if (place != list.end())
        place->content = std::move(content);
    else if (list.size() < mostKeys)
        list.push_back({key, std::move(content)});
    else
        throw std::length_error("a recorded action holds too many keys");
    dataBytes += added - old;
}

const recordedAction::value *recordedAction::find(std::uint32_t key) const
{
    const auto place = std::find_if(list.begin(), list.end(), [key](const entry &e) { return e.key == key; });
    return place == list.end() ? nullptr : &place->content;
}

std::vector<std::uint8_t> recordedAction::bytes() const
{
    std::vector<std::uint8_t> out(magic.begin(), magic.end());
    out.reserve(headBytes + list.size() * keyBytes + dataBytes);
    append(out, formatVersion);
    append(out, static_cast<std::uint32_t>(list.size()));
    for (const entry &e : list)
    {
        append(out, e.key);
        append(out, static_cast<std::uint32_t>(e.content.index()) + integerType);
        if (const auto *integer = std::get_if<std::int32_t>(&e.content))
            append(out, std::uint64_t{static_cast<std::uint32_t>(*integer)});
        else if (const auto *boolean = std::get_if<bool>(&e.content))
            append(out, std::uint64_t{*boolean});
        else
        {
            const auto &data = std::get<std::vector<std::uint8_t>>(e.content);
            append(out, std::uint64_t{data.size()});
            out.insert(out.end(), data.begin(), data.end());
        }
    }
    return out;
}

recordedAction recordedAction::fromBytes(std::span<const std::uint8_t> bytes)
{
    byteReader in(bytes);
    if (bytes.size() < magic.size() || !std::equal(magic.begin(), magic.end(), in.take(magic.size(), "").begin()))
        throw formatError("is not a recorded action");
    const auto version = in.number<std::uint32_t>("its version");
    if (version != formatVersion)
        throw formatError("is a recorded action of the unknown version " + std::to_string(version));
    const auto count = in.number<std::uint32_t>("its number of keys");
    if (count > mostKeys)
        throw formatError("claims " + std::to_string(count) + " keys; no recorded action has as many");

    recordedAction action;
    for (std::uint32_t i = 0; i < count; i++)
    {
        const auto key = in.number<std::uint32_t>("key " + std::to_string(i + 1));
        const std::string name = "key '" + keyText(key) + "'";
        if (action.find(key))
            throw formatError("has " + name + " twice");
        action.put(key, readValue(in, name));
    }
    if (in.left() != 0)
        throw formatError("goes on after its last key");
    return action;
}

recordedAction recordedAction::read(const std::string &path)
{
    const auto bytes = Platform::readWholeFile(path, headBytes + mostKeys * keyBytes + mostBytes);
    try
    {
        return fromBytes(bytes);
    }
    catch (const formatError &error)
    {
        throw Platform::fileError(path + ": " + error.what());
    }
    catch (const std::length_error &error)
    {
        throw Platform::fileError(path + ": " + error.what());
    }
}

void recordedAction::write(const std::string &path) const
{
    const auto content = bytes();
    Platform::atomicFile file(path);
    file.write(content.data(), content.size());
    file.commit();
}

std::string keyText(std::uint32_t key)
{
    std::string text;
    for (int shift = 24; shift >= 0; shift -= 8)
        text += static_cast<char>(key >> shift & 0xFF);
    if (std::all_of(text.begin(), text.end(), [](char c) { return c >= ' ' && c <= '~'; }))
        return text;
    char digits[11];
    std::snprintf(digits, sizeof digits, "0x%08x", static_cast<unsigned>(key));
    return digits;
}

} // namespace Stillmark
