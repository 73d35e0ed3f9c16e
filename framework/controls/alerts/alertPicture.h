#pragma once

#include "framework/controls/alerts/messageAlert.h"
#include "framework/views/view.h"

namespace Sarnik
{

/// The sign beside an alert's text, drawn as large as its frame.
class CAlertPicture final : public CPane
{
public:
    CAlertPicture(CAlertIcon what, const CRect &frame) : CPane(frame), icon(what) {}

    void Draw(CPort &port) override;

private:
    CAlertIcon icon;
};

} // namespace Sarnik
