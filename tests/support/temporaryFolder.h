#pragma once

#include <filesystem>
#include <string>
#include <vector>

namespace TestSupport
{

/// A folder of its own for a test, removed with it.
class temporaryFolder
{
public:
    temporaryFolder();
    temporaryFolder(const temporaryFolder &) = delete;
    temporaryFolder &operator=(const temporaryFolder &) = delete;
    ~temporaryFolder();

    const std::filesystem::path &path() const { return folder; }
    std::string file(const std::string &name) const { return (folder / name).string(); }
    std::vector<std::string> names() const; ///< of all that is in it, hidden or not, sorted

private:
    std::filesystem::path folder;
};

std::string bytesOf(const std::string &path);
void writeBytes(const std::string &path, const std::string &bytes);

} // namespace TestSupport
