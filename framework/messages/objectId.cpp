#include "framework/messages/objectId.h"

#include <algorithm>
#include <map>
#include <stdexcept>

namespace Sarnik
{
namespace
{

struct block
{
    std::uint32_t first, count;
};

struct nameTable
{
    std::map<std::string, block, std::less<>> byName;
    std::map<std::uint32_t, std::string_view> byNumber;
    std::uint32_t next = 65536;
};

/// Built by whoever comes first: ids are objects with static life in many files.
nameTable &table()
{
    static nameTable names;
    return names;
}

} // namespace

std::uint32_t CObjID::Intern(std::string_view name, std::uint32_t count)
{
    if (name.empty())
        return 0;
    nameTable &names = table();
    count = std::max<std::uint32_t>(1, count);
    if (const auto known = names.byName.find(name); known != names.byName.end())
    {
        if (count > known->second.count)
            throw std::logic_error("CObjID: " + std::string(name) + " was asked for with a smaller block before");
        return known->second.first;
    }
    if (count > UINT32_MAX - names.next)
        throw std::length_error("CObjID: no numbers left");
    const auto added = names.byName.emplace(std::string(name), block{names.next, count}).first;
    names.byNumber.emplace(names.next, added->first);
    names.next += count;
    return added->second.first;
}

CObjID CObjID::Find(std::string_view name) noexcept
{
    const auto known = table().byName.find(name);
    return known == table().byName.end() ? CObjID() : CObjID(known->second.first);
}

std::string CObjID::Name() const
{
    if (value == 0)
        return {};
    const nameTable &names = table();
    auto after = names.byNumber.upper_bound(value);
    if (after == names.byNumber.begin() || value >= names.next)
        return "#" + std::to_string(value);
    --after;
    const std::string name(after->second);
    return after->first == value ? name : name + "+" + std::to_string(value - after->first);
}

} // namespace Sarnik
