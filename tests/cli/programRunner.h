#pragma once

#include "deblur/estimate/floatArray.h"
#include "tests/support/temporaryFolder.h"

#include <chrono>
#include <cstdint>
#include <filesystem>
#include <optional>
#include <string>
#include <vector>

/// Starts the built program the way a shell would.
namespace TestSupport
{

struct programRun
{
    int status = -1; ///< exit status; -1 when a signal ended it
    std::string out, err;
    double seconds = 0; ///< from the signal, if one was sent, to the end
};

struct runRules
{
    std::optional<std::uint64_t> largestFile = {};             ///< bytes; writing past them fails, as on a full disk
    std::optional<std::chrono::milliseconds> signalAfter = {}; ///< send `signals` then, a moment apart
    std::vector<int> signals = {};
};

/// Runs the program in `folder`. A run of more than a minute is killed.
programRun runProgram(const std::filesystem::path &folder, const std::vector<std::string> &arguments,
                      const runRules &rules = {});

/// A grey picture in the format that the extension names; .pfm holds the samples exactly, others 16 or 8 bits.
void writeGrey(const std::string &path, const CorvaneDeblur::floatArray &grey);
CorvaneDeblur::floatArray readGrey(const std::string &path);

} // namespace TestSupport
