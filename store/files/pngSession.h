#pragma once

#include <csetjmp>
#include <png.h>

namespace Sarnik
{
class CContainer;
}

namespace Project
{

/// A PNG being read or written through a container. The library reports errors by a long jump, which passes over
/// destructors: every call into it goes through Guarded, and what a guarded function calls holds no object that would
/// have to be destroyed. The library's warnings are dropped, its structures are freed with the object.
class PPngSession
{
public:
    enum class Direction
    {
        Reading,
        Writing
    };
    PPngSession(Sarnik::CContainer &stream, Direction direction);
    PPngSession(const PPngSession &) = delete;
    PPngSession &operator=(const PPngSession &) = delete;
    ~PPngSession();

    /// Whether the library could be set up.
    bool Good() const { return png && info; }

    /// Calls step(png, info, argument); false where the library failed in it. What step leaves behind goes through
    /// argument, which points to objects of the caller.
    template <typename Argument> bool Guarded(void (*step)(png_structp, png_infop, Argument *), Argument *argument)
    {
        if (setjmp(png_jmpbuf(png)))
            return false;
        step(png, info, argument);
        return true;
    }

private:
    png_structp png = nullptr;
    png_infop info = nullptr;
    Direction way;
};

} // namespace Project
