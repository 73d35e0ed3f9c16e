#include "cli/commands.h"
#include "cli/jsonWriter.h"
#include "cli/kernelArrays.h"
#include "cli/photoRender.h"
#include "cli/stopwatch.h"
#include "cli/traceFiles.h"
#include "cli/traceRegion.h"

#include <algorithm>

namespace Stillmark
{
namespace
{

/// Rendering leaves a picture alone where no kernel is as wide as this.
constexpr int smallestBlur = 5;

CorvaneDeblur::floatArray kernelFor(const std::string &path, const kernelSamples &kernel, const photo &picture,
                                    runContext &context)
{
    if (kernel.cols > picture.width() || kernel.rows > picture.height())
        throw Platform::fileError(path + ": a kernel of " + std::to_string(kernel.cols) + " x " +
                                  std::to_string(kernel.rows) + " pixels is larger than the picture " + picture.path() +
                                  ", which has " + std::to_string(picture.width()) + " x " +
                                  std::to_string(picture.height()));
    const CorvaneDeblur::floatArray square = squareKernel(toArray(kernel));
    if (square.cols < smallestBlur)
        context.notes.push_back(path + ": a kernel of less than " + std::to_string(smallestBlur) +
                                " pixels is no blur to remove");
    return square;
}

} // namespace

commandResult deconvolvePhoto(const deconvolveOptions &options, runContext &context)
{
    photoWriter::check(options.output);
    std::vector<kernelSamples> kernels;
    for (const std::string &path : options.kernels)
        kernels.push_back(readAnyKernel(path));

    const photo picture = openPhoto(options.photo, context);
    renderSettings settings;
    settings.method = options.method;
    settings.cellSize = options.tile;
    for (std::size_t i = 0; i < kernels.size(); ++i)
    {
        const rectangle region = options.kernelRegions.empty() ? wholeOf(picture) : options.kernelRegions[i];
        requireInside(picture, wholeOf(picture), region);
        settings.kernels.push_back(
            latentTrace(kernelFor(options.kernels[i], kernels[i], picture, context), region, options.strength));
    }

    const stopwatch rendering;
    photoWriter result(picture, options.output);
    renderPhoto(picture, result, settings, context);
    const double seconds = rendering.seconds();
    const bool blur = std::any_of(settings.kernels.begin(), settings.kernels.end(),
                                  [](const auto &trace) { return trace.kernel.cols >= smallestBlur; });
    return {0,
            options.output + (blur ? ": the blur was removed (" + secondsText(seconds) + ")" : ": the photo as it was"),
            jsonObject(
                {{"seconds", jsonObject({{"render", jsonNumber(seconds)}})}, {"output", jsonString(options.output)}})};
}

} // namespace Stillmark
