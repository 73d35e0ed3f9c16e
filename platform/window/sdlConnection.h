#pragma once

#include "platform/window/sdlDisplay.h"

#include <SDL.h>

#include <atomic>
#include <condition_variable>
#include <deque>
#include <map>
#include <mutex>

namespace Platform
{

class sdlWindow;

/// What an sdlDisplay keeps, shared with its windows. For the sources of this folder only.
struct sdlDisplay::connection
{
    /// Throws displayError.
    void start();
    /// The library must not be asked anything any more.
    bool usable() const { return isStarted && !isLost; }

    std::atomic<bool> isStarted = false;
    std::atomic<bool> isLost = false;
    bool lossTold = false;
    /// Coordinates of the library per view unit: 1 where the window system scales by itself.
    double pointsPerUnit = 1;
    Uint32 wakeEvent = 0;
    std::map<Uint32, sdlWindow *> windows;
    SDL_Cursor *shownCursor = nullptr;

    std::mutex mutex; ///< for waits before the start
    std::condition_variable condition;
    std::atomic<bool> woken = false;

    Uint32 clickedWindow = 0;
    int clicksElsewhere = 0; ///< of those that the library counts, in another window

    std::vector<std::string> dropped; ///< files of the drop under way
};

/// Pixels per view unit that the user wants, 0 where nothing says so.
double wantedScale();

/// Makes an event of ours; false where it is none, or not complete yet.
bool translate(sdlDisplay::connection &link, const SDL_Event &from, event &to);
std::uint32_t modifiersOf(SDL_Keymod state);
SDL_Scancode scancodeOf(key k);

/// From now on requests to an X11 server that come too late do not end the process. To be called before SDL starts,
/// which puts back what it found as it leaves, with some answers still to come.
void watchRequests();
/// From now on the end of an X11 connection sets the flag instead of ending the process. Does nothing under other
/// window systems.
void watchConnection(SDL_Window *window, std::atomic<bool> &lost);
/// Both as before.
void unwatch();

class sdlWindow final : public window
{
public:
    sdlWindow(sdlDisplay::connection &on, const windowSettings &with);
    ~sdlWindow() override;

    windowId id() const override { return number; }
    double scale() const override { return pixelsPerPoint * link.pointsPerUnit; }
    rectangle place() const override;
    void setPlace(const rectangle &place) override;
    rectangle border() const override;
    void setSmallest(double width, double height) override;
    void setTitle(std::string_view title) override;
    void show(bool visible) override;
    bool visible() const override { return isVisible; }
    void activate() override;
    void capturePointer(bool on) override;
    raster &pixels() override { return drawn; }
    void present(std::span<const pixelRect> parts) override;

    /// Takes over the size that the window has now.
    void sizeChanged();

private:
    sdlDisplay::connection &link;
    windowKind kind;
    SDL_Window *handle = nullptr;
    windowId number = 0;
    double pixelsPerPoint = 1;
    bool isVisible = false;
    raster drawn;
};

} // namespace Platform
