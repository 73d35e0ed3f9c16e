#pragma once

#include "platform/window/display.h"

#include <memory>

namespace Platform
{

/// The user's screen. Nothing of the window system is touched before the first window is opened: until then there are
/// no events, no modifiers, and an empty clipboard. When the last window is gone the connection stays until the display
/// goes. After the loss of a display a process can open no other one.
///
/// The scale comes from the environment variable STILLMARK_SCALE (1 to 4), otherwise from GDK_SCALE, otherwise from the
/// screen's density: 2 on screens twice as dense as usual. Where the window system scales by itself its scale counts.
///
/// The right Alt key counts as a part of typing, not as Alt. At most one at a time. Main thread.
class sdlDisplay final : public display
{
public:
    sdlDisplay();
    ~sdlDisplay() override;

    /// The connection was made.
    bool started() const;

    std::unique_ptr<window> open(const windowSettings &settings) override;
    bool next(event &e, double wait) override;
    void wake() noexcept override;
    bool lost() const override;
    double now() const override;
    std::uint32_t modifiers() const override;
    bool held(key k) const override;
    std::string clipboard() const override;
    void setClipboard(std::string_view text) override;
    void setCursor(const cursor &c) override;
    void beep() override;
    rectangle workArea() const override;

    struct connection;

private:
    std::unique_ptr<connection> link;
};

} // namespace Platform
