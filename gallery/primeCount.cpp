#include "gallery/primeCount.h"

#include "framework/views/application.h"

namespace Stillmark
{
namespace
{

/// So that an event waits no longer; seconds.
constexpr double slice = 0.008;

bool isPrime(int n)
{
    for (int d = 2; d * d <= n; ++d)
        if (n % d == 0)
            return false;
    return true;
}

} // namespace

void primeCount::Start()
{
    next = 2;
    primes = 0;
}

bool primeCount::Idle()
{
    if (!IsRunning())
        return false;
    // A display without a clock of its own stands still meanwhile: slices are short by number too.
    const double end = Sarnik::CApplication::Now() + slice;
    for (int i = 0; i < 20'000 && IsRunning() && Sarnik::CApplication::Now() < end; ++i)
        primes += isPrime(next++) ? 1 : 0;
    tell(next, primes);
    return IsRunning();
}

} // namespace Stillmark
