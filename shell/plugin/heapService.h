#pragma once

#include "shell/virtualHeap.h"

namespace Sarnik
{

/// The service of the virtual heap. Main thread.
CVirtualHeap *VirtualHeap(bool create = true);

} // namespace Sarnik
