#include "host/plugin/hostRun.h"

namespace Stillmark
{
namespace
{

/// Stands in the result word before each call. No plug-in has a reason to give it.
constexpr TNError unwritten = 0x5A5A;

} // namespace

hostRun::hostRun(TNEntry pluginEntry, const hostOptions &hostOffers, faultScript *faults)
    : entry(pluginEntry), options(hostOffers), state(faults), handles(state), buffers(state, options.bufferLimit),
      descriptors(state, handles), properties(state, handles, options), suites(state), alerts(state, options)
{
    offer(TN_BUFFER_SUITE, 1, buffers.suite());
    offer(TN_DESCRIPTOR_SUITE, 5, descriptors.suite());
}

void hostRun::offer(const char *name, int version, const void *suite)
{
    if (options.withheldSuites.count(name) == 0)
        suites.offer(name, version, suite);
}

bool hostRun::call(TNSelector selector, void *block)
{
    TNError result = unwritten;
    try
    {
        entry(static_cast<std::uint16_t>(selector), block, &dataWord, &result);
    }
    catch (...) // not ours: our callbacks throw nothing
    {
        state.misuse("an exception came out of " + selectorName(selector));
        result = TNErrParameter;
    }
    if (result == unwritten)
    {
        state.misuse(selectorName(selector) + " gave no result");
        result = TNErrParameter;
    }
    if (result != TNNoError && !outcome.failedAt)
    {
        outcome.result = result;
        outcome.failedAt = selector;
    }
    return result == TNNoError;
}

hostOutcome hostRun::end()
{
    state.rethrow(!outcome.done());
    outcome.alerts = alerts.shown();
    outcome.leaks = {handles.count(),      handles.totalBytes(), buffers.count(),
                     buffers.totalBytes(), descriptors.count(),  suites.unreleased()};
    outcome.misuse = state.misuses();
    return std::move(outcome);
}

} // namespace Stillmark
