#pragma once

#include "framework/icons/resourceConversionThunk.h"

namespace Sarnik
{

/// The program's pictures. What asks for them first makes them the current CIconSource, until services end. Interface
/// thread.
class CProgramIcons
{
public:
    CProgramIcons();
    ~CProgramIcons();
    CProgramIcons(const CProgramIcons &) = delete;
    CProgramIcons &operator=(const CProgramIcons &) = delete;

    static CProgramIcons *Get(bool create = true);

    /// A numbered icon.
    CIcon Icon(std::uint32_t id, double scale, std::uint32_t state = 0);
    /// The same for what the display itself draws.
    ResourceConversionThunk::screenPicture OnScreen(std::uint32_t id, double scale);

    const CResourceDataProvider &Provider() const { return provider; }

private:
    std::string NameOf(std::uint32_t id) const;

    CResourceDataProvider provider;
    ResourceConversionThunk pictures{provider};
};

} // namespace Sarnik
