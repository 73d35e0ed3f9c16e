#pragma once

#include "store/params.h"
#include "store/traces/kernelCollection.h"
#include "store/traces/readOnlyKernel.h"

#include <stdexcept>

namespace TestSupport
{

/// A collection whose traces were not estimated.
class stageTraces final : Project::PTracePicture
{
public:
    stageTraces() : collection(*this, params, events, {}) {}

    Project::PKernel &add(const CorvaneDeblur::floatArray &kernel, const Sarnik::CRect &region)
    {
        Project::PTraceRecord record;
        record.kernel = kernel;
        record.region = region;
        record.settings.size = kernel.cols;
        record.settings.forcedApply = true;
        Project::PKernel &trace =
            collection.Insert(std::make_unique<Project::PReadOnlyKernel>(collection, record), collection.Count());
        collection.Activate(collection.Count() - 1);
        return trace;
    }

private:
    Sarnik::CRect Bounds() const override { return {0, 0, 1000, 1000}; }
    int Planes() const override { return 3; }
    int Depth() const override { return 8; }
    void ReadGrey(const Sarnik::CRect &, std::uint8_t, const CorvaneDeblur::floatArray &,
                  const CorvaneDeblur::byteArray &) override
    {
        throw std::logic_error("nothing is to be estimated here");
    }

    Project::PParams params;
    Project::PTraceEvents events;

public:
    Project::PKernelCollection collection;
};

} // namespace TestSupport
