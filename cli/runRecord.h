#pragma once

#include "cli/options.h"
#include "deblur/estimate/floatArray.h"
#include "host/plugin/recordedAction.h"

#include <cstdint>
#include <vector>

namespace Sarnik
{
class CContainer;
}

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

/// The same with traces as a workspace holds them: the bytes behind its header, of a format version.
recordedAction actionOfStream(std::vector<std::uint8_t> stream, int version, int width, int height,
                              bool artifactSuppression);

/// Those bytes of a run's record, in the newest version; none if it holds no traces.
std::vector<std::uint8_t> streamOf(const recordedAction &action);

/// One trace as a trace file holds it behind its header.
void writeTrace(const recordedTrace &trace, Sarnik::CContainer &out);

/// The traces of a run's record. Throws std::runtime_error when it holds none that can be read.
std::vector<recordedTrace> tracesOf(const recordedAction &action);

} // namespace Stillmark
