#pragma once

#include "framework/views/tracker.h"

namespace Sarnik
{

/// Takes hold of what lies in a scroller and moves it with the pointer, as with a hand. Does nothing outside of a
/// scroller.
class CPanner : public CTracker
{
public:
    explicit CPanner(CView &content) : CTracker(content) {}

protected:
    bool Begin() override;
    void Track() override;

private:
    CPoint position; ///< of the scroller less the pointer's place in the window, at the press
};

} // namespace Sarnik
