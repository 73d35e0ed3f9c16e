#include "platform/window/memoryDisplay.h"

#include "platform/utf8.h"

#include <algorithm>
#include <cmath>

namespace Platform
{

namespace
{

/// Even a look that finds nothing takes time: work on idle does not stop the clock.
constexpr double emptyPoll = 0.0005;

} // namespace

memoryWindow::memoryWindow(memoryDisplay &on, windowId id, const windowSettings &with)
    : owner(on), number(id), settings(with), where(with.place)
{
    if (!with.placed)
        where = {100, 100, 100 + with.place.width(), 100 + with.place.height()};
    owner.openWindows[number] = this;
    makePixels();
}

memoryWindow::~memoryWindow()
{
    owner.openWindows.erase(number);
    if (owner.focused == number)
        owner.focused = 0;
}

double memoryWindow::scale() const
{
    return owner.unit;
}

void memoryWindow::makePixels()
{
    const auto pixelsOf = [&](double units) {
        return static_cast<int>(std::clamp(std::ceil(units * owner.unit), 1.0, double{raster::largestSide}));
    };
    const int width = pixelsOf(where.width()), height = pixelsOf(where.height());
    if (drawn.width() == width && drawn.height() == height)
        return;
    drawn = raster(width, height);
    shown = drawn;
}

void memoryWindow::setPlace(const rectangle &place)
{
    const bool sized = place.width() != where.width() || place.height() != where.height();
    where = place;
    if (!sized)
        return;
    makePixels();
    owner.happen({.kind = eventKind::resize, .window = number});
}

rectangle memoryWindow::border() const
{
    return settings.kind == windowKind::normal ? owner.frameBorder : rectangle{};
}

void memoryWindow::show(bool visible)
{
    if (isVisible == visible)
        return;
    isVisible = visible;
    if (visible)
        owner.happen({.kind = eventKind::expose, .window = number});
    if (visible && (settings.kind == windowKind::normal || settings.kind == windowKind::plain))
        activate();
}

void memoryWindow::activate()
{
    if (!isVisible || owner.focused == number)
        return;
    if (owner.focused != 0)
        owner.happen({.kind = eventKind::focusOut, .window = owner.focused});
    owner.focused = number;
    owner.happen({.kind = eventKind::focusIn, .window = number});
}

void memoryWindow::present(std::span<const pixelRect> parts)
{
    ++presentCount;
    for (const pixelRect &part : parts)
    {
        const pixelRect p{std::max(part.left, 0), std::max(part.top, 0), std::min(part.right, drawn.width()),
                          std::min(part.bottom, drawn.height())};
        for (int y = p.top; y < p.bottom && !p.empty(); ++y)
            std::copy(drawn.row(y) + p.left, drawn.row(y) + p.right, shown.row(y) + p.left);
        pixelCount += std::int64_t{p.width()} * p.height();
    }
}

std::unique_ptr<window> memoryDisplay::open(const windowSettings &settings)
{
    if (isLost)
        throw displayError("The display is gone.");
    auto made = std::make_unique<memoryWindow>(*this, ++lastId, settings);
    if (scriptWindow == 0)
        scriptWindow = made->id();
    return made;
}

/// Events of the display's own doing come before what the script still holds.
void memoryDisplay::happen(const event &e)
{
    script.emplace(std::nextafter(time, -1.0), e);
}

bool memoryDisplay::next(event &e, double wait)
{
    if (isLost || woken.exchange(false))
        return false;
    const double until = time + std::max(emptyPoll, wait);
    if (script.empty() || script.begin()->first > until)
    {
        if (std::isinf(until))
        {
            isLost = true;
            e = {.kind = eventKind::displayLost};
            return true;
        }
        time = until;
        return false;
    }
    time = std::max(time, script.begin()->first);
    e = std::move(script.begin()->second);
    script.erase(script.begin());

    modifierState = e.modifiers;
    if (e.kind == eventKind::keyDown || e.kind == eventKind::keyUp)
        heldKeys[static_cast<int>(e.pressed)] = e.kind == eventKind::keyDown;
    if (e.kind == eventKind::displayLost)
        isLost = true;
    if (memoryWindow *const w = find(e.window);
        w != nullptr && e.kind == eventKind::resize && (e.at.x > 0 || e.at.y > 0))
    {
        w->where.right = w->where.left + std::max(e.at.x, w->smallest.x);
        w->where.bottom = w->where.top + std::max(e.at.y, w->smallest.y);
        w->makePixels();
    }
    return true;
}

bool memoryDisplay::held(key k) const
{
    return heldKeys[static_cast<int>(k)];
}

memoryDisplay &memoryDisplay::to(const window &w)
{
    scriptWindow = w.id();
    return *this;
}

memoryDisplay &memoryDisplay::after(double seconds)
{
    scriptTime = std::max(scriptTime, time) + seconds;
    return *this;
}

memoryDisplay &memoryDisplay::with(std::uint32_t modifiers)
{
    scriptModifiers = modifiers;
    return *this;
}

memoryDisplay &memoryDisplay::post(event e)
{
    scriptTime = std::max(scriptTime, time);
    e.window = e.window != 0 ? e.window : scriptWindow;
    e.modifiers |= scriptModifiers;
    script.emplace(scriptTime, std::move(e));
    return *this;
}

memoryDisplay &memoryDisplay::move(double x, double y)
{
    return post({.kind = eventKind::pointerMove, .at = {x, y}});
}

memoryDisplay &memoryDisplay::press(double x, double y, int button, int clicks)
{
    return post({.kind = eventKind::pointerDown, .at = {x, y}, .button = button, .clicks = clicks});
}

memoryDisplay &memoryDisplay::release(double x, double y, int button)
{
    return post({.kind = eventKind::pointerUp, .at = {x, y}, .button = button});
}

memoryDisplay &memoryDisplay::click(double x, double y, int button)
{
    return move(x, y).press(x, y, button).release(x, y, button);
}

memoryDisplay &memoryDisplay::drag(std::initializer_list<point> way, int button)
{
    const point *const first = way.begin(), *const last = way.end() - 1;
    move(first->x, first->y).press(first->x, first->y, button);
    for (const point *p = first + 1; p <= last; ++p)
        move(p->x, p->y);
    return release(last->x, last->y, button);
}

memoryDisplay &memoryDisplay::wheel(double x, double y, double notches)
{
    return post({.kind = eventKind::wheel, .at = {x, y}, .wheelY = notches});
}

memoryDisplay &memoryDisplay::tap(key k)
{
    keyDown(k);
    const char32_t written = characterOf(k);
    if (written >= 32 && written < 127 && (scriptModifiers & (ctrlModifier | altModifier)) == 0)
        post({.kind = eventKind::text, .text = std::string(1, static_cast<char>(written))});
    return keyUp(k);
}

memoryDisplay &memoryDisplay::keyDown(key k, bool repeat)
{
    return post({.kind = eventKind::keyDown, .pressed = k, .character = characterOf(k), .repeat = repeat});
}

memoryDisplay &memoryDisplay::keyUp(key k)
{
    return post({.kind = eventKind::keyUp, .pressed = k, .character = characterOf(k)});
}

memoryDisplay &memoryDisplay::type(std::string_view utf8)
{
    for (std::size_t i = 0; i < utf8.size();)
    {
        const std::size_t length = std::max<std::size_t>(1, characterLength(utf8.substr(i)));
        const key k = length == 1 ? keyOf(static_cast<unsigned char>(utf8[i])) : key::none;
        keyDown(k);
        post({.kind = eventKind::text, .text = std::string(utf8.substr(i, length))});
        keyUp(k);
        i += length;
    }
    return *this;
}

memoryDisplay &memoryDisplay::drop(double x, double y, std::vector<std::string> files)
{
    return post({.kind = eventKind::dropFiles, .at = {x, y}, .files = std::move(files)});
}

memoryDisplay &memoryDisplay::close()
{
    return post({.kind = eventKind::close});
}

memoryDisplay &memoryDisplay::resize(double width, double height)
{
    return post({.kind = eventKind::resize, .at = {width, height}});
}

memoryDisplay &memoryDisplay::loseDisplay()
{
    return post({.kind = eventKind::displayLost});
}

void memoryDisplay::changeScale(double pixelsPerUnit)
{
    unit = pixelsPerUnit;
    for (const auto &[id, w] : openWindows)
    {
        w->makePixels();
        happen({.kind = eventKind::resize, .window = id});
    }
}

std::vector<memoryWindow *> memoryDisplay::windows() const
{
    std::vector<memoryWindow *> result;
    for (const auto &[id, w] : openWindows)
        result.push_back(w);
    return result;
}

memoryWindow *memoryDisplay::find(windowId id) const
{
    const auto found = openWindows.find(id);
    return found == openWindows.end() ? nullptr : found->second;
}

} // namespace Platform
