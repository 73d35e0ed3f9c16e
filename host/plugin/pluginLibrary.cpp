#include "host/plugin/pluginLibrary.h"

#include "platform/files.h"

#include <cerrno>
#include <cstring>
#include <dlfcn.h>
#include <elf.h>
#include <filesystem>
#include <fstream>
#include <link.h>
#include <sys/stat.h>
#include <unistd.h>

namespace Stillmark
{
namespace
{

/// The loader's words without the path that they begin with.
std::string loaderReason(const std::string &path)
{
    const char *words = dlerror();
    std::string reason = words ? words : "the system does not tell why";
    if (reason.rfind(path + ": ", 0) == 0)
        reason.erase(0, path.size() + 2);
    return reason;
}

/// The loader maps segments without a look at the file's length, and a library that was cut short crashes it. What is
/// no library of this machine's kind is left for the loader to refuse.
void checkWhole(const std::string &path, std::uint64_t length)
{
    std::ifstream file(path, std::ios::binary);
    ElfW(Ehdr) head;
    if (!file.read(reinterpret_cast<char *>(&head), sizeof head) || std::memcmp(head.e_ident, ELFMAG, SELFMAG) != 0 ||
        head.e_phentsize != sizeof(ElfW(Phdr)))
        return;
    file.seekg(static_cast<std::streamoff>(head.e_phoff));
    for (int i = 0; i < head.e_phnum; i++)
    {
        ElfW(Phdr) segment;
        if (!file.read(reinterpret_cast<char *>(&segment), sizeof segment) || segment.p_offset > length ||
            segment.p_filesz > length - segment.p_offset)
            throw Platform::fileError(path + ": cannot be loaded as a plug-in: the file is cut short");
    }
}

/// The loader says little about files that are missing or are not files at all.
void checkFile(const std::string &path)
{
    struct stat state = {};
    if (stat(path.c_str(), &state) != 0 || access(path.c_str(), R_OK) != 0)
        throw Platform::errnoError(path, "the plug-in cannot be opened", errno);
    if (!S_ISREG(state.st_mode))
        throw Platform::fileError(path + ": is not a plug-in: it is not a file");
    checkWhole(path, static_cast<std::uint64_t>(state.st_size));
}

} // namespace

void pluginLibrary::close::operator()(void *library) const noexcept
{
    dlclose(library);
}

pluginLibrary::pluginLibrary(const std::string &path)
{
    checkFile(path);
    // A name without a slash would be looked for in the system's library folders.
    const std::string whole = std::filesystem::absolute(path).string();
    library.reset(dlopen(whole.c_str(), RTLD_NOW | RTLD_LOCAL));
    if (!library)
        throw Platform::fileError(path + ": cannot be loaded as a plug-in: " + loaderReason(whole));

    void *symbol = dlsym(library.get(), TN_ENTRY_NAME);
    if (!symbol)
        throw Platform::fileError(path + ": is not a filter plug-in: it has no " TN_ENTRY_NAME);
    static_assert(sizeof entryPoint == sizeof symbol);
    std::memcpy(&entryPoint, &symbol, sizeof symbol);
}

} // namespace Stillmark
