#include "store/files/traceFile.h"

#include "framework/base/localisedString.h"
#include "store/files/collectionStream.h"
#include "store/files/fileBytes.h"
#include "store/files/fileHeader.h"
#include "store/files/kernelPng.h"
#include "store/traces/kernelCollection.h"
#include "store/traces/readOnlyKernel.h"

namespace Project
{

namespace
{

void Add(PKernelCollection &collection, std::unique_ptr<PKernel> trace, int at)
{
    if (!collection.Events().AddLoadedTrace(*trace, at))
        collection.Insert(std::move(trace), at);
}

/// The square of a kernel of this size in the middle of the picture.
Sarnik::CRect MiddleSquare(const Sarnik::CRect &bounds, int size)
{
    const auto begin = [size](std::int32_t low, std::int32_t high) {
        return Sarnik::CRect::Clamped(low + (std::int64_t{high} - low) / 2 - size / 2);
    };
    const std::int32_t left = begin(bounds.left, bounds.right), top = begin(bounds.top, bounds.bottom);
    return {left, top, Sarnik::CRect::Clamped(std::int64_t{left} + size),
            Sarnik::CRect::Clamped(std::int64_t{top} + size)};
}

std::unique_ptr<PKernel> TraceOf(PKernelCollection &collection, const CorvaneDeblur::floatArray &kernel)
{
    PTraceRecord record;
    record.region = MiddleSquare(collection.Picture().Bounds(), kernel.cols);
    record.settings = collection.Parameters().defaultSettings;
    record.settings.size = kernel.cols;
    record.settings.anchorX = record.settings.anchorY = 0;
    record.kernel = kernel;
    return std::make_unique<PReadOnlyKernel>(collection, record);
}

} // namespace

bool LoadTrace(PKernelCollection &collection, const std::string &path, int at)
{
    return LoadFile(collection, path, [&](Sarnik::CContainer &in) {
        ReadHeader(collection, in);
        if (!collection.GetLastError().empty())
            return false;
        std::unique_ptr<PKernel> trace = ReadTrace(collection, in);
        if (!trace)
            return false;
        if (!RegionFits(collection, *trace))
        {
            collection.SetLastError(
                Sarnik::Localize("$$$/Deblur/Error/LoadKernel/ErrRegionOutOfBounds=Invalid file format: the blur "
                                 "trace region is out of the image bounds."));
            return false;
        }
        Add(collection, std::move(trace), at);
        return true;
    });
}

bool LoadPngTrace(PKernelCollection &collection, const std::string &path, int at)
{
    return LoadFile(collection, path, [&](Sarnik::CContainer &in) {
        std::string message;
        CorvaneDeblur::floatArray kernel;
        if (!ReadKernelPng(kernel, collection.MaxKernelSize(), in, message))
        {
            collection.SetLastError(message);
            return false;
        }
        Add(collection, TraceOf(collection, kernel), at);
        return true;
    });
}

bool SaveTrace(const PKernelCollection &collection, const std::string &directory, const std::string &name)
{
    const PKernel *trace = collection.Selected();
    return trace && SaveFile(directory, name, [&](Sarnik::CContainer &out) {
               WriteHeader(collection, out);
               trace->Write(out);
               return true;
           });
}

bool SavePngTrace(PKernelCollection &collection, const std::string &directory, const std::string &name)
{
    const PKernel *trace = collection.Selected();
    return trace && SaveFile(directory, name, [&](Sarnik::CContainer &out) {
               std::string message = collection.GetLastError();
               const bool written = WriteKernelPng(trace->KernelImage(), out, message);
               collection.SetLastError(message);
               return written;
           });
}

} // namespace Project
