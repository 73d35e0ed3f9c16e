#include "host/plugin/hostOutcome.h"

#include <array>
#include <utility>

namespace Stillmark
{
namespace
{

constexpr std::array<std::pair<TNError, const char *>, 14> sentences = {{
    {TNErrUserCanceled, "The run was cancelled"},
    {TNErrFreeBlock, "The plug-in used memory that had been given back"},
    {TNErrNilHandle, "The plug-in used a memory handle that does not exist"},
    {TNErrMemoryFull, "There is not enough memory"},
    {TNErrParameter, "The plug-in and the host do not understand each other"},
    {TNErrVolumeLocked, "The disk is write-protected"},
    {TNErrFileLocked, "The file is locked"},
    {TNErrFileNotFound, "The file or folder was not found"},
    {TNErrEndOfFile, "The data ended too early"},
    {TNErrInputOutput, "The disk could not be read or written"},
    {TNErrDiskFull, "The disk is full"},
    {TNErrOpen, "The file could not be opened"},
    {TNErrWrite, "The picture could not be written"},
    {TNErrRead, "The picture could not be read"},
}};

void addCounted(std::string &text, std::uint64_t count, const char *what, std::uint64_t bytes)
{
    if (count == 0)
        return;
    text += text.empty() ? "" : ", ";
    text += std::to_string(count) + " " + what + (count == 1 ? "" : "s");
    if (bytes > 0)
        text += " (" + std::to_string(bytes) + " bytes)";
}

} // namespace

std::string leakReport::text() const
{
    std::string text;
    addCounted(text, handles, "handle", handleBytes);
    addCounted(text, buffers, "buffer", bufferBytes);
    addCounted(text, descriptors, "descriptor", 0);
    for (const auto &[name, count] : suites)
    {
        text += text.empty() ? "suite " : ", suite ";
        text += name + (count == 1 ? "" : " (" + std::to_string(count) + " times)");
    }
    return text;
}

std::string hostOutcome::hostSentence() const
{
    if (result == TNNoError || result == TNUserHasBeenTold || result == TNErrUserCanceled)
        return "";
    return hostErrorText(result);
}

std::string hostErrorText(TNError code)
{
    for (const auto &[known, sentence] : sentences)
        if (known == code)
            return std::string(sentence) + " (error " + std::to_string(code) + ").";
    return "The plug-in failed in a way that the host does not know (error " + std::to_string(code) + ").";
}

std::string selectorName(TNSelector selector)
{
    static constexpr std::array<const char *, 6> names = {"About", "Parameters", "Prepare",
                                                          "Start", "Continue",   "Finish"};
    return names.at(static_cast<std::size_t>(selector));
}

} // namespace Stillmark
