#pragma once

#include "framework/controls/panes/framePane.h"

namespace Sarnik
{

/// A frame whose first child, a heading, always shows, and whose other children, the content, can be hidden. Hidden,
/// the pane is as high as the heading with the same margin above and below. Its neighbours are the parent's business:
/// the pane says that its height has changed by a CMessageEvent of the id Changed with its own id as the source, which
/// climbs from it; stackColumn (columnStack.h) is how a column answers.
class CDisclosurePane : public CFramePane
{
public:
    explicit CDisclosurePane(const CRect &viewFrame = {}) : CFramePane(viewFrame, kFramePrimaryGroup) {}

    bool IsDisclosed() const { return disclosed; }
    /// A focus in a content that is hidden goes to the heading's first view that can have it.
    void Disclose(bool show);

    static const CObjID Changed;

private:
    std::int32_t HeadingHeight() const;

    bool disclosed = true;
    std::int32_t fullHeight = 0; ///< while the content is hidden
};

} // namespace Sarnik
