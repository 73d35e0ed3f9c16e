#include "framework/layout/layoutFlags.h"

namespace Sarnik
{
namespace
{

struct flag
{
    std::string_view word, property;
    std::int32_t bit;
    bool clears = false; ///< true in the layout clears the bit
};

// clang-format off
constexpr flag flags[] = {
    {"view_options", "view_invisible", 1},
    {"view_options", "view_disabled", 2},
    {"view_options", "view_target", 4},
    {"view_options", "view_bullseye", 8},
    {"view_options", "view_tabstop", 16},
    {"view_options", "view_target_ring", 32},
    {"view_options", "view_context_click", 64},
    {"view_options", "view_invalid_on_activate", 128},
    {"view_options", "view_draw_buffer", 256},
    {"view_options", "view_draw_parts", 512},
    {"view_options", "view_chunky_scroll", 1024},
    {"view_options", "view_entire_scroll", 2048},
    {"view_options", "view_big_coordinates", 4096},
    {"view_options", "view_ignore_mouse_events", 8192},
    {"view_options", "view_multi_on_mouse_up", 16384},
    {"view_options", "view_no_focus_on_click", 32768},
    {"view_options", "view_no_tab_navigate", 0x10000},
    {"view_options", "view_supress_surrenders", 0x20000},

    {"window_features", "window_can_close", 1},
    {"window_features", "window_can_move", 2},
    {"window_features", "window_can_size", 4},
    {"window_features", "window_has_size_box", 8},
    {"window_features", "window_live_resize", 16},
    {"window_features", "window_can_zoom", 32},
    {"window_features", "window_can_maximize", 32},
    {"window_features", "window_can_collapse", 64},
    {"window_features", "window_can_minimize", 64},
    {"window_features", "window_can_target", 128},
    {"window_features", "window_can_bullseye", 256},
    {"window_features", "window_can_tabstop", 512},
    {"window_features", "window_open_hidden", 1024},
    {"window_features", "window_auto_delete", 2048},
    {"window_features", "window_disable_owner", 4096},
    {"window_features", "window_drop_files", 8192},
    {"window_features", "window_resolution_independent", 16384},

    {"text_options", "text_multi_line", 1},
    {"text_options", "text_auto_grow", 2},
    {"text_options", "text_framed", 4, true},
    {"text_options", "text_read_only", 8},
    {"text_options", "text_password", 16},
    {"text_options", "text_can_scroll", 32},
    {"text_options", "text_return_is_enter", 64},
    {"text_options", "text_ignore_fkeys", 128},
    {"text_options", "text_no_range_alert", 256},

    {"static_options", "static_wrap", 1},
    {"static_options", "static_group_title", 2},

    {"list_options", "list_multi_select", 1},
    {"list_options", "list_contiguous_select", 2},
    {"list_options", "list_track_select", 4},
    {"list_options", "list_track_range", 8},
    {"list_options", "list_deselect_outside", 16},

    {"radio_options", "radio_custom_items", 1},
    {"radio_options", "radio_report_all", 2},

    {"number_format", "decimal_number", 1},
    {"number_format", "decimal_fixed", 2},
    {"number_format", "integer_pad", 4},
    {"number_format", "show_plus", 8},
    {"number_format", "wrap_around", 16},

    {"scroller_attributes", "scroller_horizontal_bar", 1},
    {"scroller_attributes", "scroller_vertical_bar", 2},
    {"scroller_attributes", "scroller_size_box", 4},
    {"scroller_attributes", "scroller_well_frame", 8},
    {"scroller_attributes", "scroller_autohide_scrollbars", 16},

    {"angle_slider", "angle_slider_clockwise", 1},
    {"angle_slider", "angle_slider_bidirectional", 2},
    {"angle_slider", "angle_slider_pin_value", 4},
};
// clang-format on

} // namespace

std::int32_t ReadFlags(const CWyraVariablePropertyList &properties, std::string_view word, std::int32_t otherwise)
{
    std::int32_t bits = properties.Integer(word, otherwise);
    for (const flag &f : flags)
        if (std::int32_t value = 0; f.word == word && properties.ReadInteger(f.property, &value))
            bits = ((value != 0) != f.clears) ? bits | f.bit : bits & ~f.bit;
    return bits;
}

} // namespace Sarnik
