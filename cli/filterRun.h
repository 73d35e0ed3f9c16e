#pragma once

#include "cli/runContext.h"
#include "host/document/resultRaster.h"
#include "host/document/selectionMask.h"
#include "host/photo.h"
#include "host/plugin/recordedAction.h"

namespace Stillmark
{

/// What the plug-in is to do with a photo.
struct filterJob
{
    const recordedAction &action;
    const selectionMask *selection = nullptr; ///< null: the whole photo
    bool yes = false;                         ///< the answer to questions
};

/// What a run of the plug-in over a photo gave.
struct filterAnswer
{
    recordedAction recorded; ///< what it did
    double findSeconds = 0;  ///< until the first pixels of the result came
    double renderSeconds = 0;
};

/// Runs the plug-in over a photo as a host does, without a dialog: it reads the photo, plays the action and writes into
/// the result, which the caller saves. What the plug-in tells the user, and goes on, becomes a note. Throws
/// Platform::cancelled after Ctrl-C, Platform::fileError when the plug-in cannot be loaded, the photo not be read or
/// the result not be kept, std::runtime_error with the plug-in's own words when it fails.
filterAnswer runFilter(const photo &picture, resultRaster &result, const filterJob &job, runContext &context);

/// stillmark.tnf, beside the program or in ../lib/stillmark. Throws Platform::fileError when it is in neither place.
std::string pluginPath();

} // namespace Stillmark
