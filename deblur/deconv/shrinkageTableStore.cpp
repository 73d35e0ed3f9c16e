#include "deblur/deconv/shrinkageTableStore.h"

#include "deblur/deconv/splittingRounds.h"
#include "platform/files.h"

#include <bit>
#include <cassert>
#include <cmath>
#include <cstdint>
#include <cstring>
#include <utility>

namespace CorvaneDeblur
{
namespace
{

using sharedTable = std::shared_ptr<const shrinkageTable>;

constexpr std::size_t fileBytes = shrinkageTableEntries * sizeof(float);
constexpr int family = 1; // of exponent 2/3, in the names of the files
static_assert(std::endian::native == std::endian::little, "scratch files hold samples as they lie in memory");

/// The table that a scratch file holds; null if there is none, or one of the wrong length or with values that are no
/// numbers.
sharedTable readTable(const std::string &path)
{
    try
    {
        const std::vector<std::uint8_t> bytes = Platform::readWholeFile(path, fileBytes);
        if (bytes.size() != fileBytes)
            return nullptr;
        shrinkageTable table(shrinkageTableEntries);
        std::memcpy(table.data(), bytes.data(), fileBytes);
        for (const float w : table)
            if (!std::isfinite(w))
                return nullptr;
        return std::make_shared<const shrinkageTable>(std::move(table));
    }
    catch (const Platform::fileError &)
    {
        return nullptr;
    }
}

/// A failure costs building the table again at the next start, no more.
void writeTable(const std::string &path, const shrinkageTable &table)
{
    try
    {
        Platform::atomicFile file(path);
        file.write(table.data(), fileBytes);
        file.commit();
    }
    catch (const Platform::fileError &)
    {
    }
}

sharedTable loadShrinkageTable(const std::string &directory, float beta, float alpha, int round)
{
    if (directory.empty())
        return std::make_shared<const shrinkageTable>(buildShrinkageTable(beta, alpha));
    const std::string path = directory + "/" + std::to_string(round) + "_" + std::to_string(family) + ".tmp";
    if (sharedTable table = readTable(path))
        return table;
    sharedTable table = std::make_shared<const shrinkageTable>(buildShrinkageTable(beta, alpha));
    writeTable(path, *table);
    return table;
}

/// -1, 0 or 1; numbers closer than 2^-23 are equal.
int compare(float a, float b)
{
    if (std::fabs(a - b) < 1.1920929e-07f)
        return 0;
    return a < b ? -1 : 1;
}

} // namespace

shrinkageTableStore::shrinkageTableStore(std::string scratchDirectory) : directory(std::move(scratchDirectory))
{
    const std::vector<float> betas = splittingBetas();
    assert(betas.size() == family23.size());
    for (std::size_t round = 0; round < family23.size(); ++round)
    {
        family23[round] = loadShrinkageTable(directory, betas[round], priorExponent, static_cast<int>(round));
        byKey.emplace(std::pair(priorExponent, betas[round]), family23[round]);
    }
}

const shrinkageTable &shrinkageTableStore::prepared(int round) const
{
    return *family23.at(static_cast<std::size_t>(round));
}

std::shared_ptr<const shrinkageTable> shrinkageTableStore::findTable(float alpha, float beta)
{
    const std::lock_guard guard(lock);
    sharedTable &table = byKey[{alpha, beta}];
    if (!table)
        table = std::make_shared<const shrinkageTable>(buildShrinkageTable(beta, alpha));
    return table;
}

bool shrinkageTableStore::keyLess::operator()(const std::pair<float, float> &a, const std::pair<float, float> &b) const
{
    const int alpha = compare(a.first, b.first);
    return alpha != 0 ? alpha < 0 : compare(a.second, b.second) < 0;
}

} // namespace CorvaneDeblur
