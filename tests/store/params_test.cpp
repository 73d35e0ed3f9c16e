#include "store/params.h"

#include "store/dialogRules.h"

#include <functional>
#include <gmock/gmock.h>
#include <set>

namespace Project
{

namespace
{

using ::testing::ElementsAre;

/// A record in which every field differs from a fresh one.
void ChangeAll(PParams &p)
{
    p.version = 7;
    p.showPreview = p.showRegions = p.fineResult = p.accuratePreview = false;
    p.lastFolder = "folder";
    p.lastWorkspaceName = "workspace";
    p.lastTraceName = "trace";
    p.lastTraceExtension = ".png";
    p.defaultSettings.size = 99;
    p.overflowColour = 0xFF00FF00;
    p.autoTraceCount = 3;
    p.advancedOpen = p.previewWindowOpen = p.behaviorMenus = p.outputLog = true;
    p.pyramidSmooth = 2;
    p.smoothParameter1 = 4.0f;
    p.smoothParameter2 = 5.0f;
    p.predictorDenoise = 1;
    p.pyramidLevel = 6;
    p.deconvChannels = {1};
    p.tileSize = 128;
    p.derivativesType = 1;
    p.deconvType = 1;
    p.randomKernelLevel = 2;
    p.previewCap = 640;
}

/// The names of the fields in which two records differ.
std::set<std::string> Differences(const PParams &a, const PParams &b)
{
    std::set<std::string> names;
    const auto compare = [&](const char *name, auto PParams::*field) {
        if (!(a.*field == b.*field))
            names.insert(name);
    };
    compare("version", &PParams::version);
    compare("showPreview", &PParams::showPreview);
    compare("showRegions", &PParams::showRegions);
    compare("fineResult", &PParams::fineResult);
    compare("lastFolder", &PParams::lastFolder);
    compare("lastWorkspaceName", &PParams::lastWorkspaceName);
    compare("lastTraceName", &PParams::lastTraceName);
    compare("lastTraceExtension", &PParams::lastTraceExtension);
    compare("defaultSettings", &PParams::defaultSettings);
    compare("overflowColour", &PParams::overflowColour);
    compare("autoTraceCount", &PParams::autoTraceCount);
    compare("advancedOpen", &PParams::advancedOpen);
    compare("previewWindowOpen", &PParams::previewWindowOpen);
    compare("accuratePreview", &PParams::accuratePreview);
    compare("behaviorMenus", &PParams::behaviorMenus);
    compare("outputLog", &PParams::outputLog);
    compare("pyramidSmooth", &PParams::pyramidSmooth);
    compare("smoothParameter1", &PParams::smoothParameter1);
    compare("smoothParameter2", &PParams::smoothParameter2);
    compare("predictorDenoise", &PParams::predictorDenoise);
    compare("pyramidLevel", &PParams::pyramidLevel);
    compare("deconvChannels", &PParams::deconvChannels);
    compare("tileSize", &PParams::tileSize);
    compare("derivativesType", &PParams::derivativesType);
    compare("deconvType", &PParams::deconvType);
    compare("randomKernelLevel", &PParams::randomKernelLevel);
    compare("previewCap", &PParams::previewCap);
    return names;
}

using names = std::set<std::string>;

TEST(Params, CopiesTakeWhatEachIsMeantToTake)
{
    const PParams fresh(4);
    PParams changed(4);
    ChangeAll(changed);
    ASSERT_EQ(Differences(fresh, changed).size(), 27u);

    PParams selected(4);
    CopySelected(selected, changed);
    EXPECT_EQ(Differences(selected, fresh),
              (names{"showPreview", "showRegions", "accuratePreview", "lastFolder", "tileSize", "derivativesType",
                     "overflowColour", "autoTraceCount", "advancedOpen", "fineResult", "previewWindowOpen"}));

    const PParams copy(changed);
    EXPECT_EQ(
        Differences(copy, changed),
        (names{"defaultSettings", "behaviorMenus", "outputLog", "pyramidSmooth", "smoothParameter1", "smoothParameter2",
               "predictorDenoise", "pyramidLevel", "deconvChannels", "tileSize", "derivativesType", "deconvType"}));
    EXPECT_THAT(copy.deconvChannels, ElementsAre(0u, 1u, 2u, 3u));
}

TEST(Params, ZeroTilesAre512AtTheHub)
{
    PParams p;
    EXPECT_EQ(p.HubTileSize(), 512u);
    p.tileSize = 0;
    EXPECT_EQ(p.HubTileSize(), 512u);
    p.tileSize = 64;
    EXPECT_EQ(p.HubTileSize(), 64u);
}

TEST(KernelSettings, MaskBitsCopyTheirFieldAlone)
{
    KernelSettings from;
    from.mode = 1, from.size = 2, from.estimatorOptions = 3, from.estimatorTuningA = 4, from.estimatorTuningB = 5;
    from.threadWeight = 6, from.threadFlag = false, from.forcedApply = true, from.deconvFlagA = false;
    from.deconvFlagB = true, from.deconvWeight = 7, from.smoothing = 8, from.suppression = 9;
    from.deconvIterations = 10, from.noiseLevel = 0, from.maskThreshold = 11, from.anchorX = 12, from.anchorY = 13;

    using restorer = std::function<void(KernelSettings &, const KernelSettings &)>;
    const auto field = [](auto KernelSettings::*member) -> restorer {
        return [member](KernelSettings &to, const KernelSettings &source) { to.*member = source.*member; };
    };
    const std::pair<std::uint32_t, restorer> rows[] = {
        {0x1, field(&KernelSettings::mode)},
        {0x2, field(&KernelSettings::size)},
        {0x4, field(&KernelSettings::estimatorOptions)},
        {0x8, field(&KernelSettings::estimatorTuningA)},
        {0x10, field(&KernelSettings::estimatorTuningB)},
        {0x20, field(&KernelSettings::threadWeight)},
        {0x40, field(&KernelSettings::threadFlag)},
        {0x80, field(&KernelSettings::deconvFlagA)},
        {0x100, field(&KernelSettings::deconvFlagB)},
        {0x200, field(&KernelSettings::deconvWeight)},
        {0x400, field(&KernelSettings::smoothing)},
        {0x800, field(&KernelSettings::suppression)},
        {0x1000, field(&KernelSettings::deconvIterations)},
        {0x2000, field(&KernelSettings::noiseLevel)},
        {0x8000, field(&KernelSettings::maskThreshold)},
        {0x10000, field(&KernelSettings::forcedApply)},
        {0x20000, [](KernelSettings &to,
                     const KernelSettings &source) { to.anchorX = source.anchorX, to.anchorY = source.anchorY; }},
    };
    const KernelSettings fresh;
    std::uint32_t all = 0;
    for (const auto &[bit, restore] : rows)
    {
        all |= bit;
        KernelSettings copied;
        CopySettings(copied, from, bit);
        EXPECT_NE(copied, fresh) << std::hex << bit;
        restore(copied, fresh);
        EXPECT_EQ(copied, fresh) << std::hex << bit;
    }

    KernelSettings whole, nothing;
    CopySettings(whole, from, all);
    EXPECT_EQ(whole, from);
    CopySettings(nothing, from, ~all);
    EXPECT_EQ(nothing, fresh);
}

TEST(KernelSettings, NoisePopupAndLevelsAgree)
{
    for (const auto &[item, level] : {std::pair{1, 3u}, {2, 0u}, {3, 1u}, {4, 2u}})
    {
        EXPECT_EQ(NoiseLevelOfItem(item), level);
        EXPECT_EQ(ItemOfNoiseLevel(level), item);
    }
    for (const int item : {-1, 0, 5, INT32_MAX})
        EXPECT_EQ(NoiseLevelOfItem(item), 3u);
    EXPECT_EQ(ItemOfNoiseLevel(4000000000u), 1);
}

TEST(ExperimentalDialog, RefusedChannelsKeepTheDialogOpenButNotTheRest)
{
    PParams real, edited;
    ChangeAll(edited);
    EXPECT_EQ(AcceptExperimental(edited, "1,x", real), ExperimentalOk::InvalidChannels);
    EXPECT_EQ(Differences(real, PParams()),
              (names{"pyramidSmooth", "smoothParameter1", "smoothParameter2", "predictorDenoise", "pyramidLevel",
                     "tileSize", "derivativesType", "deconvType", "randomKernelLevel"}));
    EXPECT_THAT(edited.deconvChannels, ElementsAre(1u));

    EXPECT_EQ(AcceptExperimental(edited, " 3, 1", real), ExperimentalOk::Closes);
    EXPECT_THAT(real.deconvChannels, ElementsAre(2u, 0u));

    PParams opened;
    FillExperimental(opened, real);
    EXPECT_EQ(AcceptExperimental(opened, "2", real), ExperimentalOk::Closes);
    EXPECT_EQ(real.pyramidLevel, 6);
}

TEST(ExperimentalDialog, ResetHasValuesOfItsOwn)
{
    PParams p;
    ChangeAll(p);
    PParams expected;
    ChangeAll(expected);
    ResetExperimental(p);
    EXPECT_EQ(Differences(p, expected),
              (names{"pyramidSmooth", "smoothParameter1", "smoothParameter2", "predictorDenoise", "pyramidLevel",
                     "tileSize", "deconvType", "randomKernelLevel"}));
    EXPECT_EQ(p.pyramidSmooth, 0u);
    EXPECT_EQ(p.smoothParameter1, 2.0f);
    EXPECT_EQ(p.tileSize, 512u);
    EXPECT_EQ(p.deconvType, 2u);
}

TEST(ExperimentalDialog, PopupItemsCountFromOneAndStayInRange)
{
    EXPECT_EQ(TileSizeOfItem(1), 64u);
    EXPECT_EQ(TileSizeOfItem(5), 1024u);
    EXPECT_EQ(PyramidSmoothOfItem(3), 2u);
    EXPECT_EQ(DeconvTypeOfItem(2), 2u);
    for (const int item : {INT32_MIN, 0, 6, INT32_MAX})
    {
        EXPECT_EQ(TileSizeOfItem(item), 128u);
        EXPECT_EQ(PyramidSmoothOfItem(item), 0u);
        EXPECT_EQ(DerivativesTypeOfItem(item), 0u);
        EXPECT_EQ(DeconvTypeOfItem(item), 1u);
    }
}

TEST(PreferencesDialog, OnlyAChangeMakesThePreviewAnew)
{
    PParams p;
    EXPECT_FALSE(AcceptPreferences(true, p));
    EXPECT_TRUE(AcceptPreferences(false, p));
    EXPECT_FALSE(p.accuratePreview);
}

} // namespace

} // namespace Project
