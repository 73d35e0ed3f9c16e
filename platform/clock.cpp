#include "platform/clock.h"

#include <chrono>
#include <ctime>

namespace Platform
{

namespace
{

class machineClock final : public clock
{
public:
    calendarTime localTime() const override
    {
        timespec now{};
        std::timespec_get(&now, TIME_UTC);
        std::tm parts{};
        ::localtime_r(&now.tv_sec, &parts);
        return {parts.tm_year + 1900,
                parts.tm_mon + 1,
                parts.tm_mday,
                parts.tm_hour,
                parts.tm_min,
                parts.tm_sec,
                static_cast<int>(now.tv_nsec / 1000000)};
    }

    std::uint64_t ticks() const override
    {
        const auto since = std::chrono::steady_clock::now().time_since_epoch();
        return static_cast<std::uint64_t>(std::chrono::duration_cast<std::chrono::milliseconds>(since).count());
    }
};

} // namespace

const clock &systemClock()
{
    static const machineClock machine;
    return machine;
}

} // namespace Platform
