#include "platform/window/sdlDisplay.h"

#include "platform/canvas/canvas.h"

#include <gmock/gmock.h>

#include <SDL.h>

#include <csignal>
#include <cstdlib>
#include <sys/wait.h>
#include <thread>
#include <unistd.h>

using namespace Platform;

namespace
{

/// Everything that comes within a time.
std::vector<event> gather(sdlDisplay &display, double seconds)
{
    std::vector<event> events;
    const double end = display.now() + seconds;
    for (event e; display.now() < end;)
        if (display.next(e, end - display.now()))
            events.push_back(e);
    return events;
}

void paintAndPresent(window &w)
{
    canvas(w.pixels(), w.scale()).fillRectangle({0, 0, 50, 50}, {200, 30, 30});
    const pixelRect all[] = {w.pixels().bounds()};
    w.present(all);
}

TEST(sdlDisplay, TouchesNothingBeforeTheFirstWindow)
{
    const bool wasThere = SDL_WasInit(SDL_INIT_VIDEO) != 0;
    sdlDisplay display;
    event e;
    const double start = display.now();
    EXPECT_FALSE(display.next(e, 0.03));
    EXPECT_GE(display.now() - start, 0.02);
    display.setClipboard("nobody keeps this");
    display.setCursor({cursorShape::hand});
    EXPECT_EQ(display.clipboard(), "");
    EXPECT_EQ(display.modifiers(), 0u);
    EXPECT_FALSE(display.held(key::l));
    std::thread waker([&] { display.wake(); });
    EXPECT_FALSE(display.next(e, 600)) << "woken, not waited";
    waker.join();
    EXPECT_FALSE(display.started());
    EXPECT_EQ(SDL_WasInit(SDL_INIT_VIDEO) != 0, wasThere);
}

TEST(sdlDisplay, WithoutADisplayThereIsAnErrorOnly)
{
    setenv("SDL_VIDEODRIVER", "x11", 1);
    setenv("DISPLAY", ":4711", 1);
    sdlDisplay display;
    EXPECT_THROW(display.open({.place = {0, 0, 100, 100}}), displayError);
    EXPECT_FALSE(display.started());
    EXPECT_FALSE(display.lost());
}

/// The library's own display without a screen: what is pushed into its queue comes out as our events.
TEST(sdlDisplay, TranslatesWhatTheLibraryTells)
{
    setenv("SDL_VIDEODRIVER", "dummy", 1);
    setenv("STILLMARK_SCALE", "2", 1);
    sdlDisplay display;
    const auto w = display.open({.title = "Test", .resizable = true, .placed = true, .place = {10, 10, 210, 110}});
    unsetenv("STILLMARK_SCALE");
    EXPECT_EQ(w->scale(), 2);
    EXPECT_EQ(w->pixels().width(), 400);
    w->show(true);
    paintAndPresent(*w);
    gather(display, 0.02);

    const auto push = [&](Uint32 type, auto fill) {
        SDL_Event e{};
        e.type = type;
        fill(e);
        SDL_PushEvent(&e);
    };
    const auto motion = [&](int x, int y) {
        push(SDL_MOUSEMOTION, [&](SDL_Event &e) { e.motion.windowID = w->id(), e.motion.x = x, e.motion.y = y; });
    };
    const auto keyEvent = [&](Uint32 type, SDL_Keycode code, Uint16 mod = 0) {
        push(type, [&](SDL_Event &e) { e.key.windowID = w->id(), e.key.keysym.sym = code, e.key.keysym.mod = mod; });
    };
    motion(10, 10);
    motion(20, 30);
    push(SDL_MOUSEBUTTONDOWN, [&](SDL_Event &e) {
        e.button.windowID = w->id(), e.button.button = SDL_BUTTON_RIGHT, e.button.x = 41, e.button.clicks = 2;
    });
    push(SDL_MOUSEWHEEL, [&](SDL_Event &e) {
        e.wheel.windowID = w->id(), e.wheel.preciseY = 1, e.wheel.direction = SDL_MOUSEWHEEL_FLIPPED;
    });
    keyEvent(SDL_KEYDOWN, SDLK_KP_8, KMOD_LALT | KMOD_RCTRL);
    keyEvent(SDL_KEYUP, SDLK_KP_8, KMOD_NUM | KMOD_RALT);
    keyEvent(SDL_KEYDOWN, SDLK_F13);
    keyEvent(SDL_KEYDOWN, 0xE4);
    push(SDL_TEXTINPUT, [&](SDL_Event &e) { e.text.windowID = w->id(), SDL_strlcpy(e.text.text, "\xC3\xA4", 8); });
    push(SDL_DROPBEGIN, [&](SDL_Event &e) { e.drop.windowID = w->id(); });
    for (int i = 0; i < 3; ++i)
        push(SDL_DROPFILE, [&](SDL_Event &e) { e.drop.windowID = w->id(), e.drop.file = SDL_strdup("/a/b.knl"); });
    push(SDL_DROPCOMPLETE, [&](SDL_Event &e) { e.drop.windowID = w->id(); });
    push(SDL_MOUSEMOTION, [&](SDL_Event &e) { e.motion.windowID = w->id() + 77; });
    push(SDL_WINDOWEVENT, [&](SDL_Event &e) { e.window.windowID = w->id(), e.window.event = SDL_WINDOWEVENT_CLOSE; });

    const std::vector<event> got = gather(display, 0.05);
    ASSERT_EQ(got.size(), 10u);
    EXPECT_EQ(got[0].kind, eventKind::pointerMove);
    EXPECT_EQ(got[0].at, (point{10, 15})) << "the last of the moves, in view units";
    EXPECT_EQ(got[1].button, 3);
    EXPECT_EQ(got[1].clicks, 2);
    EXPECT_EQ(got[1].at.x, 20.5);
    EXPECT_EQ(got[2].wheelY, -1);
    EXPECT_EQ(got[3].pressed, key::up);
    EXPECT_EQ(got[3].modifiers, altModifier | ctrlModifier);
    EXPECT_EQ(got[4].pressed, key::keypad8);
    EXPECT_EQ(got[4].kind, eventKind::keyUp);
    EXPECT_EQ(got[4].modifiers, 0u) << "the right Alt belongs to typing";
    EXPECT_EQ(got[5].pressed, key::f13);
    EXPECT_EQ(got[6].character, 0xE4u);
    EXPECT_EQ(got[7].text, "\xC3\xA4");
    EXPECT_EQ(got[8].files.size(), 3u);
    EXPECT_EQ(got[9].kind, eventKind::close);

    w->setPlace({10, 10, 160, 60});
    gather(display, 0.02);
    EXPECT_EQ(w->pixels().width(), 300);
    paintAndPresent(*w);
    display.setClipboard("kept");
    EXPECT_EQ(display.clipboard(), "kept");
    for (int shape = 0; shape <= static_cast<int>(cursorShape::forbidden); ++shape)
        display.setCursor({static_cast<cursorShape>(shape)});
    display.setCursor({.image = std::make_shared<raster>(16, 16), .hotX = 3, .hotY = 4});
    std::thread waker([&] { display.wake(); });
    event e;
    const double start = display.now();
    EXPECT_FALSE(display.next(e, 600));
    EXPECT_LT(display.now() - start, 300);
    waker.join();
}

TEST(sdlDisplay, CountsTheClicksOfEachWindowForItself)
{
    setenv("SDL_VIDEODRIVER", "dummy", 1);
    sdlDisplay display;
    const auto first = display.open({.place = {0, 0, 50, 50}}), second = display.open({.place = {0, 0, 50, 50}});
    const std::pair<window *, int> clicks[] = {{first.get(), 1},  {first.get(), 2},  {second.get(), 3},
                                               {second.get(), 4}, {second.get(), 1}, {second.get(), 2}};
    gather(display, 0.02);
    for (const auto &[where, told] : clicks)
    {
        SDL_Event e{};
        e.type = SDL_MOUSEBUTTONDOWN;
        e.button.windowID = where->id(), e.button.button = SDL_BUTTON_LEFT;
        e.button.clicks = static_cast<Uint8>(told);
        SDL_PushEvent(&e);
    }
    std::vector<int> counted;
    for (const event &e : gather(display, 0.05))
        counted.push_back(e.clicks);
    EXPECT_EQ(counted, (std::vector<int>{1, 2, 1, 2, 1, 2}));
}

/// A virtual screen of our own.
struct virtualScreen
{
    virtualScreen()
    {
        int number[2];
        if (pipe(number) != 0)
            return;
        server = fork();
        if (server == 0)
        {
            close(number[0]);
            const std::string to = std::to_string(number[1]);
            execlp("Xvfb", "Xvfb", "-displayfd", to.c_str(), "-screen", "0", "800x600x24", "-nolisten", "tcp",
                   static_cast<char *>(nullptr));
            _exit(127);
        }
        close(number[1]);
        // Digits and a line end, in any number of pieces; nothing where there is no server.
        std::string text;
        for (char c = 0; read(number[0], &c, 1) == 1 && c != '\n';)
            text += c;
        if (!text.empty())
            name = ":" + text;
        close(number[0]);
    }
    ~virtualScreen() { End(); }
    void End()
    {
        if (server > 0)
        {
            kill(server, SIGKILL);
            waitpid(server, nullptr, 0);
        }
        server = -1;
    }
    pid_t server = -1;
    std::string name; ///< empty without a server
};

/// 0 where a window could be shown, the loss of its screen was told, and nothing crashed.
int showAndLose(bool painting)
{
    virtualScreen screen;
    setenv("SDL_VIDEODRIVER", "x11", 1);
    setenv("DISPLAY", screen.name.c_str(), 1);
    sdlDisplay display;
    auto w = display.open({.title = "Test", .placed = true, .place = {40, 50, 240, 150}});
    auto popup = display.open({.kind = windowKind::popup, .placed = true, .place = {60, 60, 90, 90}, .owner = w.get()});
    w->show(true);
    popup->show(true);
    bool exposed = false;
    for (const event &e : gather(display, 0.5))
        exposed = exposed || e.kind == eventKind::expose;
    paintAndPresent(*w);
    paintAndPresent(*popup);
    if (!exposed || w->place().width() != 200 || w->place().left != 40)
        return 2;
    popup.reset();

    screen.End();
    event e;
    bool told = false;
    for (const double end = display.now() + 10; display.now() < end && !told;)
    {
        if (painting)
            paintAndPresent(*w);
        told = display.next(e, painting ? 0.1 : 1000) && e.kind == eventKind::displayLost;
    }
    if (!told || !display.lost())
        return 3;
    paintAndPresent(*w);
    w->show(false);
    w->setTitle("nobody sees it");
    w.reset();
    try
    {
        sdlDisplay().open({.place = {0, 0, 10, 10}});
    }
    catch (const displayError &)
    {
        return 0;
    }
    return 4;
}

TEST(sdlDisplay, ShowsWindowsOnAScreenAndSurvivesItsLoss)
{
    if (virtualScreen().name.empty())
        GTEST_SKIP() << "there is no Xvfb here";
    testing::FLAGS_gtest_death_test_style = "threadsafe";
    EXPECT_EXIT(std::exit(showAndLose(true)), testing::ExitedWithCode(0), "");
    EXPECT_EXIT(std::exit(showAndLose(false)), testing::ExitedWithCode(0), "");
}

} // namespace
