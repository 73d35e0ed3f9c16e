#include "store/preferencesFormat.h"

#include "framework/base/container.h"
#include "store/preferences.h"

namespace Project
{

namespace
{

constexpr std::uint32_t kMagic = 0x53726E6B;
constexpr std::uint32_t kMagicOtherOrder = 0x6B6E7253;
constexpr std::uint32_t kCreator = 0x4465626C;
constexpr std::uint32_t kFlagsChunk = 0x44466C67;
constexpr std::uint32_t kPlacementChunk = 0x444C6F63;
constexpr std::uint32_t kParametersChunk = 0x42536574;
constexpr std::size_t kHeaderLength = 20; ///< of the file and of a chunk alike

constexpr std::uint32_t kPlacementShape = 1;
constexpr std::uint32_t kPlacementLength = 60; ///< without shape and length

/// Whether the rest is a file of ours; sets the byte order.
bool ReadFileHeader(Sarnik::CContainer &in)
{
    if (in.Size() <= kHeaderLength)
        return false;
    const std::uint32_t magic = in.ReadU32();
    if (magic == kMagicOtherOrder)
        in.SetSwapBytes(!in.SwapBytes());
    else if (magic != kMagic)
        return false;

    const std::uint32_t creator = in.ReadU32();
    in.ReadU32();
    const std::uint32_t reserved = in.ReadU32();
    const std::uint32_t length = in.ReadU32();
    return creator == kCreator && reserved == 0 && length >= 5;
}

void ReadChunk(Sarnik::CContainer &in, std::uint32_t type, std::uint32_t version, PPreferences &preferences)
{
    if (type == kFlagsChunk && version == 0)
        preferences.flags = in.ReadU32();
    else if (type == kPlacementChunk && version == 0)
        ReadPlacement(in, preferences.frame);
    else if (type == kParametersChunk)
    {
        preferences.parameters.version = version;
        ReadParameters(in, preferences.parameters);
    }
}

template <typename WritePayload>
void WriteChunk(Sarnik::CContainer &out, std::uint32_t type, std::uint32_t version, const WritePayload &writePayload)
{
    Sarnik::CMemoryContainer payload;
    writePayload(payload);
    out.WriteU32(kCreator);
    out.WriteU32(type);
    out.WriteU32(0);
    out.WriteU32(version);
    out.WriteU32(static_cast<std::uint32_t>(payload.Size()));
    out.WriteBytes(payload.Content());
}

} // namespace

bool ReadPreferences(Sarnik::CContainer &in, PPreferences &preferences)
{
    if (!ReadFileHeader(in))
        return false;
    // Lengths are added up in 64 bits: one that wraps around would lead back to a chunk already read, for ever.
    for (std::uint64_t next = kHeaderLength; const std::uint32_t creator = in.ReadU32();)
    {
        const std::uint32_t type = in.ReadU32();
        in.ReadU32();
        const std::uint32_t version = in.ReadU32();
        next += kHeaderLength + std::uint64_t{in.ReadU32()};
        if (creator == kCreator)
            ReadChunk(in, type, version, preferences);
        in.Seek(next);
    }
    return true;
}

void WritePreferences(Sarnik::CContainer &out, const PPreferences &preferences)
{
    out.Seek(0);
    for (int i = 0; i < 5; ++i)
        out.WriteU32(0); // the header's place; its length is known at the end
    WriteChunk(out, kFlagsChunk, 0, [&](auto &payload) { payload.WriteU32(preferences.flags); });
    WriteChunk(out, kPlacementChunk, 0, [&](auto &payload) { WritePlacement(payload, preferences.frame); });
    WriteChunk(out, kParametersChunk, kParametersVersion,
               [&](auto &payload) { WriteParameters(payload, preferences.parameters); });
    out.WriteU32(0);

    const std::size_t end = out.Position();
    out.Seek(0);
    out.WriteU32(kMagic);
    out.WriteU32(kCreator);
    out.WriteU32(0);
    out.WriteU32(0);
    out.WriteU32(static_cast<std::uint32_t>(end - kHeaderLength));
    out.Seek(end);
}

void ReadPlacement(Sarnik::CContainer &in, PWindowPlacement &frame)
{
    const std::uint32_t shape = in.ReadU32();
    const std::uint32_t length = in.ReadU32();
    if (shape != kPlacementShape)
    {
        in.Seek(std::uint64_t{in.Position()} + length);
        const PWindowPlacement fresh;
        frame = {frame.kind, frame.mode, fresh.rectangles, fresh.positionX, fresh.positionY, 0, 0, fresh.flags};
        return;
    }
    frame.kind = in.ReadU32();
    frame.mode = in.ReadU32();
    for (std::int32_t &edge : frame.rectangles)
        edge = in.ReadI32();
    frame.positionX = in.ReadI32();
    frame.positionY = in.ReadI32();
    frame.offsetX = in.ReadI32();
    frame.offsetY = in.ReadI32();
    for (std::uint16_t &flag : frame.flags)
        flag = in.ReadU16();
}

void WritePlacement(Sarnik::CContainer &out, const PWindowPlacement &frame)
{
    out.WriteU32(kPlacementShape);
    out.WriteU32(kPlacementLength);
    out.WriteU32(frame.kind);
    out.WriteU32(frame.mode);
    for (const std::int32_t edge : frame.rectangles)
        out.WriteI32(edge);
    out.WriteI32(frame.positionX);
    out.WriteI32(frame.positionY);
    out.WriteI32(frame.offsetX);
    out.WriteI32(frame.offsetY);
    for (const std::uint16_t flag : frame.flags)
        out.WriteU16(flag);
}

void WriteParameters(Sarnik::CContainer &out, const PParams &parameters)
{
    out.WriteBool(parameters.showPreview);
    out.WriteBool(parameters.showRegions);
    out.WriteString(parameters.lastFolder);
    out.WriteU32(parameters.tileSize);
    out.WriteU32(parameters.overflowColour);
    out.WriteU32(parameters.autoTraceCount);
    out.WriteBool(parameters.advancedOpen);
    out.WriteBool(parameters.fineResult);
    out.WriteBool(parameters.accuratePreview);
    out.WriteBool(parameters.previewWindowOpen);
}

void ReadParameters(Sarnik::CContainer &in, PParams &parameters)
{
    parameters.showPreview = in.ReadBool();
    parameters.showRegions = in.ReadBool();
    parameters.lastFolder = in.ReadString();
    parameters.tileSize = in.ReadU32();
    parameters.overflowColour = in.ReadU32();
    parameters.autoTraceCount = in.ReadU32();
    parameters.advancedOpen = in.ReadBool();
    if (parameters.version > 0)
        parameters.fineResult = in.ReadBool();
    parameters.accuratePreview = in.ReadBool();
    parameters.previewWindowOpen = in.ReadBool();
}

} // namespace Project
