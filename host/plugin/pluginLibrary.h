#pragma once

#include "shell/tintorel.h"

#include <memory>
#include <string>

namespace Stillmark
{

/// A plug-in that is loaded into the process while the object lives. Its code must not run any more when it goes.
class pluginLibrary
{
public:
    /// Throws Platform::fileError with one line that names the file and tells whether it is missing, is no library that
    /// loads here, or has no entry.
    explicit pluginLibrary(const std::string &path);

    TNEntry entry() const { return entryPoint; }

private:
    struct close
    {
        void operator()(void *library) const noexcept;
    };

    std::unique_ptr<void, close> library;
    TNEntry entryPoint = nullptr;
};

} // namespace Stillmark
