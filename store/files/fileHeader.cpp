#include "store/files/fileHeader.h"

#include "framework/base/container.h"
#include "framework/base/localisedString.h"
#include "store/traces/kernelCollection.h"

namespace Project
{

namespace
{

constexpr std::uint32_t kSignature = 0x44425753;        ///< the bytes "SWBD"
constexpr std::uint32_t kVersionSignature = 0x56657273; ///< the bytes "sreV"

std::string SizeText(std::int64_t width, std::int64_t height)
{
    return std::to_string(width) + "x" + std::to_string(height);
}

} // namespace

void WriteHeader(const PKernelCollection &collection, Sarnik::CContainer &out)
{
    const Sarnik::CRect bounds = collection.Picture().Bounds();
    WriteHeader(static_cast<std::int32_t>(bounds.Width()), static_cast<std::int32_t>(bounds.Height()), out);
}

void WriteHeader(std::int32_t width, std::int32_t height, Sarnik::CContainer &out)
{
    out.WriteU32(kSignature);
    out.WriteU32(kVersionSignature);
    out.WriteU16(kNewestTraceVersion);
    out.WriteI32(width);
    out.WriteI32(height);
}

void ReadHeader(PKernelCollection &collection, Sarnik::CContainer &in)
{
    using Sarnik::Localize;
    const std::uint32_t signature = in.ReadU32();
    if (in.ReadU32() != kVersionSignature || signature != kSignature)
        return collection.SetLastError(Localize(kUnrecognizedFormat));
    collection.SetVersion(in.ReadU16());

    const std::int32_t width = in.ReadI32();
    const std::int32_t height = in.ReadI32();
    const Sarnik::CRect bounds = collection.Picture().Bounds();
    if (width != bounds.Width() || height != bounds.Height())
        collection.SetLastError(Localize("$$$/Deblur/Warning/UnmatchedImageWidth=Image size doesn't match.") + "\n" +
                                Localize("$$$/Deblur/Warning/UnmatchedValueInFile=Value in the loaded file: ") +
                                SizeText(width, height) + "\n" +
                                Localize("$$$/Deblur/Warning/UnmatchedValueInDoc=Value of the current image: ") +
                                SizeText(bounds.Width(), bounds.Height()));
}

} // namespace Project
