#pragma once

#include "platform/clock.h"

#include <cstdint>
#include <fstream>
#include <mutex>
#include <string>

/// A developer's aid: "deblur.log" in the preferences directory, time-stamped lines that tell how long things took.
/// It is written when the behavioral parameters say ui.output_log=true; else a line costs one test. It only grows, and
/// whatever goes wrong with it, a line is lost and nothing else happens.
namespace Project
{

/// Where the lines go. The file is opened, or created, by the first of them; after a failure the next one tries again.
/// Any thread: lines come whole and one after the other.
class PTimeLogFile
{
public:
    explicit PTimeLogFile(const std::string &directory, const Platform::clock &time = Platform::systemClock());

    /// Appends "YYYY-MM-DD HH:MM:SS.mmm message" and a line feed. A message is cut after 2047 bytes.
    void Append(const char *message) noexcept;

    /// The file's length as far as this object knows; modulo 2^32.
    std::uint32_t Position() const;

private:
    void Write(const char *text, std::size_t length);

    const std::string path;
    const Platform::clock &clock;
    mutable std::mutex lock;
    std::ofstream port; ///< not open until there is a line
    std::uint32_t position = 0;
};

/// What the log wants to know of the one run that is going on; the filter is that.
class PTimeLogOwner
{
public:
    /// The current record's outputLog. Any thread.
    virtual bool OutputLog() const = 0;
    /// Called when OutputLog() said yes, by the thread that logs; null drops the line.
    virtual PTimeLogFile *GetTimeLogFile() = 0;

protected:
    ~PTimeLogOwner() = default;
};

/// Null, the state at the start, drops all lines. Set it before work starts on other threads and put null back after
/// the last of them is joined.
void SetTimeLogOwner(PTimeLogOwner *owner) noexcept;

/// One line; a message is cut after 2047 bytes. Any thread.
void LogLine(const char *format, ...) noexcept __attribute__((format(printf, 1, 2)));

/// Tells how long something took, in steps of a millisecond.
class PTimeLogger
{
public:
    explicit PTimeLogger(std::string title, const Platform::clock &time = Platform::systemClock());
    PTimeLogger(const PTimeLogger &) = delete;
    PTimeLogger &operator=(const PTimeLogger &) = delete;
    virtual ~PTimeLogger() = default;

    void Start(); ///< logs "<label> Started."
    void Stop();  ///< logs "<label> Stopped. Time Cost: <seconds since Start> seconds."

private:
    double Seconds() const { return static_cast<double>(clock.ticks()) / 1000.0; }

    const Platform::clock &clock;
    double startSeconds = 0.0;
    std::string label;
};

} // namespace Project
