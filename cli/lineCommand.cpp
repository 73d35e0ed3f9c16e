#include "cli/commands.h"
#include "cli/jsonWriter.h"
#include "cli/kernelArrays.h"
#include "deblur/estimate/straightKernel.h"

namespace Stillmark
{

commandResult makeLine(const lineOptions &options, runContext &)
{
    checkKernelPath(options.output);
    const kernelSamples kernel = toSamples(CorvaneDeblur::straightKernel(options.length, options.angle));
    writeKernel(options.output, kernel);
    return {0,
            options.output + ": a line in " + std::to_string(kernel.cols) + " x " + std::to_string(kernel.rows) +
                " pixels",
            jsonObject({{"cols", jsonNumber(kernel.cols)},
                        {"rows", jsonNumber(kernel.rows)},
                        {"output", jsonString(options.output)}})};
}

} // namespace Stillmark
