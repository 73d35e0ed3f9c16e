#include "deblur/deconv/fastSize.h"

#include <algorithm>
#include <array>
#include <cstdint>
#include <limits>
#include <vector>

namespace CorvaneDeblur
{
namespace
{

/// Lengths that the transform library has fast codelets for.
constexpr std::array<int, 6> smallPrimes = {2, 3, 5, 7, 11, 13};
constexpr int tableSize = 10000;

bool hasOnlySmallPrimes(int n)
{
    for (const int prime : smallPrimes)
        while (n % prime == 0)
            n /= prime;
    return n == 1;
}

/// Entry n - 1: the smallest product below tableSize that is not less than n; 0 above the largest one.
std::vector<int> buildTable()
{
    std::vector<int> table(tableSize, 0);
    int above = 0;
    for (int n = tableSize; n >= 1; --n)
    {
        if (n < tableSize && hasOnlySmallPrimes(n))
            above = n;
        table[static_cast<std::size_t>(n - 1)] = above;
    }
    return table;
}

/// Lowers `best` to the smallest product > n that extends `product` by primes from number `first` on.
void searchAbove(std::int64_t n, std::int64_t product, std::size_t first, std::int64_t &best)
{
    if (product > n)
    {
        best = std::min(best, product);
        return;
    }
    for (std::size_t i = first; i < smallPrimes.size() && product * smallPrimes[i] < best; ++i)
        searchAbove(n, product * smallPrimes[i], i, best);
}

} // namespace

int fastSize(int n)
{
    static const std::vector<int> table = buildTable();
    n = std::max(n, 1);
    if (n <= tableSize && table[static_cast<std::size_t>(n - 1)] != 0)
        return table[static_cast<std::size_t>(n - 1)];
    std::int64_t best = std::numeric_limits<int>::max();
    searchAbove(n, 1, 0, best);
    return static_cast<int>(best);
}

} // namespace CorvaneDeblur
