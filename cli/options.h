#pragma once

#include "deblur/deconv/latentEstimator.h"
#include "deblur/estimate/kernelEstimator.h"
#include "host/photo.h"

#include <optional>
#include <string>
#include <utility>
#include <vector>

/// What each subcommand was asked for, parsed and checked as far as that goes without opening a file.
namespace Stillmark
{

struct commonOptions
{
    int threads = 0; ///< 0 for one per core
    bool quiet = false;
    bool json = false;
};

/// How strongly a trace is removed, as shares (0..1) of what the command line takes as percent.
struct traceStrength
{
    float smoothing = 0.3f;
    float suppression = 0.3f;
};

/// The main job: find the blur, remove it.
struct removeOptions
{
    commonOptions common;
    std::string photo, output;
    std::optional<int> size; ///< none: measured
    CorvaneDeblur::noiseMode noise = CorvaneDeblur::noiseMode::automatic;
    std::vector<rectangle> regions; ///< none: found
    int traces = 1;                 ///< how many regions to find
    traceStrength strength;
    bool artifactSuppression = true; ///< off: the Wiener method
    bool force = false;              ///< remove the blur even by traces judged poor
    std::string kernelPicture;       ///< empty: none
    std::string selection;           ///< a mask, white where the photo may change; empty: all of it
    std::string workspace;           ///< traces to use; empty: none
    std::string saveWorkspace;       ///< where the traces go; empty: nowhere
    std::string replay;              ///< a recorded run to repeat; empty: none
    std::string record;              ///< where the run is recorded; empty: nowhere
    bool yes = false;                ///< the answer to questions; no: no
};

/// The main job for many photos.
struct batchOptions
{
    removeOptions job; ///< without photo and output
    std::vector<std::string> photos;
    std::string folder;        ///< results have the photos' names there
    int shard = 1, shards = 1; ///< every shards-th photo, from the shard-th on
};

/// What a file holds.
struct inspectOptions
{
    commonOptions common;
    std::string file;
    std::optional<std::pair<int, int>> imageSize; ///< of the picture that it is loaded for; none: what the file says
    std::string picture;                          ///< where its kernels are drawn; empty: nowhere
};

struct estimateOptions
{
    commonOptions common;
    std::string photo, output;
    std::optional<rectangle> region; ///< none: the whole photo or a found region
    std::optional<int> size;         ///< none: measured
    CorvaneDeblur::noiseMode noise = CorvaneDeblur::noiseMode::automatic;
    int maskThreshold = 255; ///< of 255; a channel above it is saturated, 255 is no mask
    int seedLevels = 0;
    int skipLevels = 0;
    bool secondOrder = false;
};

struct deconvolveOptions
{
    commonOptions common;
    std::string photo, output;
    std::vector<std::string> kernels;
    std::vector<rectangle> kernelRegions; ///< none (one kernel only), or one for each kernel
    CorvaneDeblur::deconvolutionMethod method = CorvaneDeblur::deconvolutionMethod::fast;
    traceStrength strength;
    int tile = 512; ///< side of a cell
};

struct suggestOptions
{
    commonOptions common;
    std::string photo;
    std::optional<int> size; ///< none: measured
    int count = 1;
    std::optional<std::pair<int, int>> near; ///< x, y
};

struct measureOptions
{
    commonOptions common;
    std::string photo;
};

struct lineOptions
{
    commonOptions common;
    double length = 0; ///< pixels
    double angle = 0;  ///< degrees, counterclockwise from the right
    std::string output;
};

} // namespace Stillmark
