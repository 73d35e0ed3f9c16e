#pragma once

#include <chrono>
#include <cstdio>
#include <string>

namespace Stillmark
{

/// Time since it was made.
class stopwatch
{
public:
    double seconds() const { return std::chrono::duration<double>(std::chrono::steady_clock::now() - began).count(); }

private:
    std::chrono::steady_clock::time_point began = std::chrono::steady_clock::now();
};

/// "1.5 s"
inline std::string secondsText(double seconds)
{
    char text[32];
    std::snprintf(text, sizeof text, "%.1f s", seconds);
    return text;
}

} // namespace Stillmark
