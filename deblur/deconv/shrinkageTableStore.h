#pragma once

#include "deblur/deconv/shrinkageTable.h"

#include <array>
#include <map>
#include <memory>
#include <mutex>
#include <string>
#include <vector>

namespace CorvaneDeblur
{

/// The tables of the hyper-Laplacian methods, in memory and in scratch files from one run to the next.
///
/// Construction loads or builds the six tables of exponent 2/3 at beta = 1, 2.83, 8, 22.6, 64, 181. Scratch files are
/// "<directory>/<round>_<family>.tmp", 200,001 little-endian floats without a header; a file of any other length is
/// rebuilt. They are written beside and renamed into place, so several processes may share the directory. An
/// unwritable directory (or an empty name) only costs building the tables again.
class shrinkageTableStore
{
public:
    explicit shrinkageTableStore(std::string directory);

    /// The prepared table of a round (0..5) of exponent family 1 (2/3). Never null; read without a lock.
    const shrinkageTable &prepared(int round) const;

    /// The table for (alpha, beta), built on first use and kept. Any thread; concurrent callers wait for one build.
    /// Keys compare with a tolerance of 2^-23.
    std::shared_ptr<const shrinkageTable> findTable(float alpha, float beta);

private:
    struct keyLess
    {
        bool operator()(const std::pair<float, float> &a, const std::pair<float, float> &b) const;
    };

    std::string directory;
    std::array<std::shared_ptr<const shrinkageTable>, 6> family23;
    std::mutex lock; ///< guards byKey
    std::map<std::pair<float, float>, std::shared_ptr<const shrinkageTable>, keyLess> byKey;
};

} // namespace CorvaneDeblur
