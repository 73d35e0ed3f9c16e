#include "framework/base/alerts.h"

#include <cstdio>
#include <unistd.h>

namespace Sarnik
{
namespace
{

CTextAlerts &textPort()
{
    static CTextAlerts port;
    return port;
}

CAlertPort *current = nullptr;

} // namespace

CAlertAnswer CTextAlerts::Show(const CAlert &alert)
{
    std::string line = alert.title.empty() ? alert.first : alert.title + ": " + alert.first;
    if (!alert.second.empty())
        line += " " + alert.second;
    std::fprintf(stderr, "%s\n", line.c_str());
    return alert.kind == CAlertKind::Ok ? CAlertAnswer::Ok : answer;
}

void CTextAlerts::Beep()
{
    if (::isatty(STDERR_FILENO))
        std::fputc('\a', stderr);
}

CAlertPort &Alerts() noexcept
{
    return current ? *current : static_cast<CAlertPort &>(textPort());
}

CAlertPort *SetAlerts(CAlertPort *port) noexcept
{
    CAlertPort *before = current;
    current = port;
    return before;
}

} // namespace Sarnik
