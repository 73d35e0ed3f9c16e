// stillmark_pack_icons LIST PICTURES OUT: packs the icons that LIST names (resources/icons/icons.txt), rendered into
// PICTURES/low and PICTURES/high, into the index and the stores of docs/files/icons.md. A part of the build.

#include "framework/base/exceptions.h"
#include "framework/icons/iconPacker.h"
#include "platform/files.h"

#include <cstdio>
#include <fstream>
#include <sstream>
#include <string>

namespace
{

using Sarnik::CError;
using Sarnik::CIconPacker;

/// Far above any icon.
constexpr std::size_t largestFile = 1 << 20;

std::vector<std::byte> contentOf(const std::string &path)
{
    const auto bytes = Platform::readWholeFile(path, largestFile);
    const auto content = std::as_bytes(std::span(bytes));
    return {content.begin(), content.end()};
}

void write(const std::string &path, std::span<const std::byte> bytes)
{
    Platform::atomicFile file(path);
    file.write(bytes.data(), bytes.size());
    file.commit();
}

/// name, state, picture, width, height, hot spot's x and y.
void addRow(CIconPacker &packer, const std::string &row, const std::string &pictures)
{
    CIconPacker::picture icon;
    std::string file, more;
    std::istringstream columns(row);
    if (!(columns >> icon.name >> icon.state >> file >> icon.width >> icon.height >> icon.hotX >> icon.hotY) ||
        columns >> more)
        throw CError("a row has seven columns: " + row);
    icon.png[0] = contentOf(pictures + "/low/" + file + ".png");
    icon.png[1] = contentOf(pictures + "/high/" + file + ".png");
    packer.Add(icon);
}

void pack(const std::string &list, const std::string &pictures, const std::string &folder)
{
    std::ifstream in(list);
    CIconPacker packer;
    for (std::string row; std::getline(in, row);)
        if (!row.empty() && row.front() != '#')
            addRow(packer, row, pictures);
    if (!in.eof())
        throw CError(list + ": cannot be read");

    write(folder + "/IconResources.idx", packer.Index());
    write(folder + "/IconsLowRes.dat", packer.Store(Sarnik::kIconResolution_Low));
    write(folder + "/IconsHighRes.dat", packer.Store(Sarnik::kIconResolution_High));
}

} // namespace

int main(int argc, char **argv)
try
{
    if (argc != 4)
        throw CError("usage: stillmark_pack_icons LIST PICTURES OUT");
    pack(argv[1], argv[2], argv[3]);
    return 0;
}
catch (const CError &e)
{
    std::fprintf(stderr, "stillmark_pack_icons: %s\n", e.ErrorText().c_str());
    return 1;
}
catch (const std::exception &e)
{
    std::fprintf(stderr, "stillmark_pack_icons: %s\n", e.what());
    return 1;
}
