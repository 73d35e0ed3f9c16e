#pragma once

#include "platform/window/display.h"

#include <atomic>
#include <map>
#include <utility>
#include <vector>

namespace Platform
{

class memoryDisplay;

/// A window of a memoryDisplay. What it shows is what was presented, not what was drawn.
class memoryWindow final : public window
{
public:
    memoryWindow(memoryDisplay &on, windowId number, const windowSettings &with);
    ~memoryWindow() override;

    windowId id() const override { return number; }
    double scale() const override;
    rectangle place() const override { return where; }
    void setPlace(const rectangle &place) override;
    rectangle border() const override;
    void setSmallest(double width, double height) override { smallest = {width, height}; }
    void setTitle(std::string_view title) override { settings.title = title; }
    void show(bool visible) override;
    bool visible() const override { return isVisible; }
    void activate() override;
    void capturePointer(bool on) override { captured = on; }
    raster &pixels() override { return drawn; }
    void present(std::span<const pixelRect> parts) override;

    const std::string &title() const { return settings.title; }
    windowKind kind() const { return settings.kind; }
    bool hasPointer() const { return captured; }
    const raster &screen() const { return shown; }
    /// Pixels presented since the window was opened, and how often.
    std::int64_t presentedPixels() const { return pixelCount; }
    int presents() const { return presentCount; }

private:
    friend class memoryDisplay;
    void makePixels();

    memoryDisplay &owner;
    windowId number;
    windowSettings settings;
    rectangle where;
    point smallest;
    bool isVisible = false, captured = false;
    raster drawn, shown;
    std::int64_t pixelCount = 0;
    int presentCount = 0;
};

/// A display without any screen: events come out of a script, windows are drawn in memory, and time passes only as the
/// script and waits make it, so that everything happens the same on every run. Where a script has ended and nothing
/// else could ever come, a wait for good ends with displayLost instead of hanging.
class memoryDisplay final : public display
{
public:
    explicit memoryDisplay(double pixelsPerUnit = 1) : unit(pixelsPerUnit) {}

    std::unique_ptr<window> open(const windowSettings &settings) override;
    bool next(event &e, double wait) override;
    void wake() noexcept override { woken = true; }
    bool lost() const override { return isLost; }
    double now() const override { return time; }
    std::uint32_t modifiers() const override { return modifierState; }
    bool held(key k) const override;
    std::string clipboard() const override { return clip; }
    void setClipboard(std::string_view text) override { clip = text; }
    void setCursor(const cursor &c) override { currentCursor = c; }
    void beep() override { ++beepCount; }
    rectangle workArea() const override { return {0, 0, 1920 / unit, 1080 / unit}; }

    /// What follows goes to this window.
    memoryDisplay &to(const window &w);
    /// What follows happens this much later.
    memoryDisplay &after(double seconds);
    /// What follows happens with these modifiers held.
    memoryDisplay &with(std::uint32_t modifiers);
    memoryDisplay &post(event e);
    memoryDisplay &move(double x, double y);
    memoryDisplay &press(double x, double y, int button = 1, int clicks = 1);
    memoryDisplay &release(double x, double y, int button = 1);
    memoryDisplay &click(double x, double y, int button = 1);
    /// Press at the first place, moves to each of the others, release at the last.
    memoryDisplay &drag(std::initializer_list<point> way, int button = 1);
    memoryDisplay &wheel(double x, double y, double notches);
    /// Down and up, with the characters that the key writes.
    memoryDisplay &tap(key k);
    memoryDisplay &keyDown(key k, bool repeat = false);
    memoryDisplay &keyUp(key k);
    /// As if typed: a key for each character that has one, then the text.
    memoryDisplay &type(std::string_view utf8);
    memoryDisplay &drop(double x, double y, std::vector<std::string> files);
    memoryDisplay &close();
    /// The user drags the window's edge.
    memoryDisplay &resize(double width, double height);
    memoryDisplay &loseDisplay();
    /// Frames of normal windows from now on, as window::border.
    void setBorder(const rectangle &thickness) { frameBorder = thickness; }
    /// Another number of pixels per unit; every window gets a resize event.
    void changeScale(double pixelsPerUnit);

    /// The windows that are open, in the order of their opening.
    std::vector<memoryWindow *> windows() const;
    memoryWindow *find(windowId id) const;
    const cursor &shownCursor() const { return currentCursor; }
    int beeps() const { return beepCount; }
    bool scriptEnded() const { return script.empty(); }
    double pixelsPerUnit() const { return unit; }

private:
    friend class memoryWindow;
    void happen(const event &e);

    double unit;
    rectangle frameBorder;
    double time = 0, scriptTime = 0;
    std::multimap<double, event> script; ///< by the time of their coming
    std::map<windowId, memoryWindow *> openWindows;
    windowId lastId = 0, scriptWindow = 0, focused = 0;
    std::uint32_t scriptModifiers = 0, modifierState = 0;
    bool heldKeys[256] = {};
    bool isLost = false;
    std::atomic<bool> woken = false;
    std::string clip;
    cursor currentCursor;
    int beepCount = 0;
};

} // namespace Platform
