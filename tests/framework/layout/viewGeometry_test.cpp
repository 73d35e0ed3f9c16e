#include "tests/framework/layout/layoutViews.h"

#include <gtest/gtest.h>

#include <random>

namespace Sarnik
{
namespace
{

void list(const noteView &view, std::string &out)
{
    const CRect &r = view.placement.frame;
    out += (out.empty() ? "" : " | ") + std::to_string(r.left) + "," + std::to_string(r.top) + " " +
           std::to_string(r.Width()) + "x" + std::to_string(r.Height());
    for (const auto &child : view.children)
        list(*child, out);
}

/// "left,top WIDTHxHEIGHT" of the window and all views, parents before children, each from its parent's corner.
std::string rectangles(const std::string &text)
{
    std::string out;
    list(*layoutBench().Build(text), out);
    return out;
}

struct layoutCase
{
    const char *text, *expected;
};

class Geometry : public testing::TestWithParam<layoutCase>
{
};

TEST_P(Geometry, PlacesViews)
{
    EXPECT_EQ(rectangles(GetParam().text), GetParam().expected) << GetParam().text;
}

//  +------+   a column: children below each other, in the middle across
//  | +--+ |
//  | +--+ |
//  |+----+|
//  +------+
INSTANTIATE_TEST_SUITE_P(
    Column, Geometry,
    testing::Values(
        layoutCase{"Pane(margin: 2, spacing: 3) { Box(); Box(width: 20); Box(height: 4); }",
                   "0,0 24x34 | 7,2 10x10 | 2,15 20x10 | 7,28 10x4"},
        // fill, right and left across; the offset of a view at the left widens its parent, that of a centred one does
        // not
        layoutCase{"Pane() { Box(width: 40); Box(horizontal: align_fill); Box(horizontal: align_right);"
                   " Box(horizontal: align_left, left_offset: 35); }",
                   "0,0 45x40 | 2,0 40x10 | 0,10 45x10 | 35,20 10x10 | 35,30 10x10"},
        layoutCase{"Pane() { Box(left_offset: 7); }", "0,0 10x10 | 7,0 10x10"},
        // a filling view ends where the room ends, whatever its offset
        layoutCase{"Pane(width: 50) { Box(horizontal: align_fill, left_offset: 8); }", "0,0 50x10 | 8,0 42x10"},
        // the free height goes in equal parts to the filling and the centred one; the third pixel is nobody's
        layoutCase{"Pane(height: 41) { Box(); Box(vertical: align_fill); Box(vertical: align_center); }",
                   "0,0 10x41 | 0,0 10x10 | 0,10 10x15 | 0,27 10x10"},
        layoutCase{
            "Pane(height: 40) { Box(vertical: align_proportional, top_offset: -2); Box(vertical: align_bottom); }",
            "0,0 10x40 | 0,8 10x10 | 0,30 10x10"},
        layoutCase{"Pane(height: 60) { Box(vertical: align_fill, max_height: 15); Box(vertical: align_fill); }",
                   "0,0 10x60 | 0,0 10x15 | 0,30 10x30"},
        // an upper limit cuts the parent, not the children
        layoutCase{"Pane(max_height: 12) { Box(); Box(); }", "0,0 10x12 | 0,0 10x10 | 0,10 10x10"},
        layoutCase{"Pane(height: 30, max_height: 20);", "0,0 0x20"},
        layoutCase{"Pane(reverse: true) { Box(width: 1); Pane(reverse: 1) { Box(width: 2); Box(width: 3); } }",
                   "0,0 3x30 | 0,0 3x20 | 0,0 3x10 | 0,10 2x10 | 1,20 1x10"}));

//  +-----------+   a row: side by side, in the middle down
//  |+--+ +----+|
//  |+--+ |    ||
//  |     +----+|
//  +-----------+
INSTANTIATE_TEST_SUITE_P(
    Row, Geometry,
    testing::Values(
        layoutCase{"Pane(placement: place_row, margin: 1, spacing: 4) { Box(); Box(height: 31); }",
                   "0,0 26x33 | 1,11 10x10 | 15,1 10x31"},
        layoutCase{"Pane(placement: place_row, height: 20, width: 100) { Box(vertical: align_top);"
                   " Box(vertical: align_bottom, horizontal: align_fill); Box(vertical: align_fill, max_height: 12);"
                   " Box(vertical: align_center, horizontal: align_center); }",
                   "0,0 100x20 | 0,0 10x10 | 10,10 40x10 | 50,0 10x12 | 75,5 10x10"},
        layoutCase{"Pane(placement: place_row) { Box(vertical: align_top, top_offset: 6); Box(top_offset: 3); }",
                   "0,0 20x16 | 0,6 10x10 | 10,6 10x10"},
        // nobody takes the free width: it stays at the end, whatever the alignment
        layoutCase{"Pane(placement: place_row, width: 50) { Box(); Box(horizontal: align_right); }",
                   "0,0 50x10 | 0,0 10x10 | 10,0 10x10"}));

//  one on top of the other, as wide as the widest
INSTANTIATE_TEST_SUITE_P(
    Offscreen, Geometry,
    testing::Values(layoutCase{"Pane(placement: place_offscreen, margin: 1) { Box(height: 30); Box(width: 50);"
                               " Box(horizontal: align_left, vertical: align_center); }",
                               "0,0 52x32 | 1,1 50x30 | 1,1 50x10 | 1,11 10x10"},
                    layoutCase{
                        "Pane(placement: place_offscreen, child_horizontal: align_right) { Box(width: 3); Box(); }",
                        "0,0 10x10 | 7,0 3x10 | 0,0 10x10"}));

INSTANTIATE_TEST_SUITE_P(
    WhereValuesComeFrom, Geometry,
    testing::Values(
        // the particular margin wins over the general one, in any order; a cushion is a margin
        layoutCase{"Pane(margin_bottom: 4, margin: 8);", "0,0 16x12"},
        layoutCase{"Pane(margin_width: 3, margin: 8, margin_left: 1);", "0,0 4x16"},
        layoutCase{"Pane(cushion: 8, cushion_x: 2, cushion_bottom: 1);", "0,0 4x9"},
        // head before class before variable; a general property of the head before a particular variable
        layoutCase{"margin = 1; margin_top = 2; Framed() { Framed(margin: 3); Pane(); Pane(margin: 0); }",
                   "0,0 16x19 | 5,5 6x6 | 7,11 2x3 | 8,14 0x0"},
        // what the head says does not reach the views in it; a variable of the body does
        layoutCase{"Pane(margin: 4) { Pane(); spacing = 2; Pane() { Box(); Box(); } }",
                   "0,0 18x30 | 9,4 0x0 | 4,4 10x22 | 0,0 10x10 | 0,12 10x10"},
        layoutCase{
            "gSpace = 3; Pane() { Box(); Pane() { gSpace = 9; Box(); Box(); } Pane(spacing: 1) { Box(); Box(); } }",
            "0,0 10x60 | 0,0 10x10 | 0,13 10x23 | 0,0 10x10 | 0,13 10x10"
            " | 0,39 10x21 | 0,0 10x10 | 0,11 10x10"},
        layoutCase{"Pane(child_horizontal: align_left, width: 30, child_vertical: align_fill, height: 30)"
                   " { Box(); Box(horizontal: align_center, vertical: align_top); }",
                   "0,0 30x30 | 0,0 10x20 | 10,20 10x10"},
        // nonsense is as if it was not there
        layoutCase{"Pane(placement: 9, width: -5, max_height: -1) { Box(horizontal: 77, width: nothing + 1); }",
                   "0,0 10x10 | 0,0 10x10"},
        layoutCase{"Pane(window_size_x: 30, window_size_y: 0) { Box(horizontal: align_right); }",
                   "0,0 30x10 | 20,0 10x10"}));

//  label  [field]     the labels of a column are as wide as the widest; fields keep their width
INSTANTIATE_TEST_SUITE_P(
    Labels, Geometry,
    testing::Values(layoutCase{"Pane(child_horizontal: align_left) { Box(width: 50, label_width: 20);"
                               " Box(width: 50, label_width: 35); Box(); }",
                               "0,0 65x30 | 0,0 65x10 | 0,10 50x10 | 0,20 10x10"},
                    layoutCase{"Pane(placement: place_row) { Box(label_width: 20); Box(label_width: 35); }",
                               "0,0 20x10 | 0,0 10x10 | 10,0 10x10"}));

//  a view reaches over its cell by its outset; what a margin does not cover its parent passes on, as does the first
//  child at the left and top, the last at the bottom, any at the right
INSTANTIATE_TEST_SUITE_P(
    Outsets, Geometry,
    testing::Values(layoutCase{"Pane(margin: 9) { Pane(margin: 3) { Box(outset: 5); Box(right_outset: 7); } }",
                               "0,0 34x44 | 7,7 22x28 | 0,0 20x20 | 5,15 17x10"},
                    layoutCase{"Pane(margin: 9, placement: place_row) { Box(width_outset: 2, outset: 1);"
                               " Box(outset_left: 3, bottom_outset: 4); }",
                               "0,0 38x28 | 7,8 14x12 | 16,9 13x14"}));

TEST(ViewGeometry, UnknownClassesTakeTheirPlaceButAreNotMade)
{
    const layoutBench bench;
    const auto window = bench.Build("Pane() { Box(); Nobody(height: 7) { Box(view_id: 'lost'); } Box(view_id: 'b',"
                                    " frame_interior: kInterior_FrameInsertRight, label_width: 3); }");
    ASSERT_EQ(window->children.size(), 2u);
    EXPECT_EQ(window->Find("b")->placement.frame, (CRect{0, 20, 10, 30}));
    EXPECT_EQ(window->Find("b")->placement.labelWidth, 3);
    EXPECT_EQ(window->interiors, (std::vector<std::int32_t>{0, 4}));
    EXPECT_EQ(window->Find("lost"), nullptr);
}

/// A layout of random shape. `tame`: only what keeps children within their parents and apart from each other.
class randomLayout
{
public:
    randomLayout(unsigned seed, bool onlyTame) : random(seed), tame(onlyTame) {}

    std::string Text() { return "gSpace = " + Number(0, 9) + "; " + View(0); }

private:
    int Pick(int from, int to) { return std::uniform_int_distribution<>(from, to)(random); }
    std::string Number(int from, int to) { return std::to_string(Pick(from, to)); }

    std::string Property()
    {
        static const char *const sizes[] = {"width",        "height",     "margin",        "margin_left",
                                            "margin_width", "margin_top", "margin_bottom", "spacing"};
        static const char *const choices[] = {"horizontal", "vertical", "child_horizontal", "child_vertical"};
        static const char *const wild[] = {"max_height",  "left_offset", "top_offset",    "outset",
                                           "left_outset", "label_width", "window_size_x", "cushion"};
        switch (Pick(0, tame ? 3 : 4))
        {
        case 0:
            return std::string(choices[Pick(0, 3)]) + ": " + Number(0, 6);
        case 1:
            return "placement: " + Number(0, 2);
        case 2:
            return Pick(0, 1) != 0 ? "reverse: true" : "label_width: " + Number(0, 40);
        case 3:
            return std::string(sizes[Pick(0, 7)]) + ": " + Number(0, 60);
        default:
        {
            static const char *const values[] = {"-7",      "13",    "2147483647", "-2147483647 - 1",
                                                 "nothing", "1 / 0", "'abcd'"};
            const char *const value = values[Pick(0, 6)];
            return std::string(Pick(0, 1) != 0 ? wild[Pick(0, 7)] : sizes[Pick(0, 7)]) + ": " +
                   (std::string(value) == "nothing" ? "(nothing)" : value);
        }
        }
    }

    std::string View(int depth)
    {
        std::string head;
        for (int i = Pick(0, 4); i > 0; --i)
            head += (head.empty() ? "" : ", ") + Property();
        std::string body;
        for (int i = depth < 5 ? Pick(0, depth == 0 ? 6 : 3) : 0; i > 0; --i)
            body += View(depth + 1);
        static const char *const classes[] = {"Pane", "Box", "Framed", "Text"};
        return classes[Pick(0, 3)] + ("(" + head + ") {") + body + "}";
    }

    std::mt19937 random;
    bool tame;
};

void expectInside(const noteView &view, const std::string &text)
{
    const CRect bounds{0, 0, static_cast<std::int32_t>(view.placement.frame.Width()),
                       static_cast<std::int32_t>(view.placement.frame.Height())};
    for (const auto &child : view.children)
    {
        const CRect &frame = child->placement.frame;
        ASSERT_TRUE(bounds.Contains(frame)) << text;
        ASSERT_TRUE(frame.right >= frame.left && frame.bottom >= frame.top) << text;
        ASSERT_NO_FATAL_FAILURE(expectInside(*child, text));
    }
}

TEST(ViewGeometry, TwentyThousandRandomLayouts)
{
    const layoutBench bench;
    for (unsigned seed = 0; seed < 20'000; ++seed)
    {
        const bool tame = seed % 2 == 0;
        const std::string text = randomLayout(seed, tame).Text();
        const auto window = bench.Build(text);
        if (tame)
        {
            ASSERT_NO_FATAL_FAILURE(expectInside(*window, text));
        }
    }
}

} // namespace
} // namespace Sarnik
