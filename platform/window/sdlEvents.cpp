#include "platform/window/sdlConnection.h"

#include <utility>

namespace Platform
{
namespace
{

constexpr std::pair<SDL_Keycode, key> special[] = {{SDLK_RETURN, key::enter},
                                                   {SDLK_RETURN2, key::enter},
                                                   {SDLK_ESCAPE, key::escape},
                                                   {SDLK_BACKSPACE, key::backspace},
                                                   {SDLK_TAB, key::tab},
                                                   {SDLK_DELETE, key::del},
                                                   {SDLK_LEFT, key::left},
                                                   {SDLK_RIGHT, key::right},
                                                   {SDLK_UP, key::up},
                                                   {SDLK_DOWN, key::down},
                                                   {SDLK_HOME, key::home},
                                                   {SDLK_END, key::end},
                                                   {SDLK_PAGEUP, key::pageUp},
                                                   {SDLK_PAGEDOWN, key::pageDown},
                                                   {SDLK_INSERT, key::insert},
                                                   {SDLK_APPLICATION, key::menu},
                                                   {SDLK_MENU, key::menu},
                                                   {SDLK_KP_PLUS, key::keypadPlus},
                                                   {SDLK_KP_MINUS, key::keypadMinus},
                                                   {SDLK_KP_MULTIPLY, key::keypadTimes},
                                                   {SDLK_KP_DIVIDE, key::keypadDivide},
                                                   {SDLK_KP_PERIOD, key::keypadPoint},
                                                   {SDLK_KP_ENTER, key::keypadEnter},
                                                   {SDLK_KP_0, key::keypad0}};

key keyFrom(SDL_Keycode code)
{
    const auto from = [&](key first, SDL_Keycode start) {
        return static_cast<key>(static_cast<int>(first) + (code - start));
    };
    // The codes of F1 to F12 follow one another, as do those of F13 to F24 and of the keypad's 1 to 9.
    if (code >= SDLK_F1 && code <= SDLK_F12)
        return from(key::f1, SDLK_F1);
    if (code >= SDLK_F13 && code <= SDLK_F24)
        return from(key::f13, SDLK_F13);
    if (code >= SDLK_KP_1 && code <= SDLK_KP_9)
        return from(key::keypad1, SDLK_KP_1);
    for (const auto &[known, meaning] : special)
        if (known == code)
            return meaning;
    return code > 0 && code < 128 ? keyOf(static_cast<char32_t>(code)) : key::none;
}

/// Keypad keys are movements without the number lock.
key withoutNumberLock(key k)
{
    constexpr std::pair<key, key> moves[] = {{key::keypadPoint, key::del},  {key::keypad0, key::insert},
                                             {key::keypad1, key::end},      {key::keypad2, key::down},
                                             {key::keypad3, key::pageDown}, {key::keypad4, key::left},
                                             {key::keypad6, key::right},    {key::keypad7, key::home},
                                             {key::keypad8, key::up},       {key::keypad9, key::pageUp}};
    for (const auto &[from, to] : moves)
        if (from == k)
            return to;
    return k;
}

void translateKey(const SDL_KeyboardEvent &from, event &to)
{
    to.kind = from.type == SDL_KEYDOWN ? eventKind::keyDown : eventKind::keyUp;
    to.pressed = keyFrom(from.keysym.sym);
    if ((from.keysym.mod & KMOD_NUM) == 0)
        to.pressed = withoutNumberLock(to.pressed);
    to.character = characterOf(to.pressed);
    // Letters of other alphabets have no key of ours, but their character.
    if (to.pressed == key::none && from.keysym.sym >= 128 && (from.keysym.sym & SDLK_SCANCODE_MASK) == 0)
        to.character = static_cast<char32_t>(from.keysym.sym);
    to.repeat = from.repeat != 0;
    to.modifiers = modifiersOf(static_cast<SDL_Keymod>(from.keysym.mod));
}

int buttonOf(Uint8 button)
{
    return button == SDL_BUTTON_LEFT ? 1 : button == SDL_BUTTON_MIDDLE ? 2 : button == SDL_BUTTON_RIGHT ? 3 : 0;
}

bool translateWindow(sdlDisplay::connection &link, const SDL_WindowEvent &from, event &to)
{
    switch (from.event)
    {
    case SDL_WINDOWEVENT_EXPOSED:
        to.kind = eventKind::expose;
        return true;
    case SDL_WINDOWEVENT_DISPLAY_CHANGED:
    case SDL_WINDOWEVENT_SIZE_CHANGED:
        link.windows[from.windowID]->sizeChanged();
        to.kind = eventKind::resize;
        return true;
    case SDL_WINDOWEVENT_CLOSE:
        to.kind = eventKind::close;
        return true;
    case SDL_WINDOWEVENT_FOCUS_GAINED:
        to.kind = eventKind::focusIn;
        return true;
    case SDL_WINDOWEVENT_FOCUS_LOST:
        to.kind = eventKind::focusOut;
        return true;
    case SDL_WINDOWEVENT_LEAVE:
        to.kind = eventKind::pointerLeave;
        return true;
    default:
        return false;
    }
}

bool translateDrop(sdlDisplay::connection &link, const SDL_DropEvent &from, event &to)
{
    // A hostile source cannot make us gather paths for ever.
    constexpr std::size_t mostFiles = 10'000;
    switch (from.type)
    {
    case SDL_DROPBEGIN:
        link.dropped.clear();
        return false;
    case SDL_DROPFILE:
        if (from.file != nullptr && link.dropped.size() < mostFiles)
            link.dropped.emplace_back(from.file);
        return false;
    default:
        break;
    }
    to.kind = eventKind::dropFiles;
    to.files = std::exchange(link.dropped, {});
    // The source holds the pointer: the window has not seen it move.
    int x = 0, y = 0;
    SDL_GetGlobalMouseState(&x, &y);
    const rectangle place = link.windows[from.windowID]->place();
    to.at = {x / link.pointsPerUnit - place.left, y / link.pointsPerUnit - place.top};
    return !to.files.empty();
}

/// The window that an event speaks of; 0 for others.
Uint32 windowOf(const SDL_Event &e)
{
    switch (e.type)
    {
    case SDL_WINDOWEVENT:
        return e.window.windowID;
    case SDL_MOUSEMOTION:
        return e.motion.windowID;
    case SDL_MOUSEBUTTONDOWN:
    case SDL_MOUSEBUTTONUP:
        return e.button.windowID;
    case SDL_MOUSEWHEEL:
        return e.wheel.windowID;
    case SDL_KEYDOWN:
    case SDL_KEYUP:
        return e.key.windowID;
    case SDL_TEXTINPUT:
        return e.text.windowID;
    case SDL_DROPBEGIN:
    case SDL_DROPFILE:
    case SDL_DROPCOMPLETE:
        return e.drop.windowID;
    default:
        return 0;
    }
}

} // namespace

std::uint32_t modifiersOf(SDL_Keymod state)
{
    return ((state & KMOD_LALT) != 0 ? altModifier : 0u) | ((state & KMOD_CTRL) != 0 ? ctrlModifier : 0u) |
           ((state & KMOD_SHIFT) != 0 ? shiftModifier : 0u);
}

SDL_Scancode scancodeOf(key k)
{
    for (const auto &[code, meaning] : special)
        if (meaning == k)
            return SDL_GetScancodeFromKey(code);
    const char32_t character = characterOf(k);
    return character != 0 ? SDL_GetScancodeFromKey(static_cast<SDL_Keycode>(character)) : SDL_SCANCODE_UNKNOWN;
}

bool translate(sdlDisplay::connection &link, const SDL_Event &from, event &to)
{
    to = {};
    if (from.type == SDL_QUIT)
    {
        // Nobody else sends it: the window system's end of the connection has closed.
        link.isLost = true;
        return false;
    }
    to.window = windowOf(from);
    if (!link.windows.contains(to.window))
        return false;
    to.modifiers = modifiersOf(SDL_GetModState());
    const auto at = [&](double x, double y) { return point{x / link.pointsPerUnit, y / link.pointsPerUnit}; };
    switch (from.type)
    {
    case SDL_WINDOWEVENT:
        return translateWindow(link, from.window, to);
    case SDL_MOUSEMOTION:
        to.kind = eventKind::pointerMove;
        to.at = at(from.motion.x, from.motion.y);
        return true;
    case SDL_MOUSEBUTTONDOWN:
    case SDL_MOUSEBUTTONUP:
        to.kind = from.type == SDL_MOUSEBUTTONDOWN ? eventKind::pointerDown : eventKind::pointerUp;
        to.at = at(from.button.x, from.button.y);
        to.button = buttonOf(from.button.button);
        // The library goes on counting from one window to the next, in coordinates of either.
        if (link.clickedWindow != 0 && link.clickedWindow != from.button.windowID)
            link.clicksElsewhere = from.button.clicks - 1;
        else if (from.button.clicks <= link.clicksElsewhere)
            link.clicksElsewhere = 0;
        link.clickedWindow = from.button.windowID;
        to.clicks = from.button.clicks - link.clicksElsewhere;
        return to.button != 0;
    case SDL_MOUSEWHEEL:
    {
        const double sign = from.wheel.direction == SDL_MOUSEWHEEL_FLIPPED ? -1 : 1;
        to.kind = eventKind::wheel;
        to.at = at(from.wheel.mouseX, from.wheel.mouseY);
        to.wheelX = sign * static_cast<double>(from.wheel.preciseX);
        to.wheelY = sign * static_cast<double>(from.wheel.preciseY);
        return true;
    }
    case SDL_KEYDOWN:
    case SDL_KEYUP:
        translateKey(from.key, to);
        return true;
    case SDL_TEXTINPUT:
        to.kind = eventKind::text;
        to.text = from.text.text;
        return !to.text.empty();
    case SDL_DROPBEGIN:
    case SDL_DROPFILE:
    case SDL_DROPCOMPLETE:
        return translateDrop(link, from.drop, to);
    default:
        return false;
    }
}

} // namespace Platform
