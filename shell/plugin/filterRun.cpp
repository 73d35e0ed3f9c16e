#include "shell/plugin/filter.h"

#include "framework/base/localisedString.h"
#include "shell/plugin/hostChecks.h"
#include "store/behavioralParameters.h"

#include <string>

namespace Project
{

using Sarnik::CAlertKind;
using Sarnik::Localize;

namespace
{

/// The host's colour space suite for one run, given back however it ends.
class coloursForRun
{
public:
    coloursForRun(Sarnik::CSuiteHold &slot, const TNSuiteProcs *host, PHostPicture &user) : hold(slot), picture(user)
    {
        hold = Sarnik::CSuiteHold(host, TN_COLOR_SPACE_SUITE, 2);
        picture.SetColourSuite(hold.As<TNColorSpaceSuite>());
    }
    coloursForRun(const coloursForRun &) = delete;
    coloursForRun &operator=(const coloursForRun &) = delete;
    ~coloursForRun()
    {
        picture.SetColourSuite(nullptr);
        hold.Release();
    }

private:
    Sarnik::CSuiteHold &hold;
    PHostPicture &picture;
};

} // namespace

bool PFilter::CheckHostVersion()
{
    if (BehavioralParametersExist(PreferencesFolder()) || supportsHostVersion(Properties().Number(TN_PROPERTY_VERSION)))
        return true;
    Alert(CAlertKind::Ok, Localize("$$$/Deblur/Warning/UnsupportedVersion="
                                   "The plug-in is not supported by this version of Tintorel."));
    return false;
}

bool PFilter::CheckImageSize()
{
    const Sarnik::CRect bounds = FilterBounds();
    if (bounds.Width() >= smallestSide && bounds.Height() >= smallestSide)
        return true;
    Alert(CAlertKind::Ok,
          Localize("$$$/Deblur/Dialog/sizeWarningText=Images/selections with dimension smaller than ^0 pixels are not "
                   "supported by Stillmark.",
                   {std::to_string(smallestSide)}));
    return false;
}

bool PFilter::DoRun()
{
    applied = false;
    if (!CheckHostVersion() || !CheckImageSize())
        return false;

    PPreferences &stored = *GetPreferences();
    PParams &run = *GetParams();
    PParams record(stored.parameters);
    GetImageHub();
    GetKernels();

    const coloursForRun colours(colourSpace, Suites().Host(), Picture());
    Properties().Set(TN_PROPERTY_WATCH, 1);
    UseWideBounds();
    Block().autoMask = 0; // the selection is applied here

    const bool playing = Properties().Number(TN_PROPERTY_PLAYING).value_or(0) != 0;
    if (!Interactive())
    {
        if (!Replay(record))
            return applied;
    }
    else
    {
        if (playing)
        {
            if (!ReadRecording(record))
                return applied;
            if (autoMode)
                GetKernels()->Clear();
        }
        else
        {
            CopySelected(run, stored.parameters);
            GetImageHub()->SetCellSize(static_cast<std::int32_t>(run.HubTileSize()));
        }
        ReadBehavioralParameters(PreferencesFolder(), run);
        if (run.outputLog && !PreferencesFolder().empty())
            timeLogFile = std::make_unique<PTimeLogFile>(PreferencesFolder());
        if (RunDialog())
            WriteDescriptor(run);
    }

    CopySelected(stored.parameters, run);
    SavePreferences(PreferencesDirectory(), stored);
    return applied;
}

bool PFilter::ReadRecording(PParams &record)
{
    if (!ReadDescriptor(record))
        return false;
    CopySelected(*GetParams(), record);
    return true;
}

bool PFilter::Replay(PParams &record)
{
    if (!ReadRecording(record))
        return false;
    if (FindTraces() && GetImageHub()->RenderWithCallbacks())
    {
        applied = true;
        WriteDescriptor(*GetParams());
    }
    return true;
}

/// There is no window yet: what the dialog would open with is taken as it is, as if its OK had been pressed.
bool PFilter::RunDialog()
{
    PKernelCollection &traces = *GetKernels();
    if (traces.Count() == 0)
    {
        traces.FindDefaultSize();
        traces.AddAutoTraces();
    }
    applied = EstimateMissing() && GetImageHub()->RenderWithCallbacks();
    return applied;
}

} // namespace Project
