#include "framework/base/process.h"

#include "framework/base/localisedString.h"

#include <atomic>
#include <thread>

namespace Sarnik
{
namespace
{

std::atomic<std::thread::id> mainThread;

} // namespace

CAlertAnswer CProcess::Alert(CAlertKind kind, std::string_view text) const
{
    return Alerts().Show({kind, Localize(ProcessName()), std::string(text), {}});
}

void CProcess::StoreMainThread() noexcept
{
    mainThread = std::this_thread::get_id();
}

bool CProcess::IsMainThread() noexcept
{
    return mainThread.load() == std::this_thread::get_id();
}

} // namespace Sarnik
