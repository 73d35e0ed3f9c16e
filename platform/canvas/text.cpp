#include "platform/canvas/text.h"

#include "platform/canvas/textLayout.h"
#include "platform/utf8.h"

#include <algorithm>
#include <cmath>

namespace Platform
{
namespace
{

double units(int pango)
{
    return static_cast<double>(pango) / PANGO_SCALE;
}

/// A character's box where no font can be loaded at all, in parts of the em.
constexpr double boxWidth = 0.6, boxAscent = 0.93, boxDescent = 0.24;

PangoAttribute *boxes(double size)
{
    const auto whole = [&](double part) { return static_cast<int>(part * size * PANGO_SCALE); };
    const PangoRectangle box{0, -whole(boxAscent), whole(boxWidth), whole(boxAscent + boxDescent)};
    return pango_attr_shape_new(&box, &box);
}

/// A frame, as the library draws for letters that none of its fonts has.
void drawBox(cairo_t *cairo, PangoAttrShape *box, gboolean, void *)
{
    double x = 0, y = 0;
    cairo_get_current_point(cairo, &x, &y);
    const double width = units(box->logical_rect.width), top = units(box->logical_rect.y);
    cairo_rectangle(cairo, x + 0.15 * width, y + 0.8 * top, 0.7 * width, -0.8 * top);
    cairo_set_line_width(cairo, 0.1 * width);
    cairo_stroke(cairo);
}

/// Without a font the library (1.50) leaves the offsets of its runs unset, and adds them to all that it measures.
void clearOffsets(PangoLayout *pango)
{
    for (const GSList *line = pango_layout_get_lines(pango); line != nullptr; line = line->next)
        for (const GSList *run = static_cast<PangoLayoutLine *>(line->data)->runs; run != nullptr; run = run->next)
        {
            auto *const item = static_cast<PangoGlyphItem *>(run->data);
            item->y_offset = item->start_x_offset = item->end_x_offset = 0;
        }
}

/// One per thread. Measures must not depend on the scale or on the user's rendering settings: no hinting.
PangoContext *textContext()
{
    struct holder
    {
        holder() : context(pango_font_map_create_context(pango_cairo_font_map_get_default()))
        {
            cairo_font_options_t *options = cairo_font_options_create();
            cairo_font_options_set_antialias(options, CAIRO_ANTIALIAS_GRAY);
            cairo_font_options_set_hint_style(options, CAIRO_HINT_STYLE_NONE);
            cairo_font_options_set_hint_metrics(options, CAIRO_HINT_METRICS_OFF);
            pango_cairo_context_set_font_options(context, options);
            cairo_font_options_destroy(options);
            pango_context_set_round_glyph_positions(context, FALSE);
            pango_cairo_context_set_shape_renderer(context, drawBox, nullptr, nullptr);
        }
        ~holder() { g_object_unref(context); }
        PangoContext *context;
    };
    static thread_local holder held;
    return held.context;
}

PangoAlignment alignment(textAlign a)
{
    return a == textAlign::centre ? PANGO_ALIGN_CENTER : a == textAlign::right ? PANGO_ALIGN_RIGHT : PANGO_ALIGN_LEFT;
}

PangoEllipsizeMode ellipsis(textTrim t)
{
    switch (t)
    {
    case textTrim::start:
        return PANGO_ELLIPSIZE_START;
    case textTrim::middle:
        return PANGO_ELLIPSIZE_MIDDLE;
    case textTrim::end:
        return PANGO_ELLIPSIZE_END;
    case textTrim::none:
        break;
    }
    return PANGO_ELLIPSIZE_NONE;
}

/// Positions are 32-bit integers of 1/1024 unit: text is cut before they can overflow, with letters of up to 1.3 em.
std::size_t mostBytes(double size)
{
    return static_cast<std::size_t>(2147483647.0 / PANGO_SCALE / (size * 1.3));
}

} // namespace

textBlock::layout::layout(std::string_view utf8, const font &f, const textOptions &options)
{
    const double size = f.size >= 1 ? std::min(f.size, 1000.0) : 1.0;
    const std::size_t most = mostBytes(size);
    text = cleanText(utf8.substr(0, most));
    if (text.size() > most)
        text.resize(characterStart(text, most)); // cleaning made it longer

    pango = pango_layout_new(textContext());
    PangoFontDescription *face = pango_font_description_new();
    pango_font_description_set_family(face, cleanText(f.family).c_str());
    pango_font_description_set_absolute_size(face, size * PANGO_SCALE);
    pango_font_description_set_weight(face, f.bold ? PANGO_WEIGHT_BOLD : PANGO_WEIGHT_NORMAL);
    pango_font_description_set_style(face, f.italic ? PANGO_STYLE_ITALIC : PANGO_STYLE_NORMAL);
    pango_layout_set_font_description(pango, face);
    PangoFont *const loaded = pango_context_load_font(textContext(), face);
    pango_font_description_free(face);

    pango_layout_set_single_paragraph_mode(pango, !options.lines);
    if (options.width > 0 && (options.lines || options.trim != textTrim::none || options.align != textAlign::left))
    {
        pango_layout_set_width(pango, static_cast<int>(std::min(options.width, 1e6) * PANGO_SCALE));
    }
    pango_layout_set_wrap(pango, PANGO_WRAP_WORD_CHAR);
    pango_layout_set_ellipsize(pango, ellipsis(options.trim));
    // One line that is too wide stays one, aligned or not.
    if (!options.lines && options.width > 0 && options.trim == textTrim::none && options.align != textAlign::left)
        pango_layout_set_ellipsize(pango, PANGO_ELLIPSIZE_END);
    pango_layout_set_alignment(pango, alignment(options.align));
    pango_layout_set_text(pango, text.data(), static_cast<int>(text.size()));

    PangoAttrList *const attributes = pango_attr_list_new();
    if (loaded == nullptr)
        pango_attr_list_insert(attributes, boxes(size));
    if (options.underlined >= 0 && static_cast<std::size_t>(options.underlined) < text.size())
    {
        PangoAttribute *line = pango_attr_underline_new(PANGO_UNDERLINE_SINGLE);
        line->start_index = static_cast<guint>(options.underlined);
        line->end_index = static_cast<guint>(
            static_cast<std::size_t>(options.underlined) +
            std::max<std::size_t>(1, characterLength(std::string_view(text).substr(std::size_t(options.underlined)))));
        pango_attr_list_insert(attributes, line);
    }
    pango_layout_set_attributes(pango, attributes);
    pango_attr_list_unref(attributes);

    if (loaded == nullptr)
        clearOffsets(pango);
    else
        g_object_unref(loaded);
}

textBlock::layout::~layout()
{
    g_object_unref(pango);
}

int textBlock::layout::index(std::size_t offset) const
{
    return static_cast<int>(characterStart(text, offset));
}

textBlock::textBlock(std::string_view utf8, const font &f, const textOptions &options)
    : made(std::make_unique<layout>(utf8, f, options))
{
}

textBlock::~textBlock() = default;
textBlock::textBlock(textBlock &&) noexcept = default;
textBlock &textBlock::operator=(textBlock &&) noexcept = default;

const std::string &textBlock::text() const
{
    return made->text;
}

double textBlock::width() const
{
    PangoRectangle box;
    pango_layout_get_extents(made->pango, nullptr, &box);
    return units(box.width);
}

double textBlock::height() const
{
    int height = 0;
    pango_layout_get_size(made->pango, nullptr, &height);
    return units(height);
}

double textBlock::baseline() const
{
    return units(pango_layout_get_baseline(made->pango));
}

int textBlock::lineCount() const
{
    return pango_layout_get_line_count(made->pango);
}

std::size_t textBlock::lastLine() const
{
    PangoLayoutLine *const line = pango_layout_get_line_readonly(made->pango, lineCount() - 1);
    return static_cast<std::size_t>(pango_layout_line_get_start_index(line));
}

rectangle textBlock::caret(std::size_t offset) const
{
    PangoRectangle strong;
    pango_layout_get_cursor_pos(made->pango, made->index(offset), &strong, nullptr);
    return {units(strong.x), units(strong.y), units(strong.x), units(strong.y + strong.height)};
}

std::size_t textBlock::offsetAt(point p) const
{
    const auto whole = [](double v) {
        return static_cast<int>(std::clamp(std::isfinite(v) ? v : 0.0, -1e6, 1e6) * PANGO_SCALE);
    };
    int index = 0, trailing = 0;
    pango_layout_xy_to_index(made->pango, whole(p.x), whole(p.y), &index, &trailing);
    const char *const text = made->text.c_str();
    return static_cast<std::size_t>(g_utf8_offset_to_pointer(text + index, trailing) - text);
}

std::vector<rectangle> textBlock::covered(std::size_t from, std::size_t to) const
{
    std::vector<rectangle> result;
    const int first = made->index(from), last = made->index(to);
    if (first >= last)
        return result;
    PangoLayoutIter *line = pango_layout_get_iter(made->pango);
    do
    {
        PangoLayoutLine *const at = pango_layout_iter_get_line_readonly(line);
        const int start = pango_layout_line_get_start_index(at), end = start + pango_layout_line_get_length(at);
        if (last <= start || first > end)
            continue;
        int top = 0, bottom = 0, count = 0, *edges = nullptr;
        pango_layout_iter_get_line_yrange(line, &top, &bottom);
        // Edges come from the layout's left side, alignment and all.
        pango_layout_line_get_x_ranges(at, std::max(first, start), std::min(last, end), &edges, &count);
        for (int i = 0; i < count; ++i)
            result.push_back({units(edges[2 * i]), units(top), units(edges[2 * i + 1]), units(bottom)});
        g_free(edges);
    } while (pango_layout_iter_next_line(line));
    pango_layout_iter_free(line);
    return result;
}

namespace
{

/// The first character boundary from an offset, in a direction, whose attributes fit.
template <class Fits> std::size_t seek(PangoLayout *pango, const std::string &text, int from, int direction, Fits fits)
{
    int count = 0;
    const PangoLogAttr *const attributes = pango_layout_get_log_attrs_readonly(pango, &count);
    const char *const begin = text.c_str();
    auto i = static_cast<int>(g_utf8_pointer_to_offset(begin, begin + from)) + direction;
    while (i > 0 && i < count - 1 && !fits(attributes[i]))
        i += direction;
    if (i <= 0)
        return 0;
    return i >= count - 1 ? text.size() : static_cast<std::size_t>(g_utf8_offset_to_pointer(begin, i) - begin);
}

bool isCaretPlace(const PangoLogAttr &a)
{
    return a.is_cursor_position;
}

bool isWordStart(const PangoLogAttr &a)
{
    return a.is_word_start;
}

} // namespace

std::size_t textBlock::nextCharacter(std::size_t offset) const
{
    return seek(made->pango, made->text, made->index(offset), 1, isCaretPlace);
}

std::size_t textBlock::previousCharacter(std::size_t offset) const
{
    return seek(made->pango, made->text, made->index(offset), -1, isCaretPlace);
}

std::size_t textBlock::nextWord(std::size_t offset) const
{
    return seek(made->pango, made->text, made->index(offset), 1, isWordStart);
}

std::size_t textBlock::previousWord(std::size_t offset) const
{
    return seek(made->pango, made->text, made->index(offset), -1, isWordStart);
}

bool textBlock::beginsWithWord() const
{
    int count = 0; // at least one: the end's
    return isWordStart(*pango_layout_get_log_attrs_readonly(made->pango, &count));
}

} // namespace Platform
