#include "framework/base/container.h"
#include "framework/base/exceptions.h"
#include "framework/base/localisedString.h"
#include "shell/plugin/descriptor.h"
#include "shell/plugin/filter.h"
#include "shell/plugin/recordKeys.h"
#include "store/files/collectionStream.h"

#include <optional>

namespace Project
{
namespace
{

using Sarnik::CDescriptor;
using Sarnik::CMemoryContainer;

/// Bytes of a recorded collection; far more than 4000 of the largest traces need.
constexpr std::uint64_t mostTraceBytes = std::uint64_t{1} << 30;

/// What a recording says beside its traces.
struct recording
{
    bool automatic = false;
    std::int32_t height = 0, width = 0;
    bool fineResult = true;
};

bool ReadTraces(CDescriptor &descriptor, PKernelCollection &kernels)
{
    const auto bytes = descriptor.Data(keyTraces, mostTraceBytes);
    if (!bytes)
        return false;
    CMemoryContainer stream(*bytes);
    ReadCollection(kernels, stream);
    return true;
}

/// The reader takes keys as they come. None where the host fails.
std::optional<recording> ReadKeys(CDescriptor &descriptor, PKernelCollection &kernels)
{
    const auto keys = descriptor.Keys();
    if (!keys)
        return std::nullopt;
    recording found;
    const auto take = [](auto &field, const auto &value) {
        if (value)
            field = *value;
        return value.has_value();
    };
    for (const std::uint32_t key : *keys)
    {
        bool good = true;
        std::int32_t version = 0;
        switch (key)
        {
        case keyHeight:
            good = take(found.height, descriptor.Integer(key));
            break;
        case keyWidth:
            good = take(found.width, descriptor.Integer(key));
            break;
        case keyVersion:
            good = take(version, descriptor.Integer(key));
            if (good)
                kernels.SetVersion(static_cast<std::uint16_t>(version));
            break;
        case keyAutomatic:
            good = take(found.automatic, descriptor.Boolean(key));
            break;
        case keyFineResult:
            // Whoever recorded this mark recorded the traces with it.
            good = take(found.fineResult, descriptor.Boolean(key)) && ReadTraces(descriptor, kernels);
            break;
        case keyTraces:
            good = ReadTraces(descriptor, kernels);
            break;
        default:
            break;
        }
        if (!good)
            return std::nullopt;
    }
    return found;
}

} // namespace

bool PFilter::ReadDescriptor(PParams &record)
{
    if (Suites().Host() == nullptr)
        return true;
    const TNDescriptorSuite *suite = Suites().Descriptors();
    const TNDescriptorSlot *slot = Block().descriptor;
    if (suite == nullptr || slot == nullptr)
        return false;
    CDescriptor descriptor(*suite);
    if (!descriptor.Open(slot->descriptor))
        return false;
    const auto found = ReadKeys(descriptor, *GetKernels());
    if (!found)
        return false;

    autoMode = found->automatic;
    const Sarnik::CRect bounds = FilterBounds();
    if (!autoMode && (bounds.Width() != found->width || bounds.Height() != found->height))
    {
        autoMode = true;
        if (Alert(Sarnik::CAlertKind::YesNo,
                  Sarnik::Localize("$$$/Deblur/Dialog/loadActionSizeWarning=The image size stored in the action is "
                                   "different from the current image. Would you like to ignore the recorded settings "
                                   "and estimate blur trace automatically?")) == Sarnik::CAlertAnswer::No)
            return false;
    }
    record.fineResult = found->fineResult;
    return true;
}

void PFilter::WriteDescriptor(const PParams &record)
{
    const TNDescriptorSuite *suite = Suites().Descriptors();
    TNDescriptorSlot *slot = Block().descriptor;
    if (suite == nullptr || slot == nullptr)
        return;
    CDescriptor descriptor(*suite);
    if (!descriptor.Create())
        return;

    PKernelCollection &traces = *GetKernels();
    bool good = descriptor.PutInteger(keyVersion, recordVersion) && descriptor.PutBoolean(keyAutomatic, autoMode);
    if (autoMode)
        good = good && descriptor.PutBoolean(keyFullAutomatic, true);
    else
    {
        const Sarnik::CRect bounds = FilterBounds();
        good = good && descriptor.PutInteger(keyHeight, static_cast<std::int32_t>(bounds.Height())) &&
               descriptor.PutInteger(keyWidth, static_cast<std::int32_t>(bounds.Width())) &&
               descriptor.PutInteger(keyTraceCount, traces.Count()) &&
               descriptor.PutInteger(keyActiveCount, traces.ActiveCount());
    }
    CMemoryContainer parameters, stream;
    WriteParameters(parameters, record);
    WriteCollection(traces, stream);
    good = good && descriptor.PutData(keyParameters, parameters.Content()) &&
           descriptor.PutBoolean(keyFineResult, record.fineResult) && descriptor.PutData(keyTraces, stream.Content());
    if (const TNHandle handle = good ? descriptor.ToHandle() : nullptr)
        slot->descriptor = handle;
}

} // namespace Project
