#pragma once

#include "cli/options.h"
#include "cli/progressBar.h"

#include <functional>
#include <string>
#include <vector>

namespace Stillmark
{

/// What a command has at hand while it runs.
struct runContext
{
    progressBar &bar;
    /// Plain sentences for the user about what did not go as one might expect; shown when the command has ended.
    std::vector<std::string> notes;

    /// For host functions: moves the bar, and stops the work after Ctrl-C.
    progressCheck progress();
};

/// What a command answers.
struct commandResult
{
    int status = 0;
    std::string text; ///< for people; without the last line's end
    std::string json; ///< the same for programs
};

using commandBody = std::function<commandResult(runContext &)>;

/// Runs body with the threads that options allow, shows progress where there is a terminal, and prints notes (standard
/// error) and the result (standard output). Whatever is thrown becomes one line on the standard error. Returns the
/// exit status.
int runCommand(const commonOptions &options, const commandBody &body);

} // namespace Stillmark
