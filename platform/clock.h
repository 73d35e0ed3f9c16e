#pragma once

#include <cstdint>

namespace Platform
{

/// A moment as the user's calendar and wall clock show it. month and day count from 1.
struct calendarTime
{
    int year = 0, month = 0, day = 0;
    int hour = 0, minute = 0, second = 0, millisecond = 0;
};

/// The two clocks of the machine behind one interface, so that a test can set them. Any thread.
class clock
{
public:
    virtual ~clock() = default;

    /// Now, in the user's time zone.
    virtual calendarTime localTime() const = 0;
    /// Milliseconds since some fixed moment; never goes back.
    virtual std::uint64_t ticks() const = 0;
};

const clock &systemClock();

} // namespace Platform
