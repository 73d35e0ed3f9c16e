#pragma once

#include "cli/options.h"
#include "deblur/estimate/floatArray.h"
#include "host/plugin/recordedAction.h"

#include <vector>

/// What the main job tells the plug-in to do, and learns from it: recorded runs (docs/files/recorded-run.md).
namespace Stillmark
{

/// A trace of a recorded run. Regions are in pixels of the photo.
struct recordedTrace
{
    rectangle region; ///< width or height 0: the whole picture
    int size = 0;
    CorvaneDeblur::noiseMode noise = CorvaneDeblur::noiseMode::automatic;
    traceStrength strength;
    bool forced = false;              ///< renders even if it is judged poor
    CorvaneDeblur::floatArray kernel; ///< empty: not estimated yet; the run does that
    bool active = true;               ///< wanted in the result
};

/// Find everything in the picture itself. It plays on a picture of any size.
recordedAction automaticAction(bool artifactSuppression);

/// Use these traces, which lie within a picture (or a selection's bounds) of width x height. It plays on nothing else.
recordedAction actionWith(const std::vector<recordedTrace> &traces, int width, int height, bool artifactSuppression);

/// The traces of a run's record. Throws std::runtime_error when it holds none that can be read.
std::vector<recordedTrace> tracesOf(const recordedAction &action);

} // namespace Stillmark
