#pragma once

#include "shell/tintorel.h"

#include <array>
#include <cstdint>
#include <string>
#include <string_view>
#include <vector>

namespace Stillmark
{

/// The functions of a host that can be told to lie.
enum class hostCall
{
    read,       ///< readPixels, of the suite and of the block
    write,      ///< writePixels, of both
    suite,      ///< acquire of a suite
    release,    ///< release of one
    buffer,     ///< allocate of the buffer suite
    space,      ///< its space
    handle,     ///< create of a handle
    descriptor, ///< each function of the descriptor suite
    property,   ///< get and set
    colour,     ///< conversion from CMYK
    alert,      ///< an alert's answer
    abort       ///< testAbort
};
constexpr int hostCalls = 12;

/// How one call lies.
struct hostLie
{
    enum class sort
    {
        none,    ///< it does its work
        failure, ///< it does nothing and answers with code; null where it gives memory, 1 where it is asked to abort
        nonsense ///< it claims success; what it delivers is wrong
    };
    sort kind = sort::none;
    TNError code = TNNoError;

    bool fails() const { return kind == sort::failure; }
    bool raves() const { return kind == sort::nonsense; }
};

/// Which calls of a run a host lies in, for tests of what the plug-in makes of it.
///
/// As text: rules with commas between them, each `call[(name)]:which[=how]`.
///
///     read:3=-36          the third readPixels fails with -36
///     suite(Buffer):1     the first acquire of a suite whose name contains Buffer fails; of a descriptor's functions
///                         and of properties, (name) is the function or the key
///     handle:2+           no handle from the second on
///     write:*=nonsense    writePixels never writes, and says it did
class faultScript
{
public:
    faultScript() = default;
    /// Throws std::invalid_argument with a sentence about the first rule that is none.
    static faultScript parse(std::string_view text);

    /// All counts back to 0: the beginning of a run.
    void restart();
    /// Counts a call and tells how it lies; of several rules that apply the first decides.
    hostLie next(hostCall call, std::string_view name = {});
    /// Calls since the restart.
    std::uint64_t calls(hostCall call) const { return counts[static_cast<std::size_t>(call)]; }

private:
    struct rule
    {
        hostCall call = hostCall::read;
        std::string name;                  ///< empty: any
        std::uint64_t first = 1, last = 1; ///< which of the calls that it is about
        hostLie lie;
        std::uint64_t seen = 0;
    };
    static rule parseRule(std::string_view text);

    std::vector<rule> rules;
    std::array<std::uint64_t, hostCalls> counts{};
};

} // namespace Stillmark
