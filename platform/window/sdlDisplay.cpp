#include "platform/window/sdlDisplay.h"

#include "platform/window/sdlConnection.h"

#include <algorithm>
#include <chrono>
#include <cmath>
#include <cstdio>
#include <cstdlib>

namespace Platform
{
namespace
{

/// A lost connection cannot be closed, only left, and the library holds on to it: this process has seen its last
/// window.
bool libraryUnusable = false;

/// The library's own wait does not see a connection end, only the next look at it does; seconds.
constexpr double longestWait = 0.25;

double fromEnvironment(const char *name)
{
    const char *const text = std::getenv(name);
    const double value = text == nullptr ? 0 : std::strtod(text, nullptr);
    return value >= 1 && value <= 4 ? value : 0;
}

/// A whole number of times the usual 96 dots per inch. Laptops of 1.7 times stand at 1, as their desktops do.
double fromDensity()
{
    float dots = 0;
    if (SDL_GetDisplayDPI(0, nullptr, &dots, nullptr) != 0 || !(dots > 0))
        return 1;
    return std::clamp(std::floor(static_cast<double>(dots) / 96 + 0.25), 1.0, 4.0);
}

bool scalesItself()
{
    const char *const driver = SDL_GetCurrentVideoDriver();
    return driver != nullptr && std::string_view(driver) == "wayland";
}

SDL_SystemCursor systemCursor(cursorShape shape)
{
    switch (shape)
    {
    case cursorShape::cross:
        return SDL_SYSTEM_CURSOR_CROSSHAIR;
    case cursorShape::text:
        return SDL_SYSTEM_CURSOR_IBEAM;
    case cursorShape::hand:
        return SDL_SYSTEM_CURSOR_HAND;
    case cursorShape::move:
        return SDL_SYSTEM_CURSOR_SIZEALL;
    case cursorShape::sizeVertical:
        return SDL_SYSTEM_CURSOR_SIZENS;
    case cursorShape::sizeHorizontal:
        return SDL_SYSTEM_CURSOR_SIZEWE;
    case cursorShape::sizeFalling:
        return SDL_SYSTEM_CURSOR_SIZENWSE;
    case cursorShape::sizeRising:
        return SDL_SYSTEM_CURSOR_SIZENESW;
    case cursorShape::wait:
        return SDL_SYSTEM_CURSOR_WAIT;
    case cursorShape::forbidden:
        return SDL_SYSTEM_CURSOR_NO;
    case cursorShape::arrow:
    case cursorShape::hidden:
        break;
    }
    return SDL_SYSTEM_CURSOR_ARROW;
}

SDL_Cursor *imageCursor(const cursor &c)
{
    // The library wants colours without the alpha in them.
    raster plain = *c.image;
    for (int y = 0; y < plain.height(); ++y)
        for (int x = 0; x < plain.width(); ++x)
        {
            const colour p = unpacked(plain.row(y)[x]);
            plain.row(y)[x] =
                std::uint32_t{p.alpha} << 24 | std::uint32_t{p.red} << 16 | std::uint32_t{p.green} << 8 | p.blue;
        }
    SDL_Surface *const surface = SDL_CreateRGBSurfaceWithFormatFrom(
        plain.row(0), plain.width(), plain.height(), 32, static_cast<int>(plain.rowBytes()), SDL_PIXELFORMAT_ARGB8888);
    if (surface == nullptr)
        return nullptr;
    SDL_Cursor *const made = SDL_CreateColorCursor(surface, c.hotX, c.hotY);
    SDL_FreeSurface(surface);
    return made;
}

} // namespace

double wantedScale()
{
    const double own = fromEnvironment("STILLMARK_SCALE");
    return own > 0 ? own : fromEnvironment("GDK_SCALE");
}

void sdlDisplay::connection::start()
{
    if (isLost || libraryUnusable)
        throw displayError("The connection to the display was lost.");
    if (isStarted)
        return;
    // We are a guest in another program: its signals and its end are its own.
    SDL_SetMainReady();
    SDL_SetHint(SDL_HINT_NO_SIGNAL_HANDLERS, "1");
    SDL_SetHint(SDL_HINT_QUIT_ON_LAST_WINDOW_CLOSE, "0");
    SDL_SetHint(SDL_HINT_VIDEO_ALLOW_SCREENSAVER, "1");
    SDL_SetHint(SDL_HINT_MOUSE_FOCUS_CLICKTHROUGH, "1");
    SDL_SetHint(SDL_HINT_VIDEO_X11_NET_WM_BYPASS_COMPOSITOR, "0");
    // Only the parts that have changed go to the screen. Through OpenGL it would be the whole window each time.
    SDL_SetHint(SDL_HINT_FRAMEBUFFER_ACCELERATION, "0");
    watchRequests();
    if (SDL_InitSubSystem(SDL_INIT_VIDEO) != 0)
        throw displayError(std::string("There is no display to open a window on: ") + SDL_GetError());
    wakeEvent = SDL_RegisterEvents(1);
    isStarted = true;
    const double wanted = wantedScale();
    pointsPerUnit = wanted > 0 ? wanted : scalesItself() ? 1 : fromDensity();
    SDL_EventState(SDL_DROPTEXT, SDL_DISABLE);
    SDL_StartTextInput();
}

sdlDisplay::sdlDisplay() : link(std::make_unique<connection>())
{
}

sdlDisplay::~sdlDisplay()
{
    if (link->usable())
    {
        if (link->shownCursor != nullptr)
            SDL_FreeCursor(link->shownCursor);
        SDL_QuitSubSystem(SDL_INIT_VIDEO);
    }
    // Not before: as the library leaves, it hears what came of its last requests.
    unwatch();
    libraryUnusable = libraryUnusable || link->isLost;
}

bool sdlDisplay::started() const
{
    return link->isStarted;
}

bool sdlDisplay::lost() const
{
    return link->isLost;
}

std::unique_ptr<window> sdlDisplay::open(const windowSettings &settings)
{
    link->start();
    return std::make_unique<sdlWindow>(*link, settings);
}

bool sdlDisplay::next(event &e, double wait)
{
    const auto tellLoss = [&] {
        if (!link->isLost || link->lossTold)
            return false;
        link->lossTold = libraryUnusable = true;
        e = {.kind = eventKind::displayLost};
        return true;
    };
    if (!link->usable())
    {
        if (tellLoss())
            return true;
        std::unique_lock lock(link->mutex);
        link->condition.wait_for(lock, std::chrono::duration<double>(std::clamp(wait, 0.0, 3600.0)),
                                 [&] { return link->woken.load(); });
        link->woken = false;
        return false;
    }

    if (link->woken.exchange(false))
        return false;
    const double end = now() + wait;
    while (!link->isLost)
    {
        const double left = end - now();
        const int milliseconds = left > 0 ? static_cast<int>(std::ceil(std::min(left, longestWait) * 1000)) : 0;
        SDL_Event from;
        const bool came = milliseconds > 0 ? SDL_WaitEventTimeout(&from, milliseconds) != 0 : SDL_PollEvent(&from) != 0;
        if (link->isLost)
            break;
        if (came && from.type == link->wakeEvent)
        {
            link->woken = false;
            return false;
        }
        // Moves that wait in a row are one.
        SDL_Event after;
        while (came && from.type == SDL_MOUSEMOTION &&
               SDL_PeepEvents(&after, 1, SDL_PEEKEVENT, SDL_FIRSTEVENT, SDL_LASTEVENT) == 1 &&
               after.type == SDL_MOUSEMOTION && after.motion.windowID == from.motion.windowID)
            SDL_PeepEvents(&from, 1, SDL_GETEVENT, SDL_MOUSEMOTION, SDL_MOUSEMOTION);
        const bool ours = came && translate(*link, from, e);
        if (came && (from.type == SDL_DROPFILE || from.type == SDL_DROPTEXT))
            SDL_free(from.drop.file);
        if (ours)
            return true;
        if (!came && left <= 0)
            return false;
    }
    return tellLoss();
}

void sdlDisplay::wake() noexcept
{
    if (link->woken.exchange(true))
        return;
    if (link->usable())
    {
        SDL_Event e{};
        e.type = link->wakeEvent;
        SDL_PushEvent(&e);
    }
    {
        const std::lock_guard lock(link->mutex);
    }
    link->condition.notify_all();
}

double sdlDisplay::now() const
{
    return std::chrono::duration<double>(std::chrono::steady_clock::now().time_since_epoch()).count();
}

std::uint32_t sdlDisplay::modifiers() const
{
    return link->usable() ? modifiersOf(SDL_GetModState()) : 0;
}

bool sdlDisplay::held(key k) const
{
    if (!link->usable())
        return false;
    int count = 0;
    const Uint8 *const state = SDL_GetKeyboardState(&count);
    const SDL_Scancode code = scancodeOf(k);
    return code != SDL_SCANCODE_UNKNOWN && static_cast<int>(code) < count && state[code] != 0;
}

std::string sdlDisplay::clipboard() const
{
    if (!link->usable())
        return {};
    char *const text = SDL_GetClipboardText();
    const std::string result = text == nullptr ? "" : text;
    SDL_free(text);
    return result;
}

void sdlDisplay::setClipboard(std::string_view text)
{
    if (link->usable())
        SDL_SetClipboardText(std::string(text).c_str());
}

void sdlDisplay::setCursor(const cursor &c)
{
    if (!link->usable())
        return;
    SDL_ShowCursor(c.shape == cursorShape::hidden && c.image == nullptr ? SDL_DISABLE : SDL_ENABLE);
    SDL_Cursor *const made =
        c.image != nullptr && !c.image->empty() ? imageCursor(c) : SDL_CreateSystemCursor(systemCursor(c.shape));
    if (made == nullptr)
        return;
    SDL_SetCursor(made);
    if (link->shownCursor != nullptr)
        SDL_FreeCursor(link->shownCursor);
    link->shownCursor = made;
}

void sdlDisplay::beep()
{
    // A terminal's bell is the one sound that needs no sound system.
    std::fputc('\a', stderr);
}

rectangle sdlDisplay::workArea() const
{
    SDL_Rect area{0, 0, 1280, 800};
    if (link->usable())
        SDL_GetDisplayUsableBounds(0, &area);
    const double f = link->pointsPerUnit;
    return {area.x / f, area.y / f, (area.x + area.w) / f, (area.y + area.h) / f};
}

} // namespace Platform
