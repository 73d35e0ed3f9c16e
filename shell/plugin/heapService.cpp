#include "shell/plugin/heapService.h"

#include "framework/base/service.h"

namespace Sarnik
{

CVirtualHeap *VirtualHeap(bool create)
{
    static CServiceT<CVirtualHeap> service;
    return service.Get(create);
}

} // namespace Sarnik
