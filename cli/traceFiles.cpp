#include "cli/traceFiles.h"

#include "cli/kernelArrays.h"
#include "framework/base/container.h"
#include "platform/files.h"
#include "store/files/fileHeader.h"
#include "store/files/inspectFile.h"

#include <algorithm>
#include <filesystem>

namespace Stillmark
{
namespace
{

using Sarnik::CMemoryContainer;

constexpr std::size_t largestWorkspace = std::size_t{1} << 30;

std::string inOneLine(std::string text)
{
    std::replace(text.begin(), text.end(), '\n', ' ');
    return text;
}

bool isTraceFile(const std::string &path)
{
    std::string extension = std::filesystem::path(path).extension().string();
    std::transform(extension.begin(), extension.end(), extension.begin(),
                   [](unsigned char c) { return static_cast<char>(std::tolower(c)); });
    return extension == ".knl";
}

void save(const std::string &path, std::span<const std::byte> content)
{
    Platform::atomicFile file(path);
    file.write(content.data(), content.size());
    file.commit();
}

} // namespace

recordedAction workspaceAction(const std::string &path, int width, int height, bool artifactSuppression,
                               std::vector<std::string> &notes)
{
    const Project::PInspection found = Project::InspectFile(path, Project::PImageSize{width, height});
    if (found.kind != Project::PInspection::Kind::Workspace)
        throw Platform::fileError(path + ": is no workspace (a file that ends in .dbw)");
    if (!found.error.empty())
    {
        if (found.traces.empty())
            throw Platform::fileError(path + ": " + inOneLine(found.error));
        notes.push_back(path + ": " + inOneLine(found.error));
    }
    // The traces as they stand in the file: the plug-in reads them by the rules that they were just read by.
    const std::vector<std::uint8_t> bytes = Platform::readWholeFile(path, largestWorkspace);
    return actionOfStream({bytes.begin() + Project::kHeaderLength, bytes.end()},
                          static_cast<int>(found.version.value_or(0)), width, height, artifactSuppression);
}

void saveWorkspace(const std::string &path, const recordedAction &recorded, int width, int height)
{
    CMemoryContainer file;
    Project::WriteHeader(width, height, file);
    const std::vector<std::uint8_t> stream = streamOf(recorded);
    file.WriteBytes(std::as_bytes(std::span(stream)));
    save(path, file.Content());
}

kernelSamples readAnyKernel(const std::string &path)
{
    if (!isTraceFile(path))
        return readKernel(path);
    const Project::PInspection found = Project::InspectFile(path);
    if (found.traces.empty())
        throw Platform::fileError(path + ": " + inOneLine(found.error));
    if (found.traces.front().kernel.empty())
        throw Platform::fileError(path + ": the trace has no kernel: it was never estimated");
    return toSamples(found.traces.front().kernel);
}

void checkAnyKernelPath(const std::string &path)
{
    if (isTraceFile(path))
        Platform::checkWritable(path);
    else
        checkKernelPath(path);
}

void writeAnyKernel(const std::string &path, const recordedTrace &trace, int width, int height)
{
    if (!isTraceFile(path))
        return writeKernel(path, toSamples(trace.kernel));
    CMemoryContainer file;
    Project::WriteHeader(width, height, file);
    writeTrace(trace, file);
    save(path, file.Content());
}

} // namespace Stillmark
