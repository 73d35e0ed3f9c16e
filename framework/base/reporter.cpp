#include "framework/base/reporter.h"

#include "framework/base/alerts.h"
#include "framework/base/exceptions.h"
#include "framework/base/localisedString.h"
#include "framework/base/service.h"

#include <utility>

namespace Sarnik
{
namespace
{

void show(const CException &exception)
{
    if (exception.Silent())
        return;
    if (!exception.ShowAlert())
        return Alerts().Beep();

    CAlert alert;
    alert.title = Localize("$$$/Sarnik/Reporter/Title=Error");
    alert.first = exception.GetTaskString();
    alert.second = exception.GetErrorString();
    if (alert.first.empty())
        std::swap(alert.first, alert.second);
    if (alert.first.empty())
        alert.first = Localize("$$$/Sarnik/Reporter/Default=The operation could not be completed.");
    Alerts().Show(alert);
}

} // namespace

CReporter *CReporter::Get(bool create)
{
    static CServiceT<CReporter> service;
    return service.Get(create);
}

void CReporter::Report(const CException &exception) noexcept
{
    try
    {
        show(exception);
    }
    catch (...)
    {
        // There is nobody left to tell.
    }
}

} // namespace Sarnik
