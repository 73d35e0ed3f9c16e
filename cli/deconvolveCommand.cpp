#include "cli/commands.h"
#include "cli/jsonWriter.h"
#include "cli/kernelArrays.h"
#include "cli/photoRender.h"
#include "cli/stopwatch.h"
#include "cli/traceRegion.h"

namespace Stillmark
{
namespace
{

CorvaneDeblur::floatArray kernelFor(const std::string &path, const kernelSamples &kernel, const photo &picture,
                                    runContext &context)
{
    if (kernel.cols > picture.width() || kernel.rows > picture.height())
        throw Platform::fileError(path + ": a kernel of " + std::to_string(kernel.cols) + " x " +
                                  std::to_string(kernel.rows) + " pixels is larger than the picture " + picture.path() +
                                  ", which has " + std::to_string(picture.width()) + " x " +
                                  std::to_string(picture.height()));
    const CorvaneDeblur::floatArray square = squareKernel(toArray(kernel));
    if (square.cols < 5)
        context.notes.push_back(path + ": a kernel of less than 5 pixels is no blur to remove");
    return square;
}

} // namespace

commandResult deconvolvePhoto(const deconvolveOptions &options, runContext &context)
{
    photoWriter::check(options.output);
    std::vector<kernelSamples> kernels;
    for (const std::string &path : options.kernels)
        kernels.push_back(readKernel(path));

    const photo picture = openPhoto(options.photo, context);
    renderSettings settings;
    settings.method = options.method;
    settings.cellSize = options.tile;
    for (std::size_t i = 0; i < kernels.size(); ++i)
    {
        const rectangle region = options.kernelRegions.empty() ? wholeOf(picture) : options.kernelRegions[i];
        requireInside(picture, region);
        settings.kernels.push_back(
            latentTrace(kernelFor(options.kernels[i], kernels[i], picture, context), region, options.strength));
    }

    const stopwatch rendering;
    photoWriter result(picture, options.output);
    renderPhoto(picture, result, settings, context);
    const double seconds = rendering.seconds();
    return {0,
            "The blur was removed from " + picture.path() + ": " + options.output + " (" + secondsText(seconds) + ")",
            jsonObject(
                {{"seconds", jsonObject({{"render", jsonNumber(seconds)}})}, {"output", jsonString(options.output)}})};
}

} // namespace Stillmark
