#pragma once

#include <compare>
#include <cstddef>
#include <cstdint>
#include <functional>
#include <string>
#include <string_view>

namespace Sarnik
{

/// A number that stands for a name, the same for the same name as long as the program runs: "Project/Dialog/OKButton",
/// "sarnik/command/undo". Names of views, commands, menus and messages share one table. The empty name is 0, "none".
/// A name may reserve the numbers after its own: what it stands for plus n are the n-th of a menu's items and the like.
/// Interface thread, and before main.
class CObjID
{
public:
    constexpr CObjID() = default;
    /// For numbers that come out of a range or a message.
    explicit constexpr CObjID(std::uint32_t number) : value(number) {}
    /// Interns the name.
    CObjID(std::string_view name) : value(Intern(name, 1)) {}
    CObjID(const char *name) : CObjID(std::string_view(name)) {}

    /// The number of a known name; 0 where nobody has interned it.
    static CObjID Find(std::string_view name) noexcept;

    constexpr std::uint32_t Number() const { return value; }
    /// "Name", or "Name+3" within a block; "#17" for what was never given out.
    std::string Name() const;

    explicit constexpr operator bool() const { return value != 0; }
    constexpr CObjID operator+(std::uint32_t n) const { return CObjID(value + n); }
    constexpr bool InRange(CObjID low, CObjID high) const { return low.value <= value && value <= high.value; }
    friend constexpr auto operator<=>(CObjID, CObjID) = default;

protected:
    /// The counter starts at 65536 and grows by `count`, at least 1. Throws std::logic_error where the name already has
    /// a smaller block, since its neighbours are taken.
    static std::uint32_t Intern(std::string_view name, std::uint32_t count);

private:
    std::uint32_t value = 0;
};

/// The kinds of names. They differ to the reader only.
class CViewID : public CObjID
{
public:
    explicit CViewID(std::string_view name) : CObjID(name) {}
};

class CCommandID : public CObjID
{
public:
    explicit CCommandID(std::string_view name) : CObjID(name) {}
};

class CMenuID : public CObjID
{
public:
    explicit CMenuID(std::string_view name) : CObjID(name) {}
};

/// The first of `count` numbers, "Project/ZoomMenu/Base".
class CBlockID : public CObjID
{
public:
    CBlockID(std::string_view name, std::uint32_t count) : CObjID(Intern(name, count)), size(count) {}

    /// The place within the block; -1 for other ids.
    int IndexOf(CObjID id) const
    {
        return id >= *this && id.Number() - Number() < size ? static_cast<int>(id.Number() - Number()) : -1;
    }

private:
    std::uint32_t size;
};

} // namespace Sarnik

template <> struct std::hash<Sarnik::CObjID>
{
    std::size_t operator()(Sarnik::CObjID id) const noexcept { return id.Number(); }
};
