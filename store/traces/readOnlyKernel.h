#pragma once

#include "store/traces/kernel.h"

namespace Project
{

/// A trace whose kernel came from a file and cannot be estimated again.
class PReadOnlyKernel final : public PKernel
{
public:
    using PKernel::PKernel;
    /// The kernel and the settings of another trace; the region becomes a square of the side settings.size around the
    /// middle of the old one.
    static std::unique_ptr<PReadOnlyKernel> Of(const PKernel &other);

    PKernelKind KernelType() const override { return PKernelKind::ReadOnly; }
    std::unique_ptr<PKernel> Copy() const override { return std::make_unique<PReadOnlyKernel>(*this); }

private:
    explicit PReadOnlyKernel(const PKernel &other);
};

} // namespace Project
