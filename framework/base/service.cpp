#include "framework/base/service.h"

namespace Sarnik
{
namespace
{

CService *head = nullptr;

} // namespace

void CService::Link() noexcept
{
    next = head;
    head = this;
}

void CService::ShutdownAll()
{
    while (head != nullptr)
    {
        CService *service = head;
        head = service->next;
        service->next = nullptr;
        service->Shutdown();
    }
}

} // namespace Sarnik
