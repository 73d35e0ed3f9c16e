#pragma once

#include "framework/controls/layoutPane.h"

namespace Sarnik
{

/// One of the panes that a CSwitchPane chooses from, by its case_id.
class CCasePane : public CLayoutPane
{
public:
    using CLayoutPane::CLayoutPane;

    CObjID CaseId() const { return caseId; }
    void SetCaseId(CObjID to) { caseId = to; }

protected:
    void ReadProperties(const CLayoutPlacement &placement, const CWyraVariablePropertyList &properties) override;

private:
    CObjID caseId;
};

/// Shows one of its CCasePane children, the first one to begin with.
class CSwitchPane : public CLayoutPane
{
public:
    using CLayoutPane::CLayoutPane;

    /// Shows the case of this id and hides the others; a focus within one of them goes to the first view of the new
    /// case that can have it. An id of no case changes nothing. Whether there is such a case.
    bool Switch(CObjID caseId);
    /// The case that is shown; 0 for none.
    CObjID Current() const { return current; }
    /// Adds a case, in code as in a layout.
    void AddCase(std::unique_ptr<CCasePane> pane);

protected:
    void TakeChild(std::unique_ptr<CView> child, std::int32_t interior) override;

private:
    CObjID current;
};

} // namespace Sarnik
