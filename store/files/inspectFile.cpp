#include "store/files/inspectFile.h"

#include "framework/base/container.h"
#include "framework/base/exceptions.h"
#include "framework/base/localisedString.h"
#include "store/files/collectionStream.h"
#include "store/files/fileBytes.h"
#include "store/files/fileHeader.h"
#include "store/files/traceFile.h"
#include "store/files/workspaceFile.h"
#include "store/preferencesFormat.h"
#include "store/traces/kernelCollection.h"
#include "store/traces/manualKernel.h"

#include <algorithm>
#include <array>
#include <filesystem>

namespace Project
{

namespace
{

/// A picture without pixels: loading asks for its bounds alone.
class boundsOnly final : public PTracePicture
{
public:
    explicit boundsOnly(const Sarnik::CRect &rect) : bounds(rect) {}

    Sarnik::CRect Bounds() const override { return bounds; }
    int Planes() const override { return 3; }
    int Depth() const override { return 8; }
    void ReadGrey(const Sarnik::CRect &, std::uint8_t, const CorvaneDeblur::floatArray &,
                  const CorvaneDeblur::byteArray &) override
    {
        throw Sarnik::CError("A picture without pixels was read.");
    }

private:
    Sarnik::CRect bounds;
};

/// Loading the file as whatever it is into a collection of its own.
struct trialLoad
{
    explicit trialLoad(const Sarnik::CRect &bounds) : picture(bounds) {}

    boundsOnly picture;
    PParams parameters;
    PTraceEvents events;
    PKernelCollection collection{picture, parameters, events, {}};
};

/// Large enough for the largest kernels, with the origin in its middle.
constexpr Sarnik::CRect kUnknownPicture{-500, -500, 500, 500};

std::string LowerExtension(const std::string &path)
{
    std::string extension = std::filesystem::path(path).extension().string();
    std::transform(extension.begin(), extension.end(), extension.begin(),
                   [](char c) { return c >= 'A' && c <= 'Z' ? static_cast<char>(c - 'A' + 'a') : c; });
    return extension;
}

bool BeginsLikePreferences(const Sarnik::CMemoryContainer &content)
{
    constexpr std::array<std::byte, 4> magic{std::byte{'k'}, std::byte{'n'}, std::byte{'r'}, std::byte{'S'}};
    const auto begin = content.Content().first(std::min(content.Size(), magic.size()));
    return std::equal(begin.begin(), begin.end(), magic.begin(), magic.end()) ||
           std::equal(begin.begin(), begin.end(), magic.rbegin(), magic.rend());
}

PInspection::Kind KindOf(const std::string &path, const Sarnik::CMemoryContainer &content)
{
    const std::string extension = LowerExtension(path);
    if (extension == ".dbw")
        return PInspection::Kind::Workspace;
    if (extension == ".knl")
        return PInspection::Kind::Trace;
    if (extension == ".png")
        return PInspection::Kind::Picture;
    return extension == ".tnp" || BeginsLikePreferences(content) ? PInspection::Kind::Preferences
                                                                 : PInspection::Kind::Unknown;
}

/// The picture size that a workspace or a trace file says; nothing for what is no such file.
PImageSize SizeInHeader(Sarnik::CMemoryContainer &content)
{
    if (content.Size() < kHeaderLength)
        return {};
    content.Seek(kHeaderLength - 8);
    const std::int32_t width = std::max(content.ReadI32(), 0);
    return {width, std::max(content.ReadI32(), 0)};
}

PInspectedTrace Inspected(const PKernel &trace)
{
    PInspectedTrace seen{trace.KernelType(),  trace.Region(),     trace.Settings(),
                         trace.KernelImage(), trace.IsReliable(), {}};
    if (const auto *manual = dynamic_cast<const PManualKernel *>(&trace))
        seen.line = {manual->LineStart(), manual->LineEnd()};
    return seen;
}

void LoadTraces(const std::string &path, const Sarnik::CRect &bounds, PInspection &inspection)
{
    trialLoad trial(bounds);
    PStreamIndices indices;
    switch (inspection.kind)
    {
    case PInspection::Kind::Workspace:
        inspection.result = LoadWorkspace(trial.collection, path, &indices);
        break;
    case PInspection::Kind::Trace:
        inspection.result = LoadTrace(trial.collection, path, -1);
        break;
    default:
        inspection.result = LoadPngTrace(trial.collection, path, -1);
        break;
    }
    inspection.error = trial.collection.GetLastError();
    if (inspection.kind != PInspection::Kind::Picture)
        inspection.version = trial.collection.Version();
    inspection.selected = indices.selected;
    inspection.active.assign(indices.active.begin(), indices.active.end());
    if (indices.active.contains(-1)) // the one that stands for no trace comes last
        std::rotate(inspection.active.begin(), inspection.active.begin() + 1, inspection.active.end());
    inspection.defaultSize = trial.collection.FoundDefaultSize();
    for (int i = 0; i < trial.collection.Count(); ++i)
        inspection.traces.push_back(Inspected(*trial.collection.At(i)));
}

void LoadPreferencesContent(Sarnik::CMemoryContainer &content, PInspection &inspection)
{
    inspection.preferences = std::make_unique<PPreferences>();
    try
    {
        inspection.result = ReadPreferences(content, *inspection.preferences);
        inspection.version = inspection.preferences->parameters.version;
    }
    catch (const Sarnik::CException &)
    {
    }
    if (inspection.result)
        return;
    inspection.preferences.reset();
    inspection.version.reset();
    inspection.error = Sarnik::Localize(kUnrecognizedFormat);
}

} // namespace

PInspection InspectFile(const std::string &path, std::optional<PImageSize> size)
{
    PInspection inspection;
    inspection.file = std::filesystem::path(path).filename().string();
    Sarnik::CMemoryContainer content = ReadFileBytes(path);
    inspection.kind = KindOf(path, content);
    switch (inspection.kind)
    {
    case PInspection::Kind::Workspace:
    case PInspection::Kind::Trace:
        if (!size)
            size = SizeInHeader(content);
        [[fallthrough]];
    case PInspection::Kind::Picture:
        if (size)
            inspection.bounds = Sarnik::CRect{0, 0, size->width, size->height};
        LoadTraces(path, inspection.bounds.value_or(kUnknownPicture), inspection);
        break;
    case PInspection::Kind::Preferences:
        LoadPreferencesContent(content, inspection);
        break;
    case PInspection::Kind::Unknown:
        inspection.error = Sarnik::Localize("$$$/Deblur/Dialog/FileLoadError=Not a Workspace file or a Blur Trace "
                                            "file.");
        break;
    }
    return inspection;
}

} // namespace Project
