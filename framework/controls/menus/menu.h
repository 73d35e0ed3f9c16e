#pragma once

#include "framework/controls/drawTools.h"
#include "framework/messages/messages.h"
#include "framework/messages/messenger.h"

#include <cstdint>
#include <functional>
#include <optional>
#include <string>
#include <vector>

namespace Sarnik
{

/// One row of a menu as it is shown.
struct CMenuRow
{
    bool separator = false;
    CDrawTools::label text; ///< localised
    std::string keys;       ///< the shortcut, to the right
    bool enabled = true;
    bool checked = false;
    CObjID command;
    /// Draws the row's inside in place of the text; empty for the text.
    std::function<void(CPort &, const Platform::rectangle &, Platform::colour ink)> draw = {};
};

/// A list of commands under a title. What can be done, and under what name, is asked each time it opens. Interface
/// thread.
///
///     CMenu file("sarnik/menu/file", "$$$/FileMenu/Title=&File");
///     file.Add("$$$/FileMenu/Load=&Load...", loadCommand, {Platform::key::o, Platform::ctrlModifier});
class CMenu
{
public:
    /// The title is to be localised; "&" marks its access key.
    explicit CMenu(CObjID menuId, std::string menuTitle = {}) : id(menuId), title(std::move(menuTitle)) {}
    /// With a block of commands for AddNumbered.
    CMenu(CObjID menuId, std::string menuTitle, const CBlockID &commands)
        : id(menuId), title(std::move(menuTitle)), block(commands)
    {
    }
    virtual ~CMenu() = default;

    CObjID Id() const { return id; }
    const std::string &Title() const { return title; }

    // Items. Texts are to be localised; "&" marks an access key.
    void Add(std::string text, CObjID command, CShortcut keys = {});
    /// The command is the block's `number`-th, by default as many as there are numbered items so far. Throws
    /// std::out_of_range past the block's end.
    void AddNumbered(std::string text, std::optional<std::uint32_t> number = {});
    /// Those at the ends, and all but one of several in a row, are not shown.
    void AddSeparator();
    void Clear();
    bool IsEmpty() const { return items.empty(); }

    struct item
    {
        std::string text; ///< empty: a separator
        CObjID command;
        CShortcut keys;
    };
    const std::vector<item> &Items() const { return items; }

    /// What is to be shown now, for a messenger that its commands are to enter at. A CMenuMessage says that the menu
    /// opens, and Opening may rebuild it; then UpdateCommand is asked for each item. What nobody knows is disabled.
    std::vector<CMenuRow> Rows(CMessenger &from);
    /// Carries out a row: a CMenuMessage says so and, where nobody takes it, the command is sent, unless it is no
    /// longer enabled. The messenger may be gone afterwards.
    static void Choose(CMessenger &from, CObjID menu, CObjID command);

protected:
    /// The menu is about to be shown.
    virtual void Opening(CMessenger &) {}

private:
    CObjID id;
    std::string title;
    std::optional<CBlockID> block;
    std::uint32_t numbered = 0;
    std::vector<item> items;
};

} // namespace Sarnik
