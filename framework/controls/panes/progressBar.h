#pragma once

#include "framework/controls/layoutPane.h"
#include "framework/views/timer.h"

namespace Sarnik
{

/// How far something has come. Without a known end (indeterminate) a light runs along the bar. progress_auto_hide: it
/// hides itself while nothing is under way, that is at 0 and at 1.
class CProgressBar : public CLayoutPane
{
public:
    explicit CProgressBar(const CRect &viewFrame = {});

    /// 0 to 1; what lies outside (or is no number) is cut. Ends the indeterminate state. Only what changes is redrawn.
    void SetValue(double to);
    double Value() const { return value; }
    void SetIndeterminate(bool is);
    bool IsIndeterminate() const { return indeterminate; }
    void SetAutoHide(bool hides);

    void StateChanged() override;
    void Draw(CPort &port) override;

    static CLayoutSize NaturalSize(const CWyraVariablePropertyList &, const CTextMeasure &) { return {120, 10}; }

protected:
    void ReadProperties(const CLayoutPlacement &placement, const CWyraVariablePropertyList &properties) override;

private:
    static void Tick(void *bar);
    void Update();
    void UpdateTimer();
    Platform::rectangle Track() const;
    double FilledTo(double share) const;

    double value = 0;
    bool indeterminate = false, autoHide = false;
    double began = 0; ///< the light's time
    CTimer timer;
};

} // namespace Sarnik
