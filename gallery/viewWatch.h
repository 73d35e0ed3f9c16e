#pragma once

#include "framework/views/idler.h"
#include "gallery/messageLog.h"

#include <map>
#include <string>

namespace Sarnik
{
class CWindow;
}

namespace Stillmark
{

/// Writes to the log where the views of the innermost modal window lie, and which one has the focus, whenever that has
/// changed.
class viewWatch final : public Sarnik::CIdler
{
public:
    explicit viewWatch(const messageLog &to) : log(to) {}

    /// Before anything else is written that follows from it.
    void Look();

private:
    bool Idle() override
    {
        Look();
        return false;
    }

    const messageLog &log;
    const Sarnik::CWindow *window = nullptr;
    std::string where, focus;
    std::map<std::string, std::string> places; ///< by the views' names
};

} // namespace Stillmark
