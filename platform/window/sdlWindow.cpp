#include "platform/window/sdlConnection.h"

#include <algorithm>
#include <cmath>

namespace Platform
{
namespace
{

Uint32 flagsOf(const windowSettings &with)
{
    Uint32 flags = SDL_WINDOW_HIDDEN | SDL_WINDOW_ALLOW_HIGHDPI;
    switch (with.kind)
    {
    case windowKind::normal:
        break;
    case windowKind::plain:
        flags |= SDL_WINDOW_BORDERLESS | SDL_WINDOW_SKIP_TASKBAR;
        break;
    case windowKind::popup:
        flags |= SDL_WINDOW_BORDERLESS | SDL_WINDOW_SKIP_TASKBAR | SDL_WINDOW_POPUP_MENU | SDL_WINDOW_ALWAYS_ON_TOP;
        break;
    case windowKind::tip:
        flags |= SDL_WINDOW_BORDERLESS | SDL_WINDOW_SKIP_TASKBAR | SDL_WINDOW_TOOLTIP | SDL_WINDOW_ALWAYS_ON_TOP;
        break;
    }
    return with.resizable ? flags | SDL_WINDOW_RESIZABLE : flags;
}

int whole(double v)
{
    return static_cast<int>(std::lround(std::clamp(v, -32768.0, 32767.0)));
}

int wholeSide(double v)
{
    return std::max(1, whole(v));
}

} // namespace

sdlWindow::sdlWindow(sdlDisplay::connection &on, const windowSettings &with) : link(on), kind(with.kind)
{
    const double f = link.pointsPerUnit;
    const int x = with.placed ? whole(with.place.left * f) : int{SDL_WINDOWPOS_CENTERED};
    const int y = with.placed ? whole(with.place.top * f) : int{SDL_WINDOWPOS_CENTERED};
    handle = SDL_CreateWindow(with.title.c_str(), x, y, wholeSide(with.place.width() * f),
                              wholeSide(with.place.height() * f), flagsOf(with));
    if (handle == nullptr)
        throw displayError(std::string("A window cannot be opened: ") + SDL_GetError());
    number = SDL_GetWindowID(handle);
    watchConnection(handle, link.isLost);
    if (const auto *owner = dynamic_cast<const sdlWindow *>(with.owner); owner != nullptr && owner->handle != nullptr)
        SDL_SetWindowModalFor(handle, owner->handle); // only a hint to the window manager
    sizeChanged();
    link.windows[number] = this;
}

sdlWindow::~sdlWindow()
{
    link.windows.erase(number);
    if (link.usable())
        SDL_DestroyWindow(handle);
}

void sdlWindow::sizeChanged()
{
    int width = 1, height = 1, points = 1;
    SDL_GetWindowSize(handle, &points, nullptr);
    SDL_GetWindowSizeInPixels(handle, &width, &height);
    pixelsPerPoint = points > 0 && width > 0 ? static_cast<double>(width) / points : 1;
    width = std::clamp(width, 1, raster::largestSide);
    height = std::clamp(height, 1, raster::largestSide);
    if (width != drawn.width() || height != drawn.height())
        drawn = raster(width, height);
}

rectangle sdlWindow::place() const
{
    if (!link.usable())
        return {};
    int x = 0, y = 0, width = 0, height = 0;
    SDL_GetWindowPosition(handle, &x, &y);
    SDL_GetWindowSize(handle, &width, &height);
    const double f = link.pointsPerUnit;
    return {x / f, y / f, (x + width) / f, (y + height) / f};
}

void sdlWindow::setPlace(const rectangle &place)
{
    if (!link.usable())
        return;
    const double f = link.pointsPerUnit;
    SDL_SetWindowPosition(handle, whole(place.left * f), whole(place.top * f));
    SDL_SetWindowSize(handle, wholeSide(place.width() * f), wholeSide(place.height() * f));
}

rectangle sdlWindow::border() const
{
    int left = 0, top = 0, right = 0, bottom = 0;
    if (!link.usable() || SDL_GetWindowBordersSize(handle, &top, &left, &bottom, &right) != 0)
        return {};
    const double f = link.pointsPerUnit;
    return {left / f, top / f, right / f, bottom / f};
}

void sdlWindow::setSmallest(double width, double height)
{
    if (link.usable())
        SDL_SetWindowMinimumSize(handle, wholeSide(width * link.pointsPerUnit), wholeSide(height * link.pointsPerUnit));
}

void sdlWindow::setTitle(std::string_view title)
{
    if (link.usable())
        SDL_SetWindowTitle(handle, std::string(title).c_str());
}

void sdlWindow::show(bool visible)
{
    if (!link.usable() || visible == isVisible)
        return;
    isVisible = visible;
    visible ? SDL_ShowWindow(handle) : SDL_HideWindow(handle);
}

void sdlWindow::activate()
{
    if (!link.usable() || !isVisible)
        return;
    SDL_RaiseWindow(handle);
    // Without a window manager raising gives no keyboard.
    SDL_SetWindowInputFocus(handle);
}

void sdlWindow::capturePointer(bool on)
{
    if (link.usable())
        SDL_CaptureMouse(on ? SDL_TRUE : SDL_FALSE);
}

void sdlWindow::present(std::span<const pixelRect> parts)
{
    if (!link.usable() || parts.empty())
        return;
    // The surface belongs to the library, and becomes another one with every new size.
    SDL_Surface *const surface = SDL_GetWindowSurface(handle);
    if (surface == nullptr || SDL_LockSurface(surface) != 0)
        return;
    std::vector<SDL_Rect> changed;
    for (const pixelRect &part : parts)
    {
        const int left = std::max(part.left, 0), top = std::max(part.top, 0);
        const int right = std::min({part.right, drawn.width(), surface->w});
        const int bottom = std::min({part.bottom, drawn.height(), surface->h});
        if (left >= right || top >= bottom)
            continue;
        auto *const to = static_cast<Uint8 *>(surface->pixels) + top * surface->pitch +
                         left * static_cast<int>(surface->format->BytesPerPixel);
        SDL_ConvertPixels(right - left, bottom - top, SDL_PIXELFORMAT_ARGB8888, drawn.row(top) + left,
                          static_cast<int>(drawn.rowBytes()), surface->format->format, to, surface->pitch);
        changed.push_back({left, top, right - left, bottom - top});
    }
    SDL_UnlockSurface(surface);
    SDL_UpdateWindowSurfaceRects(handle, changed.data(), static_cast<int>(changed.size()));
}

} // namespace Platform
