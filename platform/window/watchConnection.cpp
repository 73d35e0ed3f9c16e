#include "platform/window/sdlConnection.h"

#include <SDL_syswm.h>

#if defined(SDL_VIDEO_DRIVER_X11)
#include <X11/Xproto.h>
#endif

#include <dlfcn.h>

namespace Platform
{

#if defined(SDL_VIDEO_DRIVER_X11)

namespace
{

// By default the X library ends the process when its server goes, in two places: in the handler of such errors, which
// is one for the process, and after it, in a second one of each connection. Both are replaced, the first for our
// connection only: a host may have one of its own. Asking for the library's functions by name keeps it out of what the
// plug-in needs in order to load. It is held until the handlers are back, as SDL leaves it first.
using errorHandler = int (*)(Display *);
using exitHandler = void (*)(Display *, void *);
using requestHandler = int (*)(Display *, XErrorEvent *);
using eventReader = Bool (*)(Display *, XEvent *, xEvent *);

Display *watched = nullptr;
void *library = nullptr;
std::atomic<std::atomic<bool> *> toldOfLoss = nullptr;
errorHandler before = nullptr;
requestHandler requestBefore = nullptr;

template <class Function> Function libraryFunction(const char *name)
{
    return reinterpret_cast<Function>(dlsym(library, name));
}

void leaveLibrary()
{
    dlclose(library);
    library = nullptr;
}

int connectionFailed(Display *which)
{
    return which != watched && before != nullptr ? before(which) : 0;
}

/// A request that names a window which has gone meanwhile, or one that is not shown yet, also ends the process by
/// default. SDL makes such requests, on a second connection that it keeps to itself, to wake itself in a window that is
/// about to close. They come to nothing; all other errors go on to whoever had them before.
int requestFailed(Display *which, XErrorEvent *error)
{
    const bool late = error->error_code == BadWindow || error->error_code == BadDrawable ||
                      (error->error_code == BadMatch && error->request_code == X_SetInputFocus);
    return late || requestBefore == nullptr ? 0 : requestBefore(which, error);
}

/// Events of changed properties are dropped. SDL asks the server for the names of some, and crashes when the connection
/// ends before the answer; all that it learns from them is which windows are maximised, which nobody here asks.
Bool dropEvent(Display *, XEvent *, xEvent *)
{
    return False;
}

/// Puts back the handler from before ours, unless somebody else's came after it.
template <class Handler> void restore(const char *setter, Handler ours, Handler old)
{
    const auto set = libraryFunction<Handler (*)(Handler)>(setter);
    if (const Handler last = set(old); last != ours)
        set(last);
}

void connectionEnded(Display *, void *)
{
    if (std::atomic<bool> *const lost = toldOfLoss)
        *lost = true;
}

} // namespace

void watchRequests()
{
    if (library != nullptr)
        return;
    library = dlopen("libX11.so.6", RTLD_LAZY);
    if (library == nullptr)
        return;
    const auto set = libraryFunction<requestHandler (*)(requestHandler)>("XSetErrorHandler");
    if (set == nullptr)
        return leaveLibrary();
    requestBefore = set(requestFailed);
}

void watchConnection(SDL_Window *window, std::atomic<bool> &lost)
{
    SDL_SysWMinfo info;
    SDL_VERSION(&info.version);
    if (library == nullptr || watched != nullptr || SDL_GetWindowWMInfo(window, &info) != SDL_TRUE ||
        info.subsystem != SDL_SYSWM_X11)
        return;
    const auto setExit = libraryFunction<void (*)(Display *, exitHandler, void *)>("XSetIOErrorExitHandler");
    const auto setError = libraryFunction<errorHandler (*)(errorHandler)>("XSetIOErrorHandler");
    const auto setReader = libraryFunction<eventReader (*)(Display *, int, eventReader)>("XESetWireToEvent");
    if (setExit == nullptr || setError == nullptr || setReader == nullptr)
        return;
    watched = info.info.x11.display;
    toldOfLoss = &lost;
    setExit(watched, connectionEnded, nullptr);
    setReader(watched, PropertyNotify, dropEvent);
    before = setError(connectionFailed);
}

void unwatch()
{
    if (watched != nullptr)
        restore("XSetIOErrorHandler", connectionFailed, before);
    watched = nullptr;
    toldOfLoss = nullptr;
    if (library == nullptr)
        return;
    restore("XSetErrorHandler", requestFailed, requestBefore);
    leaveLibrary();
}

#else

void watchRequests()
{
}
void watchConnection(SDL_Window *, std::atomic<bool> &)
{
}
void unwatch()
{
}

#endif

} // namespace Platform
