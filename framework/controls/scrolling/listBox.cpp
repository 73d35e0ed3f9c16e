#include "framework/controls/scrolling/listBox.h"

#include "framework/layout/layoutFlags.h"

namespace Sarnik
{
namespace
{

constexpr std::int32_t rowHeight = 20, textCushion = 7;

constexpr std::uint32_t listAttributes = kScroller_YBar | kScroller_WellFrame | kScroller_AutoHideScrollBars;

} // namespace

class CListSheet::row final : public CCellSheetItem
{
public:
    explicit row(std::string shown) : text(std::move(shown)) {}

    void Draw(CPort &port, const CRect &cell, const state &) override
    {
        auto &list = static_cast<CListSheet &>(*Sheet());
        const Platform::rectangle r = toCanvas(cell);
        list.DrawRow(port, {r.left + textCushion, r.top, r.right - textCushion, r.bottom}, Index(), list.Ink());
    }
    std::string Text() const override { return text; }

    std::string text;
};

CListSheet::CListSheet(const CRect &viewFrame) : CCellSheet(viewFrame, kCellSheet_OneDimension)
{
    SetCellSize({40, rowHeight});
}

void CListSheet::SetTexts(const std::vector<std::string> &texts)
{
    std::vector<std::unique_ptr<CCellSheetItem>> rows;
    rows.reserve(texts.size());
    for (const std::string &text : texts)
        rows.push_back(std::make_unique<row>(text));
    SetItems(std::move(rows));
}

const std::string &CListSheet::TextOf(int index) const
{
    static const std::string nothing;
    const auto *const item = dynamic_cast<const row *>(Item(index));
    return item == nullptr ? nothing : item->text;
}

void CListSheet::SetListOptions(std::uint32_t bits)
{
    std::uint32_t cellOptions = kCellSheet_OneDimension;
    const auto map = [&](EListOptions from, ECellSheetOptions to) {
        if ((bits & from) != 0)
            cellOptions |= to;
    };
    map(kListBox_MultiSelect, kCellSheet_MultiSelect);
    map(kListBox_ContiguousSelect, kCellSheet_ContiguousSelect);
    map(kListBox_TrackSelect, kCellSheet_TrackSelect);
    map(kListBox_TrackRange, kCellSheet_TrackRange);
    map(kListBox_DeselectOutside, kCellSheet_DeselectOutside);
    SetCellOptions(cellOptions);
}

void CListSheet::ReadProperties(const CLayoutPlacement &placement, const CWyraVariablePropertyList &properties)
{
    CCellSheet::ReadProperties(placement, properties);
    SetListOptions(static_cast<std::uint32_t>(ReadFlags(properties, "list_options")));
}

void CListSheet::DrawRow(CPort &port, const Platform::rectangle &room, int index, Platform::colour ink)
{
    CDrawTools::Text(port, room, TextOf(index), Font(), ink, kAlign_Near, kAlign_Center, Platform::textTrim::middle);
}

CListBox::CListBox(const CRect &viewFrame) : CListBox(viewFrame, std::make_unique<CListSheet>())
{
}

CListBox::CListBox(const CRect &viewFrame, std::unique_ptr<CListSheet> ownSheet)
    : CScroller(viewFrame, listAttributes), list(ownSheet.get())
{
    SetContent(std::move(ownSheet));
}

void CListBox::ReadProperties(const CLayoutPlacement &placement, const CWyraVariablePropertyList &properties)
{
    CScroller::ReadProperties(placement, properties);
    list->SetId(Id());
    list->SetListOptions(static_cast<std::uint32_t>(ReadFlags(properties, "list_options")));
    std::int32_t font = kFont_UIMedium;
    properties.ReadAny({"control_font", "text_font"}, &font);
    list->SetFont(font);
}

} // namespace Sarnik
