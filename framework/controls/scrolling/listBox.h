#pragma once

#include "framework/controls/scrolling/cellSheet.h"

#include <string>
#include <string_view>
#include <vector>

namespace Sarnik
{

/// As layouts write them.
enum EListOptions : std::uint32_t
{
    kListBox_NoOptions = 0,
    kListBox_MultiSelect = 1,
    kListBox_ContiguousSelect = 2,
    kListBox_TrackSelect = 4,
    kListBox_TrackRange = 8,
    kListBox_DeselectOutside = 16
};

/// One text below the other. The class "CListSheet" of layouts, to lie in a CScroller.
class CListSheet : public CCellSheet
{
public:
    explicit CListSheet(const CRect &viewFrame = {});

    /// Shown as they are. Nothing is selected afterwards.
    void SetTexts(const std::vector<std::string> &texts);
    const std::string &TextOf(int index) const;
    void SetListOptions(std::uint32_t bits);

protected:
    void ReadProperties(const CLayoutPlacement &placement, const CWyraVariablePropertyList &properties) override;
    /// A row's inside. By default its text.
    virtual void DrawRow(CPort &port, const Platform::rectangle &room, int index, Platform::colour ink);

private:
    class row;
};

/// A list in a frame, with a scroll bar. The class "CListBox" of layouts. Its messages are those of a CListSheet, with
/// the box's id.
class CListBox : public CScroller
{
public:
    explicit CListBox(const CRect &viewFrame = {});
    /// With a sheet of another class.
    CListBox(const CRect &viewFrame, std::unique_ptr<CListSheet> ownSheet);

    CListSheet &List() const { return *list; }

    static CLayoutSize NaturalSize(const CWyraVariablePropertyList &, const CTextMeasure &) { return {120, 100}; }

protected:
    void ReadProperties(const CLayoutPlacement &placement, const CWyraVariablePropertyList &properties) override;

private:
    CListSheet *list;
};

} // namespace Sarnik
