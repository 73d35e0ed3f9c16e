#pragma once

#include <chrono>
#include <mutex>
#include <string>

namespace Stillmark
{

/// One line on the terminal: what is being done, how far it is, how long it will still take.
class progressBar
{
public:
    using clock = std::chrono::steady_clock;

    /// shown false: nothing is ever printed.
    explicit progressBar(bool shown) : visible(shown) {}
    progressBar(const progressBar &) = delete;
    progressBar &operator=(const progressBar &) = delete;
    ~progressBar() { clear(); }

    /// Stands in front of every stage from now on, such as "3/17 ".
    void prefix(const std::string &text);
    /// Begins the next piece of work, such as "Reading".
    void stage(const std::string &what);
    /// Part of the stage that is done, 0 to 1; it never goes back. Any thread.
    void set(double done);
    /// Takes the line off the terminal.
    void clear();

    /// The line, at most `columns` wide. The time left is told once it can be guessed: after a second and 2%.
    static std::string lineFor(const std::string &what, double done, double seconds, int columns);

private:
    void paint();

    const bool visible;
    std::mutex lock; ///< guards all that follows
    std::string before, what;
    double done = 0;
    clock::time_point began, painted;
    bool onScreen = false;
};

} // namespace Stillmark
