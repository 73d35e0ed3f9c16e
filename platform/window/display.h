#pragma once

#include "platform/canvas/raster.h"
#include "platform/window/event.h"

#include <memory>
#include <span>
#include <stdexcept>
#include <string>
#include <string_view>

namespace Platform
{

/// There is no display, or it is gone. what() is one line for the user.
class displayError : public std::runtime_error
{
public:
    using std::runtime_error::runtime_error;
};

enum class cursorShape
{
    arrow,
    hidden,
    cross,
    text,
    hand,
    move,
    sizeVertical,
    sizeHorizontal,
    sizeFalling, ///< from top left to bottom right
    sizeRising,
    wait,
    forbidden
};

/// One of the display's own shapes or, with an image, that picture.
struct cursor
{
    cursorShape shape = cursorShape::arrow;
    std::shared_ptr<const raster> image = {}; ///< in pixels of the screen
    int hotX = 0, hotY = 0;                   ///< the pixel that points

    friend bool operator==(const cursor &, const cursor &) = default;
};

enum class windowKind
{
    normal, ///< framed by the display's window manager
    plain,  ///< without a frame, takes the keyboard
    popup,  ///< without a frame, above its owner, leaves the keyboard where it is
    tip     ///< the same, and lets nothing be clicked
};

class window;

struct windowSettings
{
    std::string title = {};
    windowKind kind = windowKind::normal;
    bool resizable = false;
    bool placed = false;           ///< whether the place's corner counts; otherwise the display chooses
    rectangle place = {};          ///< view units of the screen
    const window *owner = nullptr; ///< stays below it
};

/// A window on the display, and the pixels to be shown in it. Goes when deleted. The display outlives it.
class window
{
public:
    virtual ~window() = default;

    virtual windowId id() const = 0;
    /// Pixels per view unit.
    virtual double scale() const = 0;
    /// Without the frame, in view units of the screen.
    virtual rectangle place() const = 0;
    virtual void setPlace(const rectangle &place) = 0;
    /// How thick the display's own frame is on each side, in view units; nothing while that is not known.
    virtual rectangle border() const = 0;
    /// A resizable window never gets smaller. View units.
    virtual void setSmallest(double width, double height) = 0;
    virtual void setTitle(std::string_view title) = 0;
    /// A new window is hidden.
    virtual void show(bool visible) = 0;
    virtual bool visible() const = 0;
    /// To the front, and the keyboard to it.
    virtual void activate() = 0;
    /// Moves go to this window, wherever the pointer is, as long as it is on.
    virtual void capturePointer(bool on) = 0;

    /// As large as the window, in pixels. Drawn to at any time, shown by present. Its contents are lost with a resize
    /// event.
    virtual raster &pixels() = 0;
    /// Shows these parts of the pixels.
    virtual void present(std::span<const pixelRect> parts) = 0;
};

/// The screen, the keyboard and the pointer, or what stands for them. Interface thread, wake excepted.
class display
{
public:
    virtual ~display() = default;

    /// Throws displayError.
    virtual std::unique_ptr<window> open(const windowSettings &settings) = 0;

    /// The next event; false where none has come within `wait` seconds (infinity waits for good) or wake was called.
    virtual bool next(event &e, double wait) = 0;
    /// Ends a next that waits, or that will. Any thread.
    virtual void wake() noexcept = 0;
    /// The connection has ended; open throws, and windows do nothing any more.
    virtual bool lost() const = 0;

    /// Seconds since some fixed moment.
    virtual double now() const = 0;

    /// As they are now, events that wait or not.
    virtual std::uint32_t modifiers() const = 0;
    virtual bool held(key k) const = 0;

    virtual std::string clipboard() const = 0;
    virtual void setClipboard(std::string_view text) = 0;
    virtual void setCursor(const cursor &c) = 0;
    virtual void beep() = 0;
    /// The screen less the system's bars, in view units; a guess before the first window is opened.
    virtual rectangle workArea() const = 0;
};

} // namespace Platform
