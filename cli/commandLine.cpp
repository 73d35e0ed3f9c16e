#include "cli/commandLine.h"

#include "cli/argumentParser.h"

#include <map>
#include <ostream>
#include <string_view>
#include <tuple>

namespace Stillmark
{
namespace
{

const std::string subcommandList = R"(Other commands (stillmark COMMAND --help tells more):
  estimate      find the blur of a photo and save it as a kernel
  deconvolve    remove a blur that is known
  suggest       find regions of a photo that suit an estimate
  measure       noise level and blur size of a photo
  line          make the kernel of a straight movement
  inspect       tell what a file of traces, preferences or a recorded run holds

A photo with the name of a command: ./estimate)";

void addCommon(argumentParser &parser, commonOptions &options)
{
    parser.value("--threads", "N", options.threads, "threads to use (default: one per core)",
                 [](const std::string &text) { return parseInt(text, 1, 256); });
    parser.flag("--quiet", options.quiet, "no progress, no summary");
    parser.flag("--json", options.json, "the result as one JSON object on the standard output");
}

void addPhoto(argumentParser &parser, std::string &photo)
{
    parser.positional("PHOTO", photo, "the picture: JPEG, PNG, TIFF, WebP, .pfm");
}

void addSize(argumentParser &parser, std::optional<int> &size)
{
    parser.value("--size", "N", size, "largest blur looked for, in pixels, odd (default: measured)", parseBlurSize);
}

void addNoise(argumentParser &parser, CorvaneDeblur::noiseMode &noise)
{
    parser.value("--noise", "M", noise, "noise of the photo: auto (measured), low, medium, high (default: auto)",
                 parseNoiseMode);
}

void addStrength(argumentParser &parser, traceStrength &strength)
{
    parser.value("--smoothing", "P", strength.smoothing, "percent: less noise, less detail (default: 30)",
                 parsePercent);
    parser.value("--suppression", "P", strength.suppression, "percent: less ringing, less effect (default: 30)",
                 parsePercent);
}

std::string asIs(const std::string &text)
{
    return text;
}

std::string endingIn(const std::string &text, const char *extension)
{
    if (!text.ends_with(extension))
        throw usageError("'" + text + "' does not end in " + extension);
    return text;
}

void addTraces(argumentParser &parser, removeOptions &options)
{
    addSize(parser, options.size);
    addNoise(parser, options.noise);
    parser.values("--region", "X,Y,W,H", options.regions, "find the blur here; may be repeated (default: found)",
                  parseRectangle);
    parser.value("--traces", "N", options.traces, "how many regions to find (default: 1)",
                 [](const std::string &text) { return parseInt(text, 1, 99); });
    addStrength(parser, options.strength);
    parser.flag("--force", options.force, "apply traces judged poor too");
}

/// Options that only one photo at a time can have.
void addFiles(argumentParser &parser, removeOptions &options)
{
    parser.value("--selection", "MASK", options.selection,
                 "a picture of the photo's size: only where it is white the photo is looked at and changed", asIs);
    parser.value("--kernel-picture", "F.png", options.kernelPicture, "a picture of the blur that was found",
                 [](const std::string &text) { return endingIn(text, ".png"); });
    parser.value("--workspace", "F.dbw", options.workspace, "remove the blur by the traces in this file", asIs);
    parser.value("--save-workspace", "F.dbw", options.saveWorkspace, "keep the traces in this file",
                 [](const std::string &text) { return endingIn(text, ".dbw"); });
    parser.value("--replay", "F", options.replay, "repeat a recorded run", asIs);
    parser.value("--record", "F", options.record, "record the run in this file", asIs);
    parser.flag("--yes", options.yes, "answer questions with yes (default: no)");
}

/// Where the traces come from is told once.
void checkOneSource(const removeOptions &options)
{
    const bool chosen = options.size || !options.regions.empty() || options.traces != 1 || options.force;
    if (int{chosen} + !options.workspace.empty() + !options.replay.empty() > 1)
        throw usageError("--workspace, --replay and options that choose traces (--size, --region, --traces, --force) "
                         "exclude each other");
    if (!options.replay.empty() && !options.artifactSuppression)
        throw usageError("--no-artifact-suppression is part of what --replay repeats");
}

int runRemove(argumentParser &parser, commandDelegate &delegate)
{
    batchOptions options;
    removeOptions &job = options.job;
    std::pair<int, int> shard{0, 0};
    bool plain = false;
    parser.positionals("PHOTO", options.photos,
                       "the picture: JPEG, PNG, TIFF, WebP, .pfm; with --out-dir many of them");
    parser.value("-o,--output", "OUT", job.output, "the sharp picture; the extension chooses the format", asIs);
    parser.value("--out-dir", "DIR", options.folder, "in place of OUT: the folder for the results of many photos",
                 asIs);
    parser.value("--shard", "I/N", shard, "with --out-dir: of every N photos only the I-th", parseShard);
    addTraces(parser, job);
    parser.flag("--no-artifact-suppression", plain, "quicker, with more ringing (the Wiener method)");
    addFiles(parser, job);
    addCommon(parser, job.common);
    if (!parser.parse())
        return exitDone;
    job.artifactSuppression = !plain;
    checkOneSource(job);

    if (options.folder.empty())
    {
        if (job.output.empty())
            throw usageError("--output is required");
        if (options.photos.size() > 1)
            throw usageError("several photos need --out-dir in place of --output");
        if (shard.first != 0)
            throw usageError("--shard goes with --out-dir");
        job.photo = options.photos.front();
        return delegate.remove(job);
    }
    if (!job.output.empty())
        throw usageError("--output and --out-dir exclude each other");
    if (!job.selection.empty() || !job.kernelPicture.empty() || !job.saveWorkspace.empty() || !job.record.empty())
        throw usageError("--selection, --kernel-picture, --save-workspace and --record are for one photo");
    if (shard.first != 0)
        std::tie(options.shard, options.shards) = shard;
    return delegate.removeAll(options);
}

int runInspect(argumentParser &parser, commandDelegate &delegate)
{
    inspectOptions options;
    parser.positional("FILE", options.file, "a workspace .dbw, a trace .knl or .png, preferences, or a recorded run");
    parser.value("--image-size", "WxH", options.imageSize,
                 "load it as for a picture of this size (default: the size that the file says)", parseSize);
    parser.value("--picture", "OUT.png", options.picture, "draw its kernels",
                 [](const std::string &text) { return endingIn(text, ".png"); });
    addCommon(parser, options.common);
    return parser.parse() ? delegate.inspect(options) : exitDone;
}

int runEstimate(argumentParser &parser, commandDelegate &delegate)
{
    estimateOptions options;
    addPhoto(parser, options.photo);
    parser.required("-o,--output", "KERNEL", options.output, "the kernel: .pfm (exact), .knl (a trace) or .png");
    parser.value("--region", "X,Y,W,H", options.region,
                 "find the blur here (default: the whole photo, of a large one a found region)", parseRectangle);
    addSize(parser, options.size);
    addNoise(parser, options.noise);
    parser.value("--mask-threshold", "T", options.maskThreshold,
                 "leave out pixels with a channel above T of 255 (default: 255, none)",
                 [](const std::string &text) { return parseInt(text, 0, 255); });
    parser.value("--seed-levels", "N", options.seedLevels, "coarsest levels that try several first shapes (default: 0)",
                 [](const std::string &text) { return parseInt(text, 0, 50); });
    parser.value("--skip-levels", "N", options.skipLevels, "finest levels left out (default: 0)",
                 [](const std::string &text) { return parseInt(text, 0, 50); });
    parser.flag("--second-order", options.secondOrder, "compare second derivatives in place of first ones");
    addCommon(parser, options.common);
    return parser.parse() ? delegate.estimate(options) : exitDone;
}

int runDeconvolve(argumentParser &parser, commandDelegate &delegate)
{
    deconvolveOptions options;
    addPhoto(parser, options.photo);
    parser.values("--kernel", "K", options.kernels, "the blur, .pfm, .knl or a picture; may be repeated",
                  [](const std::string &text) { return text; });
    parser.required("-o,--output", "OUT", options.output, "the sharp picture; the extension chooses the format");
    parser.values("--region-of-kernel", "X,Y,W,H", options.kernelRegions,
                  "where a kernel belongs; needed for each one of several, in the same order", parseRectangle);
    parser.value("--method", "M", options.method, "wiener, classic or fast (default: fast)", parseMethod);
    addStrength(parser, options.strength);
    parser.value("--tile", "N", options.tile, "pixels a side that are computed at a time (default: 512)",
                 [](const std::string &text) { return parseInt(text, 16, 8192); });
    addCommon(parser, options.common);
    if (!parser.parse())
        return exitDone;
    if (options.kernels.empty())
        throw usageError("--kernel is required");
    const bool regionsNeeded = options.kernels.size() > 1 || !options.kernelRegions.empty();
    if (regionsNeeded && options.kernelRegions.size() != options.kernels.size())
        throw usageError("several kernels need one --region-of-kernel each: there are " +
                         std::to_string(options.kernels.size()) + " kernels and " +
                         std::to_string(options.kernelRegions.size()) + " regions");
    return delegate.deconvolve(options);
}

int runSuggest(argumentParser &parser, commandDelegate &delegate)
{
    suggestOptions options;
    bool counted = false;
    addPhoto(parser, options.photo);
    addSize(parser, options.size);
    parser.value("--count", "N", options.count, "how many regions (default: 1)", [&](const std::string &text) {
        counted = true;
        return parseInt(text, 1, 99);
    });
    parser.value("--near", "X,Y", options.near, "one region, around this point", parsePoint);
    addCommon(parser, options.common);
    if (!parser.parse())
        return exitDone;
    if (counted && options.near)
        throw usageError("--near finds one region and takes no --count");
    return delegate.suggest(options);
}

int runMeasure(argumentParser &parser, commandDelegate &delegate)
{
    measureOptions options;
    addPhoto(parser, options.photo);
    addCommon(parser, options.common);
    return parser.parse() ? delegate.measure(options) : exitDone;
}

int runLine(argumentParser &parser, commandDelegate &delegate)
{
    lineOptions options;
    parser.required("--length", "L", options.length, "length of the movement in pixels",
                    [](const std::string &text) { return parseReal(text, 0, 1000); });
    parser.required("--angle", "A", options.angle, "direction in degrees, counterclockwise from the right",
                    [](const std::string &text) { return parseReal(text, -3600, 3600); });
    parser.required("-o,--output", "KERNEL", options.output, "the kernel: .pfm (exact) or .png");
    addCommon(parser, options.common);
    return parser.parse() ? delegate.line(options) : exitDone;
}

struct subcommand
{
    const char *usage, *about;
    int (*run)(argumentParser &, commandDelegate &);
};

const subcommand mainJob = {"PHOTO -o OUT [options], or PHOTO... --out-dir DIR [options]",
                            "Removes camera shake from a photograph.", runRemove};

const std::map<std::string_view, subcommand> subcommands = {
    {"estimate", {"PHOTO -o KERNEL [options]", "Finds the blur of a photo and saves it as a kernel.", runEstimate}},
    {"deconvolve", {"PHOTO --kernel K -o OUT [options]", "Removes a blur that is known.", runDeconvolve}},
    {"suggest", {"PHOTO [options]", "Finds regions of a photo that suit an estimate of its blur.", runSuggest}},
    {"measure", {"PHOTO [options]", "Measures the noise and the size of the blur.", runMeasure}},
    {"inspect", {"FILE [options]", "Tells what a file of traces, preferences or a recorded run holds.", runInspect}},
    {"line", {"--length L --angle A -o KERNEL", "Makes the kernel of a straight movement.", runLine}},
};

} // namespace

int runCommandLine(int argc, const char *const *argv, commandDelegate &delegate, std::ostream &out, std::ostream &err)
{
    std::vector<std::string> arguments(argv + (argc > 0 ? 1 : 0), argv + argc);
    const auto named = arguments.empty() ? subcommands.end() : subcommands.find(arguments.front());
    const bool isMain = named == subcommands.end();
    const subcommand &chosen = isMain ? mainJob : named->second;
    const std::string program = isMain ? "stillmark" : "stillmark " + arguments.front();
    if (!isMain)
        arguments.erase(arguments.begin());

    try
    {
        argumentParser parser(program, chosen.usage, chosen.about, isMain ? subcommandList : "", std::move(arguments),
                              out);
        return chosen.run(parser, delegate);
    }
    catch (const usageError &e)
    {
        err << program << ": " << e.what() << " (" << program << " --help tells more)\n";
        return exitUsage;
    }
}

} // namespace Stillmark
