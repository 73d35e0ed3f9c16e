#pragma once

#include "host/plugin/recordedAction.h"
#include "shell/tintorel.h"

#include <cstdint>
#include <functional>
#include <map>
#include <optional>
#include <set>
#include <string>
#include <vector>

namespace Stillmark
{

/// An alert that the plug-in showed, and what it was answered.
struct hostAlert
{
    TNAlertKind kind = TNAlertOk;
    std::string title, first, second; ///< UTF-8, whatever the plug-in's bytes were
    std::int32_t answer = TNAnswerOk;
};

/// What a host of ours offers to a run. The functions are called on the run's thread; what they throw ends the run and
/// reaches the caller of runPlugin.
struct hostOptions
{
    bool interactive = false; ///< a dialog may be shown: the run begins with Parameters
    bool playing = false;     ///< a recorded action is being played
    bool continues = false;   ///< sends Continue between Start and Finish

    std::optional<std::int32_t> version = 14 << 16;    ///< major << 16 | minor << 8 | fix; none: it does not tell
    int threads = 0;                                   ///< the most that the plug-in is to use; 0: as it likes
    std::map<std::uint32_t, std::intptr_t> properties; ///< further ones, by key

    std::int64_t maxSpace = 0;                ///< bytes for the run; 0: half of the machine's memory
    std::optional<std::uint64_t> bufferLimit; ///< bytes that the buffer suite gives; none: as long as there is memory
    std::vector<std::string> scratchFolders;  ///< the best first

    const recordedAction *action = nullptr; ///< what the plug-in finds recorded; copied

    /// Each in its turn answers a Yes/No alert; after the last the answer is No.
    std::vector<TNAlertAnswer> answers;
    /// Where alerts go; none: a line each on stderr.
    std::function<void(const hostAlert &)> alert;
    std::function<void(std::int64_t done, std::int64_t total)> progress;
    std::function<bool()> abort; ///< true: the user has asked the run to stop

    /// What an older or a poorer host lacks.
    bool bounds32 = true;                 ///< coordinates beyond 32767
    bool scripting = true;                ///< the slot for a recorded action
    bool suites = true;                   ///< any suite at all
    bool blockPixels = true;              ///< the block's own functions to read and write pixels
    bool alerts = true;                   ///< the table of alerts
    std::set<std::string> withheldSuites; ///< by name
};

} // namespace Stillmark
