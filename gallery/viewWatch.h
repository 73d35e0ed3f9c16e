#pragma once

#include "framework/messages/objectId.h"
#include "framework/views/idler.h"
#include "gallery/messageLog.h"

#include <map>
#include <string>

namespace Sarnik
{
class CContext;
class CWindow;
} // namespace Sarnik

namespace Stillmark
{

/// Writes to the log where the views of the innermost modal window lie, and which one has the focus, whenever that has
/// changed.
class viewWatch final : public Sarnik::CIdler
{
public:
    explicit viewWatch(const messageLog &to) : log(to) {}

private:
    bool Idle() override;
    void Look(const Sarnik::CContext &within, std::map<Sarnik::CObjID, std::string> &found) const;

    const messageLog &log;
    const Sarnik::CWindow *window = nullptr;
    std::string where, focus;
    std::map<Sarnik::CObjID, std::string> places;
};

} // namespace Stillmark
