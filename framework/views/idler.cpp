#include "framework/views/idler.h"

namespace Sarnik
{
namespace
{

CLinkList<CIdler> idlers;
unsigned long passes = 0;

} // namespace

CIdler::CIdler() : pass(passes)
{
    idlers.PushTail(*this);
}

CIdler::~CIdler()
{
    idlers.Unlink(*this);
}

bool CIdler::RunAll()
{
    // As with timers: whoever has not had its slice of this pass.
    const unsigned long thisPass = ++passes;
    const auto next = [&]() -> CIdler * {
        for (CIdler *i = idlers.Head(); i != nullptr; i = i->Next())
            if (i->pass < thisPass)
                return i;
        return nullptr;
    };
    bool more = false;
    while (CIdler *const idler = next())
    {
        idler->pass = thisPass;
        more = idler->Idle() || more;
    }
    return more;
}

} // namespace Sarnik
