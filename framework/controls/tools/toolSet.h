#pragma once

#include "framework/controls/tools/tool.h"
#include "framework/messages/messages.h"

#include <memory>
#include <vector>

namespace Sarnik
{

/// Tools in their order.
class CToolGroup
{
public:
    explicit CToolGroup(CObjID id) : groupId(id) {}
    CToolGroup(const CToolGroup &) = delete;
    CToolGroup &operator=(const CToolGroup &) = delete;
    virtual ~CToolGroup() = default;

    CObjID Id() const { return groupId; }
    CTool &Add(std::unique_ptr<CTool> tool);
    const std::vector<std::unique_ptr<CTool>> &Tools() const { return tools; }
    /// Null for none.
    CTool *Find(CObjID tool) const;

private:
    CObjID groupId;
    std::vector<std::unique_ptr<CTool>> tools;
};

/// A group of tools of which one is current, and the CToolButtons that have the set's id as their tool_set and the
/// tools' ids as their own. The window of the buttons passes its messages on:
///
///     bool ReceiveValue(CValueMessage &m) override { return tools.Receive(m) || CDialog::ReceiveValue(m); }
///     bool ReceiveMessage(CMessage &m) override { return tools.Receive(m) || CDialog::ReceiveMessage(m); }
class CToolSet
{
public:
    /// The buttons lie somewhere in `buttonsIn`, which outlives the set.
    CToolSet(CObjID id, CContext &buttonsIn, std::unique_ptr<CToolGroup> tools);
    CToolSet(const CToolSet &) = delete;
    CToolSet &operator=(const CToolSet &) = delete;
    virtual ~CToolSet();

    CObjID Id() const { return setId; }
    CToolGroup &Group() const { return *group; }
    /// Null until one is chosen.
    CTool *Current() const { return current; }
    /// Nothing for the current one, and for an id of no tool.
    void SetTool(CObjID tool);
    /// A button of the set was clicked. Whether the message said so.
    bool Receive(const CMessage &message);

protected:
    /// Another tool is current; either may be null. By default each is told.
    virtual void ToolChanged(CTool *old, CTool *now);

private:
    CObjID setId;
    CContext &buttons;
    std::unique_ptr<CToolGroup> group;
    CTool *current = nullptr;
};

} // namespace Sarnik
