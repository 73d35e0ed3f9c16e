#include "store/behavioralParameters.h"

#include "store/channelList.h"
#include "store/params.h"
#include "store/scanNumber.h"

#include <algorithm>
#include <array>
#include <filesystem>
#include <fstream>
#include <string_view>

namespace Project
{

namespace
{

/// A line never has more characters than this, its end included.
constexpr std::size_t kLongestLine = 255;

std::filesystem::path FileIn(const std::string &directory)
{
    return std::filesystem::path(directory) / "Corvane Stillmark Behavioral Parameters";
}

char Lower(char c)
{
    return c >= 'A' && c <= 'Z' ? static_cast<char>(c - 'A' + 'a') : c;
}

bool EqualIgnoringCase(std::string_view a, std::string_view b)
{
    return std::equal(a.begin(), a.end(), b.begin(), b.end(), [](char x, char y) { return Lower(x) == Lower(y); });
}

void SetPyramidSmooth(std::string_view value, PParams &parameters)
{
    // The misspelling is the file's own: existing files hold it.
    static constexpr std::array<std::string_view, 3> names = {"None", "Guassian", "Bilateral"};
    for (std::size_t i = 0; i < names.size(); ++i)
        if (EqualIgnoringCase(value, names[i]))
            parameters.pyramidSmooth = static_cast<std::uint32_t>(i);
}

struct key
{
    std::string_view name;
    std::size_t limit; ///< what follows the name, the line's end included, is shorter than this
    void (*apply)(std::string_view value, PParams &parameters);
};

constexpr std::array<key, 5> kKeys = {{
    {"ui.show_behavioral=", 11, [](std::string_view value, PParams &p) { p.behaviorMenus = value == "true"; }},
    {"ui.output_log=", 11, [](std::string_view value, PParams &p) { p.outputLog = value == "true"; }},
    {"ui.preview_cap=", 11,
     [](std::string_view value, PParams &p) { p.previewCap = ScanNumber(value).value_or(p.previewCap); }},
    {"estimate.pyramid_smooth=", 21, SetPyramidSmooth},
    {"deconv.channels=", 11,
     [](std::string_view value, PParams &p) { ParseChannels(std::string(value), p.deconvChannels); }},
}};

/// The first word of text: from the first character that is no blank to the next blank.
std::string_view FirstWord(std::string_view text)
{
    text.remove_prefix(std::min(text.find_first_not_of(kBlanks), text.size()));
    return text.substr(0, text.find_first_of(kBlanks));
}

void ApplyLine(std::string_view line, PParams &parameters)
{
    line = line.substr(0, line.find('\0')); // text ends there
    for (const key &k : kKeys)
        if (line.substr(0, k.name.size()) == k.name && line.size() - k.name.size() < k.limit)
            k.apply(FirstWord(line.substr(k.name.size())), parameters);
}

} // namespace

bool BehavioralParametersExist(const std::string &directory)
{
    std::error_code ignored;
    return std::filesystem::is_regular_file(FileIn(directory), ignored);
}

void ReadBehavioralParameters(const std::string &directory, PParams &parameters)
{
    if (!BehavioralParametersExist(directory)) // a folder or a pipe of that name is no such file
        return;
    std::ifstream file(FileIn(directory), std::ios::binary);
    ReadBehavioralParameters(file, parameters);
}

void ReadBehavioralParameters(std::istream &lines, PParams &parameters)
{
    std::string line;
    for (char c = 0; lines.get(c);)
    {
        line += c;
        const bool ended = c == '\n' || c == '\r';
        if (ended)
            ApplyLine(line, parameters);
        if (ended || line.size() == kLongestLine) // an endless line is dropped in pieces, its rest counts as a line
            line.clear();
    }
    ApplyLine(line, parameters);
}

} // namespace Project
