#pragma once

#include "platform/canvas/raster.h"

#include <cstdint>
#include <memory>
#include <string_view>

namespace Sarnik
{

/// The states that pictures exist in. Most have the normal one alone.
enum EIconState : std::uint32_t
{
    kIconState_Normal = 0,
    kIconState_Pressed = 6 ///< of a flat button
};

/// A small picture by its name, as controls draw it.
struct CIcon
{
    std::shared_ptr<const Platform::raster> pixels; ///< null where there is no such picture
    double scale = 1;                               ///< pixels per view unit

    explicit operator bool() const { return pixels != nullptr && !pixels->empty(); }
    double Width() const { return pixels == nullptr ? 0 : pixels->width() / scale; }
    double Height() const { return pixels == nullptr ? 0 : pixels->height() / scale; }
};

/// Where the pictures of controls come from: whoever has some is made the current one. Interface thread.
class CIconSource
{
public:
    virtual ~CIconSource() = default;

    /// The picture that suits best where a view unit is `scale` pixels. A state (EIconState) that
    /// there is no picture of gives the normal one.
    virtual CIcon Find(std::string_view name, double scale, std::uint32_t state) = 0;

    /// Null where nobody has pictures.
    static CIconSource *Current() noexcept;
    /// The source outlives its use; null for none.
    static void SetCurrent(CIconSource *source) noexcept;
    /// From the current source; none where there is no source, or the name is empty.
    static CIcon Icon(std::string_view name, double scale, std::uint32_t state = 0);
};

} // namespace Sarnik
