#pragma once

#include "framework/base/link.h"

namespace Sarnik
{

/// Works when the message loop has nothing else to do: a slice at a time, as events wait meanwhile. May be deleted and
/// made within a slice.
class CIdler : public CLink<CIdler>
{
public:
    CIdler();
    virtual ~CIdler();

    /// Gives each idler one slice. Whether any wants another soon; otherwise they are asked again after the next event
    /// or timer.
    static bool RunAll();

protected:
    /// Does a slice of work. Whether there is more.
    virtual bool Idle() = 0;

private:
    unsigned long pass = 0;
};

} // namespace Sarnik
