#include "shell/plugin/failureResult.h"

#include "framework/base/exceptions.h"
#include "framework/base/reporter.h"
#include "platform/error.h"
#include "shell/tintorel.h"

#include <exception>

namespace Sarnik
{
namespace
{

std::int16_t report(const CException &exception) noexcept
{
    try
    {
        if (CReporter *reporter = CReporter::Get())
            reporter->Report(exception);
    }
    catch (...)
    {
        // No memory for as much as the reporter: nobody can be told.
    }
    return TNUserHasBeenTold;
}

} // namespace

std::int16_t resultOf(const std::function<bool()> &work) noexcept
{
    try
    {
        return work() ? TNNoError : TNUserHasBeenTold;
    }
    catch (const CTintorelError &error)
    {
        return error.Code() != 0 ? error.Code() : std::int16_t{TNUserHasBeenTold};
    }
    catch (const CException &exception)
    {
        return report(exception);
    }
    catch (const Platform::cancelled &)
    {
        return TNUserHasBeenTold;
    }
    catch (const std::exception &failure)
    {
        try
        {
            return report(CError(failure.what()));
        }
        catch (...)
        {
            return TNUserHasBeenTold;
        }
    }
    catch (...)
    {
        return report(CException());
    }
}

} // namespace Sarnik
