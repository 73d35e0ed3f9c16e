#include "host/plugin/faultScript.h"

#include <charconv>
#include <stdexcept>

namespace Stillmark
{
namespace
{

struct callKind
{
    std::string_view name;
    TNError failure; ///< unless the rule names a code
};

/// In the order of hostCall.
constexpr std::array<callKind, hostCalls> kinds = {{{"read", TNErrRead},
                                                    {"write", TNErrWrite},
                                                    {"suite", TNErrParameter},
                                                    {"release", TNErrParameter},
                                                    {"buffer", TNErrMemoryFull},
                                                    {"space", TNErrMemoryFull},
                                                    {"handle", TNErrMemoryFull},
                                                    {"descriptor", TNErrParameter},
                                                    {"property", TNErrParameter},
                                                    {"colour", TNErrParameter},
                                                    {"alert", TNErrParameter},
                                                    {"abort", TNErrUserCanceled}}};

hostCall callOf(std::string_view name)
{
    for (std::size_t i = 0; i < kinds.size(); i++)
        if (kinds[i].name == name)
            return static_cast<hostCall>(i);
    throw std::invalid_argument("there is no call \"" + std::string(name) + "\"");
}

template <class Number> Number numberOf(std::string_view text)
{
    Number number = 0;
    const auto [end, error] = std::from_chars(text.data(), text.data() + text.size(), number);
    if (error != std::errc{} || end != text.data() + text.size() || number == 0)
        throw std::invalid_argument("\"" + std::string(text) + "\" is no number that fits");
    return number;
}

/// The text before the mark, which goes with it from the front of rest; all of rest without a mark.
std::string_view cut(std::string_view &rest, char mark)
{
    const std::size_t place = rest.find(mark);
    const std::string_view front = rest.substr(0, place);
    rest.remove_prefix(place == std::string_view::npos ? rest.size() : place + 1);
    return front;
}

} // namespace

faultScript::rule faultScript::parseRule(std::string_view text)
{
    rule made;
    std::string_view rest = text;
    std::string_view call = cut(rest, ':');
    if (const std::size_t open = call.find('('); open != std::string_view::npos && call.back() == ')')
    {
        made.name = call.substr(open + 1, call.size() - open - 2);
        call = call.substr(0, open);
    }
    made.call = callOf(call);

    std::string_view which = cut(rest, '=');
    const bool openEnd = which == "*" || (!which.empty() && which.back() == '+');
    if (which != "*")
    {
        if (openEnd)
            which.remove_suffix(1);
        made.first = made.last = numberOf<std::uint64_t>(which);
    }
    if (openEnd)
        made.last = UINT64_MAX;

    made.lie = {hostLie::sort::failure, kinds[static_cast<std::size_t>(made.call)].failure};
    if (rest == "nonsense")
        made.lie = {hostLie::sort::nonsense, TNNoError};
    else if (!rest.empty())
        made.lie.code = numberOf<TNError>(rest);
    return made;
}

faultScript faultScript::parse(std::string_view text)
{
    faultScript script;
    while (!text.empty())
    {
        const std::string_view one = cut(text, ',');
        try
        {
            script.rules.push_back(parseRule(one));
        }
        catch (const std::invalid_argument &error)
        {
            throw std::invalid_argument("\"" + std::string(one) + "\" is no fault: " + error.what());
        }
    }
    return script;
}

void faultScript::restart()
{
    counts.fill(0);
    for (rule &each : rules)
        each.seen = 0;
}

hostLie faultScript::next(hostCall call, std::string_view name)
{
    counts[static_cast<std::size_t>(call)]++;
    hostLie lie;
    for (rule &each : rules)
    {
        if (each.call != call || name.find(each.name) == std::string_view::npos)
            continue;
        each.seen++;
        if (lie.kind == hostLie::sort::none && each.seen >= each.first && each.seen <= each.last)
            lie = each.lie;
    }
    return lie;
}

} // namespace Stillmark
