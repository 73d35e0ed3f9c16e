#include "framework/controls/tools/toolSet.h"

#include "framework/controls/buttons/toolButton.h"

#include <utility>

namespace Sarnik
{

CTool &CToolGroup::Add(std::unique_ptr<CTool> tool)
{
    tools.push_back(std::move(tool));
    return *tools.back();
}

CTool *CToolGroup::Find(CObjID tool) const
{
    for (const auto &t : tools)
        if (t->GetId() == tool)
            return t.get();
    return nullptr;
}

CToolSet::CToolSet(CObjID id, CContext &buttonsIn, std::unique_ptr<CToolGroup> tools)
    : setId(id), buttons(buttonsIn), group(std::move(tools))
{
    for (const auto &tool : group->Tools())
        tool->Attach(*this);
}

CToolSet::~CToolSet()
{
    for (const auto &tool : group->Tools())
        tool->Detach(*this);
}

void CToolSet::SetTool(CObjID tool)
{
    CTool *const chosen = group->Find(tool);
    if (chosen == nullptr || chosen == current)
        return;
    CTool *const old = std::exchange(current, chosen);
    CToolButton::Choose(buttons, setId, tool);
    ToolChanged(old, chosen);
}

bool CToolSet::Receive(const CMessage &message)
{
    if (const auto *const chosen = dynamic_cast<const CValMsg<CObjID> *>(&message);
        chosen != nullptr && message.Id() == setId)
    {
        SetTool(chosen->Value());
        return true;
    }
    const auto *const click = dynamic_cast<const CToolClick *>(&message);
    if (click == nullptr || group->Find(click->Source()) == nullptr)
        return false;
    if (current != nullptr && click->Source() == current->GetId())
        current->ButtonClicked(click->Clicks());
    return true;
}

void CToolSet::ToolChanged(CTool *old, CTool *now)
{
    if (old != nullptr)
        old->Deactivated();
    if (now != nullptr)
        now->Activated();
}

} // namespace Sarnik
