#pragma once

namespace Sarnik
{

class CException;

/// The one place where failures reach the user. Main thread.
class CReporter
{
public:
    /// The service.
    static CReporter *Get(bool create = true);

    /// Shows the exception's lines in an alert, or as little as it asks for: the alert sound, or nothing. Where the
    /// alert itself fails nothing is shown.
    void Report(const CException &exception) noexcept;
};

} // namespace Sarnik
