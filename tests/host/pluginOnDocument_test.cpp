#include "host/document/hostDocument.h"
#include "host/document/photoSource.h"
#include "host/document/resultRaster.h"
#include "host/plugin/pluginHost.h"
#include "host/plugin/pluginLibrary.h"
#include "tests/host/hostFixture.h"
#include "tests/host/portPluginTasks.h"

namespace Stillmark
{
namespace
{

/// A plug-in that inverts all it is shown and leaves the selection to the host: what is not selected comes back bit for
/// bit, and so does transparency.
class PluginOnDocument : public hostTest
{
};

TEST_F(PluginOnDocument, WritesAPhotoThroughAPluginAndASelection)
{
    const int width = 70, height = 45;
    const photo before =
        photo::open(make({"rgba", ".png", 4, VIPS_FORMAT_UCHAR, VIPS_INTERPRETATION_sRGB}, width, height));
    std::vector<std::uint8_t> selected(static_cast<std::size_t>(width) * height);
    for (std::size_t i = 0; i < selected.size(); i++)
        selected[i] = i % width >= 20 && i % width < 50 ? 255 : 0;
    const selectionMask selection(width, height, selected);

    photoSource source(before);
    resultRaster result(before, file("out.png"));
    documentSettings settings;
    settings.selection = &selection;
    hostDocument document(source, &result, settings);
    const pluginLibrary plugin(STILLMARK_PORT_PLUGIN);
    hostOptions options;
    options.properties[portPluginKey] = taskInvert;
    const hostOutcome outcome = runPlugin(plugin.entry(), document, options);
    ASSERT_TRUE(outcome.done()) << outcome.result;
    EXPECT_TRUE(outcome.wrote);
    EXPECT_TRUE(outcome.leaks.empty() && outcome.misuse.empty());
    result.commit();

    std::vector<std::uint8_t> expected = planesOf(before);
    for (std::size_t i = 0; i < 3 * selected.size(); i++)
        if (selected[i % selected.size()])
            expected[i] = static_cast<std::uint8_t>(255 - expected[i]);
    EXPECT_EQ(planesOf(photo::open(file("out.png"))), expected);
}

} // namespace
} // namespace Stillmark
