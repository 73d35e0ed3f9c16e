#pragma once

#include "platform/canvas/text.h"

#include <pango/pangocairo.h>

#include <string>

namespace Platform
{

/// What a textBlock keeps. For the sources of this folder only.
struct textBlock::layout
{
    layout(std::string_view utf8, const font &f, const textOptions &options);
    ~layout();
    layout(const layout &) = delete;
    layout &operator=(const layout &) = delete;

    /// An offset that the library accepts.
    int index(std::size_t offset) const;

    std::string text;
    PangoLayout *pango = nullptr;
};

} // namespace Platform
