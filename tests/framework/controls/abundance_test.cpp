#include "framework/controls/fields/editNumber.h"
#include "framework/controls/scrolling/listBox.h"
#include "framework/views/dragDrop.h"
#include "tests/framework/controls/controlStage.h"

#include <chrono>

namespace Sarnik::Test
{
namespace
{

using testing::Gt;
using testing::Le;
using testing::SizeIs;

/// Far more than anybody would bring: it is taken or cut, and the window answers on.
struct abundance : controlStage
{
    struct fileList final : CListBox, CDropTarget
    {
        using CListBox::CListBox;
        bool DragEnter(const CDragData &data, CPoint) override { return !data.files.empty(); }
        void Drop(const CDragData &data, CPoint) override
        {
            ++drops;
            List().SetTexts(data.files);
        }
        int drops = 0;
    };

    /// What is left of a pasted text after it was changed at both ends, and the last change undone.
    template <class Field> std::string Pasted(const std::string &text, std::uint32_t options = 0)
    {
        auto &field = Control<Field>("field", {10, 10, 190, 100});
        field.SetEditOptions(options);
        field.SetFocus();
        display.setClipboard(text);
        display.with(Platform::ctrlModifier).tap(Platform::key::a).tap(Platform::key::v).with(0);
        display.tap(Platform::key::home).type("7").tap(Platform::key::end).tap(Platform::key::backspace);
        Run();
        display.with(Platform::ctrlModifier).tap(Platform::key::z).with(0);
        display.tap(Platform::key::enter);
        Run();
        const std::string left = field.Value();
        pane.Remove(field);
        return left;
    }

    double Seconds(const std::function<void()> &what)
    {
        const auto start = std::chrono::steady_clock::now();
        what();
        return std::chrono::duration<double>(std::chrono::steady_clock::now() - start).count();
    }
};

TEST_F(abundance, AThousandFilesAreDroppedAtOnce)
{
    auto &list = Control<fileList>("files", {10, 10, 190, 110});
    std::vector<std::string> files;
    for (int i = 0; i < 1000; ++i)
        files.push_back("/a/" + std::string(static_cast<std::size_t>(i) * 4, 'x') + std::to_string(i) + ".jpg");
    EXPECT_LT(Seconds([&] {
                  display.drop(50, 50, files);
                  Run();
                  list.List().SetFocus();
                  display.tap(Platform::key::end);
                  Run();
              }),
              20);
    EXPECT_EQ(list.drops, 1);
    EXPECT_EQ(list.List().Count(), 1000);
    EXPECT_EQ(list.List().Current(), 999);
    EXPECT_EQ(list.List().TextOf(999), files.back());
    EXPECT_EQ(list.Position(), list.Largest());
}

TEST_F(abundance, AHundredThousandCharactersArePasted)
{
    std::string line, lines, broken;
    while (line.size() < 100'000)
    {
        line += "word ";
        lines += lines.size() % 7 == 0 ? "\n" : "word \xC3\xA4";
        broken += "\xFF\x01\xC3";
    }
    EXPECT_LT(Seconds([&] {
                  EXPECT_EQ(Pasted<CEditString>(line), line) << "full: nothing more can be typed";
                  EXPECT_EQ(Pasted<CEditString>(line, kEdit_Password), line);
                  EXPECT_THAT(Pasted<CEditString>(lines, kEdit_MultiLine | kEdit_CanScroll), SizeIs(Gt(90'000u)));
                  const std::string mended = Pasted<CEditString>(broken);
                  EXPECT_THAT(mended, SizeIs(Le(CTextEditor::mostBytes)));
                  EXPECT_EQ(mended.find_first_of("\xFF\x01"), std::string::npos);
                  EXPECT_THAT(Pasted<CEditNumber>(std::string(100'000, '9')), SizeIs(Le(20u)));
              }),
              60);
}

} // namespace
} // namespace Sarnik::Test
