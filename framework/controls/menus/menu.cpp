#include "framework/controls/menus/menu.h"

#include "framework/base/localisedString.h"

#include <stdexcept>

namespace Sarnik
{

void CMenu::Add(std::string text, CObjID command, CShortcut keys)
{
    items.push_back({std::move(text), command, keys});
}

void CMenu::AddNumbered(std::string text, std::optional<std::uint32_t> number)
{
    const std::uint32_t n = number.value_or(numbered);
    if (!block || block->IndexOf(*block + n) < 0)
        throw std::out_of_range("the menu has no such number");
    numbered = n + 1;
    Add(std::move(text), *block + n);
}

void CMenu::AddSeparator()
{
    items.push_back({});
}

void CMenu::Clear()
{
    items.clear();
    numbered = 0;
}

std::vector<CMenuRow> CMenu::Rows(CMessenger &from)
{
    CMenuMessage opening(id, CMenuMessage::purpose::opening);
    from.Dispatch(opening);
    Opening(from);

    std::vector<CMenuRow> rows;
    for (const item &i : items)
    {
        if (i.text.empty())
        {
            if (!rows.empty() && !rows.back().separator)
                rows.push_back({.separator = true, .text = {}, .keys = {}, .enabled = false, .command = {}});
            continue;
        }
        CCommandMessage asked(i.command, CCommandMessage::purpose::update);
        const bool known = i.command && from.Dispatch(asked);
        rows.push_back({.text = CDrawTools::SplitLabel(Localize(asked.text.empty() ? i.text : asked.text)),
                        .keys = i.keys.Text(),
                        .enabled = known && asked.enabled,
                        .checked = known && asked.checked,
                        .command = i.command});
    }
    if (!rows.empty() && rows.back().separator)
        rows.pop_back();
    return rows;
}

void CMenu::Choose(CMessenger &from, CObjID menu, CObjID command)
{
    CCommandMessage asked(command, CCommandMessage::purpose::update);
    if (!from.Dispatch(asked) || !asked.enabled)
        return;
    CMenuMessage chosen(menu, CMenuMessage::purpose::chosen, command);
    if (from.Dispatch(chosen))
        return;
    CCommandMessage message(command);
    from.Dispatch(message);
}

} // namespace Sarnik
