#pragma once

#include "host/plugin/faultScript.h"
#include "host/plugin/hostOptions.h"
#include "host/plugin/hostOutcome.h"
#include "host/plugin/pluginPicture.h"
#include "shell/tintorel.h"

namespace Stillmark
{

/// Runs a filter plug-in over a picture, as a host does: Parameters where a dialog may be shown, Prepare, Start,
/// Continue where the options say so, Finish. Parameters, Prepare or Start that gives anything but 0 ends the run
/// there, for the plug-in has forgotten it. After a Continue that fails it has not: Finish follows.
///
/// faults: where the host is to lie; null: nowhere. Its counts are those of this run afterwards.
///
/// Throws what the picture or a function of the options threw (Platform::cancelled, Platform::fileError, ...), once the
/// plug-in has returned and all is freed; a shortage of memory that the plug-in got over is not thrown. All else that
/// can go wrong is in the outcome.
///
/// On the calling thread, one run at a time.
hostOutcome runPlugin(TNEntry entry, pluginPicture &picture, const hostOptions &options, faultScript *faults = nullptr);

/// Has the plug-in show its about box. Throws as runPlugin does.
hostOutcome runAbout(TNEntry entry, const hostOptions &options, faultScript *faults = nullptr);

} // namespace Stillmark
