#pragma once

#include "host/plugin/hostOptions.h"
#include "host/plugin/recordedAction.h"
#include "shell/tintorel.h"

#include <cstdint>
#include <map>
#include <optional>
#include <string>
#include <vector>

namespace Stillmark
{

/// What a plug-in had not given back when its run was over. The host has freed it since.
struct leakReport
{
    std::uint64_t handles = 0, handleBytes = 0;
    std::uint64_t buffers = 0, bufferBytes = 0;
    std::uint64_t descriptors = 0;
    std::map<std::string, int> suites; ///< "name, version N" and how often it was not released

    bool empty() const { return handles + buffers + descriptors == 0 && suites.empty(); }
    /// One line: "2 buffers (512 bytes), suite Tintorel Buffer Suite for Plug-ins, version 1"; empty for none.
    std::string text() const;
};

/// How a run ended.
struct hostOutcome
{
    TNError result = TNNoError;             ///< of the selector that failed, else 0
    std::optional<TNSelector> failedAt;     ///< none: each gave 0
    std::vector<hostAlert> alerts;          ///< in the order in which they were shown
    bool wrote = false;                     ///< samples arrived in the picture
    std::optional<recordedAction> recorded; ///< what the run recorded anew, if it succeeded
    leakReport leaks;
    /// What the plug-in did that the interface forbids, a sentence each; up to 50.
    std::vector<std::string> misuse;

    bool done() const { return result == TNNoError; }
    /// The sentence that the host itself owes the user: for error codes. Empty where the plug-in has told, the user
    /// has cancelled, or all went well.
    std::string hostSentence() const;
};

/// "The disk is full (error -34)."
std::string hostErrorText(TNError code);

/// "Start" and so on.
std::string selectorName(TNSelector selector);

} // namespace Stillmark
