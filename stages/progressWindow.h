#pragma once

#include <cstdint>
#include <string>

namespace Project
{

/// The window that a final render of the dialog shows. Main thread.
class PProgressWindow
{
public:
    virtual ~PProgressWindow() = default;
    /// Localised texts.
    virtual void Open(const std::string &title, const std::string &message, std::uint64_t done,
                      std::uint64_t total) = 0;
    virtual void Show(std::uint64_t done, std::uint64_t total) = 0;
    /// The user has pressed Cancel.
    virtual bool Cancelled() = 0;
    /// At the end of the render, however it ended.
    virtual void Close() = 0;
};

} // namespace Project
