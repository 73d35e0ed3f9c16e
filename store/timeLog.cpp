#include "store/timeLog.h"

#include <algorithm>
#include <atomic>
#include <cstdarg>
#include <cstdio>
#include <filesystem>
#include <utility>

namespace Project
{

namespace
{

std::atomic<PTimeLogOwner *> currentOwner{nullptr};

} // namespace

PTimeLogFile::PTimeLogFile(const std::string &directory, const Platform::clock &time)
    : path((std::filesystem::path(directory) / "deblur.log").string()), clock(time)
{
}

void PTimeLogFile::Append(const char *message) noexcept
try
{
    const Platform::calendarTime now = clock.localTime();
    char text[4096];
    const int wanted = std::snprintf(text, sizeof text, "%4d-%02d-%02d %02d:%02d:%02d.%03d %.2047s\n", now.year,
                                     now.month, now.day, now.hour, now.minute, now.second, now.millisecond, message);
    if (wanted > 0)
        Write(text, std::min(static_cast<std::size_t>(wanted), sizeof text - 1));
}
catch (...)
{
    // A lost line is no reason to disturb a run.
}

std::uint32_t PTimeLogFile::Position() const
{
    const std::lock_guard held(lock);
    return position;
}

void PTimeLogFile::Write(const char *text, std::size_t length)
{
    const std::lock_guard held(lock);
    port.clear();
    if (!port.is_open())
    {
        port.rdbuf()->pubsetbuf(nullptr, 0); // a line is one write, so that two processes may share the file
        port.open(path, std::ios::app | std::ios::binary);
        if (!port)
            return;
        port.seekp(0, std::ios::end);
        position = static_cast<std::uint32_t>(std::max<std::streamoff>(port.tellp(), 0));
    }
    if (port.write(text, static_cast<std::streamsize>(length)).flush())
        position += static_cast<std::uint32_t>(length);
}

void SetTimeLogOwner(PTimeLogOwner *owner) noexcept
{
    currentOwner = owner;
}

void LogLine(const char *format, ...) noexcept
{
    PTimeLogOwner *const owner = currentOwner;
    if (!owner || !owner->OutputLog())
        return;

    char message[2048];
    va_list arguments;
    va_start(arguments, format);
    const int wanted = std::vsnprintf(message, sizeof message, format, arguments);
    va_end(arguments);
    if (wanted < 0)
        return;

    try
    {
        if (PTimeLogFile *const file = owner->GetTimeLogFile())
            file->Append(message);
    }
    catch (...)
    {
        // The owner could not make the file: the line is lost.
    }
}

PTimeLogger::PTimeLogger(std::string title, const Platform::clock &time) : clock(time), label(std::move(title))
{
}

void PTimeLogger::Start()
{
    startSeconds = Seconds();
    LogLine("%s Started.", label.c_str());
}

void PTimeLogger::Stop()
{
    LogLine("%s Stopped. Time Cost: %.3f seconds.", label.c_str(), Seconds() - startSeconds);
}

} // namespace Project
