#include "cli/commands.h"
#include "cli/jsonWriter.h"
#include "cli/photoAnalysis.h"

#include <cstdio>

namespace Stillmark
{

commandResult measurePhoto(const measureOptions &options, runContext &context)
{
    const photo picture = openPhoto(options.photo, context);
    photoAnalysis analysis(picture, wholeOf(picture), context);
    const float noise = analysis.noise();
    const int size = analysis.blurSize(CorvaneDeblur::noiseMode::automatic);
    const rectangle patch = analysis.noisePatch();

    char noiseText[64];
    std::snprintf(noiseText, sizeof noiseText, "%.5f (%.2f levels of 255)", static_cast<double>(noise), noise * 255.0);
    return {
        0,
        "noise      " + std::string(noiseText) + ", measured in " + regionText(patch) + "\nblur size  " +
            std::to_string(size) + " pixels",
        jsonObject({{"noise", jsonNumber(noise)}, {"blurSize", jsonNumber(size)}, {"patch", jsonRectangle(patch)}})};
}

} // namespace Stillmark
