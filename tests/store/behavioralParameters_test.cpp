#include "store/behavioralParameters.h"

#include "store/params.h"
#include "tests/store/storeFixture.h"

#include <gmock/gmock.h>
#include <memory>

namespace Project
{

namespace
{

using ::testing::ElementsAre;

class behavioralParametersTest : public storeTest
{
protected:
    /// What a file of this text makes of a fresh record.
    std::unique_ptr<PParams> Reading(std::string_view text) const
    {
        Put("Corvane Stillmark Behavioral Parameters", text);
        auto parameters = std::make_unique<PParams>();
        ReadBehavioralParameters(directory, *parameters);
        return parameters;
    }
};

TEST_F(behavioralParametersTest, SetsEveryKeyWhateverTheLinesEnd)
{
    for (const std::string end : {"\n", "\r", "\r\n"})
    {
        const auto p = Reading("ui.show_behavioral=true" + end + "ui.output_log=true" + end + "ui.preview_cap=800" +
                               end + "estimate.pyramid_smooth=bILATERAL" + end + "deconv.channels=1,3");
        EXPECT_TRUE(p->behaviorMenus);
        EXPECT_TRUE(p->outputLog);
        EXPECT_EQ(p->previewCap, 800);
        EXPECT_EQ(p->pyramidSmooth, 2u);
        EXPECT_THAT(p->deconvChannels, ElementsAre(0u, 2u));
    }
}

TEST_F(behavioralParametersTest, ExistsOnlyAsAFile)
{
    EXPECT_FALSE(BehavioralParametersExist(directory));
    EXPECT_FALSE(BehavioralParametersExist(directory + "/none"));
    Reading("");
    EXPECT_TRUE(BehavioralParametersExist(directory));

    std::filesystem::remove(directory + "/Corvane Stillmark Behavioral Parameters");
    std::filesystem::create_directory(directory + "/Corvane Stillmark Behavioral Parameters");
    EXPECT_FALSE(BehavioralParametersExist(directory));
    PParams parameters;
    ReadBehavioralParameters(directory, parameters);
    EXPECT_EQ(parameters.previewCap, 1250);
}

TEST_F(behavioralParametersTest, TakesFlagsLiterally)
{
    // The flag starts set, so that it shows which lines clear it.
    for (const auto &[value, expected] : {std::pair{"TRUE", false},
                                          {"tru", false},
                                          {"true1", false},
                                          {"", false},
                                          {"true", true},
                                          {"  true", true},
                                          {"true x", true}})
        EXPECT_EQ(Reading(std::string("ui.output_log=true\nui.output_log=") + value + "\n")->outputLog, expected)
            << value;
    EXPECT_TRUE(Reading("ui.output_log=true\n ui.output_log=false\n")->outputLog); // a blank before the key
    EXPECT_TRUE(Reading("ui.output_log=true\nUI.output_log=false\n")->outputLog);
    EXPECT_TRUE(Reading("ui.output_log=true\nui.output_log =false\n")->outputLog);
}

TEST_F(behavioralParametersTest, ScansNumbersAsFarAsTheyGo)
{
    for (const auto &[value, expected] : {std::pair{"12abc", 12},
                                          {"-5", -5},
                                          {"+7", 7},
                                          {"", 1250},
                                          {"abc", 1250},
                                          {"-", 1250},
                                          {"9999999999", INT32_MAX},
                                          {"0x10", 0},
                                          {"3.9", 3}})
        EXPECT_EQ(Reading(std::string("ui.preview_cap=") + value)->previewCap, expected) << value;
}

TEST_F(behavioralParametersTest, KeepsToItsOwnSpellingOfSmoothings)
{
    for (const auto &[value, expected] :
         {std::pair{"None", 0u}, {"none", 0u}, {"Guassian", 1u}, {"Gaussian", 0u}, {"Bilateral", 2u}, {"Bilat", 0u}})
        EXPECT_EQ(Reading(std::string("estimate.pyramid_smooth=None\nestimate.pyramid_smooth=") + value)->pyramidSmooth,
                  expected)
            << value;
}

TEST_F(behavioralParametersTest, LeavesTheChannelsUnlessEveryElementIsANumber)
{
    for (const char *refused : {"", ",", "1,", "1,,2", "a", "1,a", "1, 2"}) // the last is cut at its blank
        EXPECT_THAT(Reading(std::string("deconv.channels=") + refused)->deconvChannels, ElementsAre(0u, 1u, 2u))
            << refused;
    EXPECT_THAT(Reading("deconv.channels=2")->deconvChannels, ElementsAre(1u));
    EXPECT_THAT(Reading("deconv.channels=3,1,1x")->deconvChannels, ElementsAre(2u, 0u, 0u));
}

TEST_F(behavioralParametersTest, PassesOverLinesTooLongForTheirKey)
{
    // The limit counts the line's end, so the last line of a file may have one character more.
    EXPECT_EQ(Reading("ui.preview_cap=123456789\n")->previewCap, 123456789);
    EXPECT_EQ(Reading("ui.preview_cap=1234567890\n")->previewCap, 1250);
    EXPECT_EQ(Reading("ui.preview_cap=1234567890")->previewCap, 1234567890);
    EXPECT_EQ(Reading("estimate.pyramid_smooth=None" + std::string(15, ' ') + "\n")->pyramidSmooth, 0u);
    EXPECT_EQ(Reading("estimate.pyramid_smooth=None" + std::string(16, ' ') + "\n")->pyramidSmooth, 1u);
    EXPECT_EQ(Reading(std::string("ui.preview_cap=7\0garbage beyond\n", 32))->previewCap, 7);
}

TEST_F(behavioralParametersTest, CutsEndlessLinesAfter255Characters)
{
    // What follows the 255th character is a line of its own.
    EXPECT_EQ(Reading(std::string(255, 'x') + "ui.preview_cap=7\n")->previewCap, 7);
    EXPECT_EQ(Reading(std::string(254, 'x') + "ui.preview_cap=7\n")->previewCap, 1250);
    EXPECT_EQ(Reading(std::string(254, 'x') + "\nui.preview_cap=7\n")->previewCap, 7);
    EXPECT_EQ(Reading(std::string(3 * 255, 'x') + "ui.preview_cap=7\n")->previewCap, 7);
}

} // namespace

} // namespace Project
