#pragma once

#include "host/plugin/alertTable.h"
#include "host/plugin/bufferTable.h"
#include "host/plugin/descriptorTable.h"
#include "host/plugin/handleTable.h"
#include "host/plugin/hostOutcome.h"
#include "host/plugin/propertyTable.h"
#include "host/plugin/runState.h"
#include "host/plugin/suiteTable.h"
#include "shell/tintorel.h"

namespace Stillmark
{

/// All that a plug-in finds in any host, and the calls of its entry. One run or one about box.
class hostRun
{
public:
    hostRun(TNEntry pluginEntry, const hostOptions &hostOffers, faultScript *faults);

    /// Calls the plug-in and keeps a result other than 0, the first one. Whether it was 0.
    bool call(TNSelector selector, void *block);
    /// What there is to tell, once the plug-in has been called for the last time. Throws what the host's functions did.
    hostOutcome end();

    const TNSuiteProcs *suiteProcs() const { return options.suites ? suites.procs() : nullptr; }
    const TNAlertProcs *alertProcs() const { return options.alerts ? alerts.procs() : nullptr; }
    void offer(const char *name, int version, const void *suite);

    const TNEntry entry;
    const hostOptions &options;
    runState state;
    handleTable handles;
    bufferTable buffers;
    descriptorTable descriptors;
    propertyTable properties;
    suiteTable suites;
    alertTable alerts;
    hostOutcome outcome;

private:
    std::intptr_t dataWord = 0; ///< the plug-in's, from call to call
};

} // namespace Stillmark
