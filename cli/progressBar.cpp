#include "cli/progressBar.h"

#include <sys/ioctl.h>
#include <unistd.h>

#include <algorithm>
#include <cmath>
#include <cstdio>

namespace Stillmark
{
namespace
{

std::string timeText(double seconds)
{
    const long total = std::lround(std::ceil(seconds));
    if (total < 60)
        return std::to_string(total) + " s";
    const std::string rest = std::to_string(total % 60);
    return std::to_string(total / 60) + ":" + (rest.size() < 2 ? "0" : "") + rest + " min";
}

int terminalColumns()
{
    winsize size = {};
    return ioctl(STDERR_FILENO, TIOCGWINSZ, &size) == 0 && size.ws_col > 0 ? size.ws_col : 80;
}

} // namespace

std::string progressBar::lineFor(const std::string &what, double done, double seconds, int columns)
{
    std::string percent = std::to_string(static_cast<int>(done * 100)) + "%";
    percent.insert(0, 4 - std::min<std::size_t>(4, percent.size()), ' ');
    std::string end = " " + percent;
    if (seconds >= 1 && done >= 0.02)
        end += "  " + timeText(seconds * (1 - done) / done) + " left";

    const int room = columns - 1 - static_cast<int>(what.size() + 3 + end.size()); // the last column would wrap
    const int width = std::min(room, 40);
    std::string bar;
    if (width >= 5)
    {
        const auto filled = static_cast<std::size_t>(std::lround(done * width));
        bar = " [" + std::string(filled, '#') + std::string(static_cast<std::size_t>(width) - filled, '-') + "]";
    }
    return (what + bar + end).substr(0, static_cast<std::size_t>(std::max(0, columns - 1)));
}

void progressBar::prefix(const std::string &text)
{
    const std::lock_guard hold(lock);
    before = text;
}

void progressBar::stage(const std::string &name)
{
    const std::lock_guard hold(lock);
    what = before + name;
    done = 0;
    began = clock::now();
    paint();
}

void progressBar::set(double value)
{
    if (!visible)
        return;
    const std::lock_guard hold(lock);
    done = std::max(done, std::clamp(value, 0.0, 1.0));
    if (clock::now() - painted >= std::chrono::milliseconds(100))
        paint();
}

void progressBar::clear()
{
    const std::lock_guard hold(lock);
    if (onScreen)
        std::fputs("\r\x1b[K", stderr);
    onScreen = false;
    what.clear();
}

void progressBar::paint()
{
    if (!visible || what.empty())
        return;
    painted = clock::now();
    const double seconds = std::chrono::duration<double>(painted - began).count();
    std::fputs(("\r\x1b[K" + lineFor(what, done, seconds, terminalColumns())).c_str(), stderr);
    onScreen = true;
}

} // namespace Stillmark
