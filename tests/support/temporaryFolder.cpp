#include "tests/support/temporaryFolder.h"

#include <algorithm>
#include <cstdlib>
#include <fstream>
#include <iterator>
#include <stdexcept>

namespace TestSupport
{

temporaryFolder::temporaryFolder()
{
    std::string pattern = (std::filesystem::temp_directory_path() / "stillmark-test-XXXXXX").string();
    if (!::mkdtemp(pattern.data()))
        throw std::runtime_error("no temporary folder");
    folder = pattern;
}

temporaryFolder::~temporaryFolder()
{
    std::error_code ignored;
    std::filesystem::remove_all(folder, ignored);
}

std::vector<std::string> temporaryFolder::names() const
{
    std::vector<std::string> list;
    for (const auto &entry : std::filesystem::directory_iterator(folder))
        list.push_back(entry.path().filename().string());
    std::sort(list.begin(), list.end());
    return list;
}

std::string bytesOf(const std::string &path)
{
    std::ifstream file(path, std::ios::binary);
    return {std::istreambuf_iterator<char>(file), {}};
}

void writeBytes(const std::string &path, const std::string &bytes)
{
    std::ofstream(path, std::ios::binary) << bytes;
}

} // namespace TestSupport
