#include "platform/window/sdlConnection.h"

#include <SDL_syswm.h>

#include <dlfcn.h>

namespace Platform
{
namespace
{

#if defined(SDL_VIDEO_DRIVER_X11)
extern "C" void connectionEnded(Display *, void *lost)
{
    static_cast<std::atomic<bool> *>(lost)->store(true);
}
#endif

} // namespace

void watchConnection(SDL_Window *window, std::atomic<bool> &lost)
{
#if defined(SDL_VIDEO_DRIVER_X11)
    SDL_SysWMinfo info;
    SDL_VERSION(&info.version);
    if (SDL_GetWindowWMInfo(window, &info) != SDL_TRUE || info.subsystem != SDL_SYSWM_X11)
        return;
    // By default the X library ends the process when its server goes. It is there already, loaded by SDL; asking for
    // its function by name keeps it out of what the plug-in needs in order to load.
    using setter = void (*)(Display *, void (*)(Display *, void *), void *);
    void *const library = dlopen("libX11.so.6", RTLD_LAZY | RTLD_NOLOAD);
    if (library == nullptr)
        return;
    if (const auto set = reinterpret_cast<setter>(dlsym(library, "XSetIOErrorExitHandler")))
        set(info.info.x11.display, connectionEnded, &lost);
    dlclose(library);
#else
    (void)window;
    (void)lost;
#endif
}

} // namespace Platform
