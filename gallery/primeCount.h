#pragma once

#include "framework/views/idler.h"

#include <functional>
#include <utility>

namespace Stillmark
{

/// Counts the primes below a limit by trial divisions, while the message loop has nothing else to do.
class primeCount final : public Sarnik::CIdler
{
public:
    static constexpr int limit = 400'000;

    /// Told after each slice: numbers that were tried, and primes among them.
    explicit primeCount(std::function<void(int tried, int primes)> toTell) : tell(std::move(toTell)) {}

    void Start();
    bool IsRunning() const { return next < limit; }

private:
    bool Idle() override;

    std::function<void(int, int)> tell;
    int next = limit, primes = 0;
};

} // namespace Stillmark
