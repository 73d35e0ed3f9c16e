#include "framework/controls/panes/switchPane.h"

#include "framework/controls/focusOrder.h"
#include "framework/views/window.h"

#include <utility>

namespace Sarnik
{

void CCasePane::ReadProperties(const CLayoutPlacement &, const CWyraVariablePropertyList &properties)
{
    caseId = CObjID(properties.Text("case_id"));
}

void CSwitchPane::AddCase(std::unique_ptr<CCasePane> pane)
{
    if (!current)
        current = pane->CaseId();
    pane->Show(pane->CaseId() == current);
    Add(std::move(pane));
}

void CSwitchPane::TakeChild(std::unique_ptr<CView> child, std::int32_t interior)
{
    if (auto *const pane = dynamic_cast<CCasePane *>(child.get()))
    {
        child.release();
        return AddCase(std::unique_ptr<CCasePane>(pane));
    }
    CLayoutPane::TakeChild(std::move(child), interior);
}

bool CSwitchPane::Switch(CObjID caseId)
{
    CCasePane *shown = nullptr;
    for (const auto &child : Children())
        if (auto *const pane = dynamic_cast<CCasePane *>(child.get()); pane != nullptr && pane->CaseId() == caseId)
            shown = pane;
    if (shown == nullptr || caseId == current)
        return shown != nullptr;

    current = caseId;
    const CWindow *const window = Window();
    const CView *const focus = window == nullptr ? nullptr : window->Focus();
    const bool moves = focus != nullptr && focus != this && focus->IsWithin(*this);
    shown->Show(true);
    if (moves)
        focusFirst(*shown);
    for (const auto &child : Children())
        if (child.get() != shown && dynamic_cast<CCasePane *>(child.get()) != nullptr)
            child->Show(false);
    return true;
}

} // namespace Sarnik
