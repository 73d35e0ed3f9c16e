#include "store/files/collectionStream.h"

#include "framework/base/container.h"
#include "framework/base/localisedString.h"
#include "store/traces/kernelCollection.h"

namespace Project
{

namespace
{

/// Reads the traces; those left out are counted off the selection. `selected` is right after every trace.
void ReadTraces(PKernelCollection &collection, Sarnik::CContainer &in, std::uint32_t count, std::int32_t &selected)
{
    for (std::uint32_t i = 0; i < count; ++i)
    {
        std::unique_ptr<PKernel> trace = ReadTrace(collection, in);
        if (trace && RegionFits(collection, *trace))
        {
            collection.Insert(std::move(trace), -1);
            continue;
        }
        // Compared with the position in the file, although earlier rejections have lowered the selection already.
        if (std::int64_t{i} <= selected)
            --selected;
        collection.SetLastError(Sarnik::Localize(
            "$$$/Deblur/Dialog/WorkspaceLoadBoundsError=Some of the traces were not loaded because their estimation "
            "regions are out of image bounds."));
    }
}

/// Indices count the traces that were kept, so that after a rejection they may name others than were meant.
void ReadActive(PKernelCollection &collection, Sarnik::CContainer &in, std::set<std::int32_t> &active)
{
    const std::uint32_t count = in.ReadU32();
    for (std::uint32_t i = 0; i < count; ++i)
    {
        const std::int32_t index = in.ReadI32();
        const bool exists = index >= 0 && index < collection.Count();
        active.insert(exists ? index : -1);
        if (exists)
            collection.Activate(index);
    }
}

} // namespace

bool RegionFits(const PKernelCollection &collection, const PKernel &trace)
{
    return trace.Region().Empty() || collection.Picture().Bounds().Contains(trace.Region());
}

void WriteCollection(const PKernelCollection &collection, Sarnik::CContainer &out)
{
    const PKernel *lone = collection.Count() == 0 ? collection.LoneTrace() : nullptr;
    out.WriteU32(lone ? 1 : static_cast<std::uint32_t>(collection.Count()));
    out.WriteI32(collection.SelectedIndex());
    if (lone)
    {
        lone->Write(out);
        out.WriteU32(static_cast<std::uint32_t>(collection.ActiveCount()));
        if (collection.ActiveCount() != 0)
            out.WriteU32(0);
    }
    else
    {
        for (int i = 0; i < collection.Count(); ++i)
            collection.At(i)->Write(out);
        out.WriteU32(static_cast<std::uint32_t>(collection.ActiveCount()));
        for (int i = 0; i < collection.Count(); ++i)
            if (collection.IsActive(i))
                out.WriteU32(static_cast<std::uint32_t>(i));
    }
    out.WriteU32(collection.FoundDefaultSize());
}

void ReadCollection(PKernelCollection &collection, Sarnik::CContainer &in, PStreamIndices *indices)
{
    PStreamIndices unasked;
    PStreamIndices &told = indices ? *indices : unasked;
    told = {};
    collection.Clear();
    const std::uint32_t count = in.ReadU32();
    told.selected = in.ReadI32();
    ReadTraces(collection, in, count, told.selected);
    collection.Select(told.selected);
    ReadActive(collection, in, told.active);
    collection.SetFoundDefaultSize(in.ReadU32());
}

} // namespace Project
