#include "framework/icons/iconIndex.h"

#include <algorithm>
#include <cassert>
#include <cstring>

namespace Sarnik
{
namespace
{

constexpr std::string_view indexTitle = "Tintorel Icon Resource Index 1.0\n";
constexpr std::size_t titleBytes = 34; ///< the byte after the title fills up: written as 0, not looked at
constexpr std::size_t storeNameBytes = 128;

std::array<std::byte, iconHeaderBytes> header()
{
    std::array<std::byte, iconHeaderBytes> all{};
    std::memcpy(all.data(), indexTitle.data(), indexTitle.size());
    std::size_t at = titleBytes;
    for (const std::string_view name : iconStoreNames)
    {
        std::memcpy(all.data() + at, name.data(), name.size());
        at += storeNameBytes;
        all[at - 1] = std::byte{'\n'};
    }
    return all;
}

/// All numbers of a record, in the order in which the file has them.
template <class Record, class Visit> void eachNumber(Record &record, Visit visit)
{
    for (auto *list : {&record.width, &record.height, &record.hotX, &record.hotY})
        for (auto &number : *list)
            visit(number);
    for (auto *table : {&record.offset, &record.length})
        for (auto &row : *table)
            for (auto &number : row)
                visit(number);
}

/// Empty where the bytes hold no name.
std::string nameIn(std::span<const std::byte> field)
{
    const auto end = std::find(field.begin(), field.end(), std::byte{0});
    if (end == field.end() || std::any_of(end, field.end(), [](std::byte b) { return b != std::byte{0}; }))
        return {};
    return {reinterpret_cast<const char *>(field.data()), static_cast<std::size_t>(end - field.begin())};
}

} // namespace

std::optional<CIconMap> readIconIndex(std::span<const std::byte> index)
{
    if (index.size() < iconHeaderBytes || (index.size() - iconHeaderBytes) % CIconRecord::bytes != 0)
        return {};
    auto expected = header();
    expected[titleBytes - 1] = index[titleBytes - 1];
    if (!std::equal(expected.begin(), expected.end(), index.begin()))
        return {};

    CIconMap icons;
    for (auto rest = index.subspan(iconHeaderBytes); !rest.empty(); rest = rest.subspan(CIconRecord::bytes))
    {
        CIconRecord record;
        const std::byte *at = rest.data() + CIconRecord::nameBytes;
        eachNumber(record, [&at](std::uint32_t &number) {
            number = 0;
            for (int shift = 0; shift < 32; shift += 8)
                number |= std::to_integer<std::uint32_t>(*at++) << shift;
        });
        std::string name = nameIn(rest.first(CIconRecord::nameBytes));
        if (name.empty() || !icons.emplace(std::move(name), record).second)
            return {};
    }
    return icons;
}

std::vector<std::byte> writeIconIndex(const CIconMap &icons)
{
    const auto first = header();
    std::vector<std::byte> index(first.begin(), first.end());
    for (const auto &[name, record] : icons)
    {
        assert(!name.empty() && name.size() < CIconRecord::nameBytes);
        const std::size_t start = index.size();
        index.resize(start + CIconRecord::nameBytes);
        std::memcpy(index.data() + start, name.data(), name.size());
        eachNumber(record, [&index](std::uint32_t number) {
            for (int shift = 0; shift < 32; shift += 8)
                index.push_back(static_cast<std::byte>(number >> shift));
        });
    }
    return index;
}

} // namespace Sarnik
