#include "cli/stopSignal.h"

#include "platform/error.h"
#include "platform/files.h"

#include <semaphore.h>
#include <signal.h>
#include <time.h>
#include <unistd.h>

#include <cerrno>
#include <string_view>
#include <thread>

namespace Stillmark::stopSignal
{
namespace
{

std::atomic<bool> stop = false, said = false;
static_assert(std::atomic<bool>::is_always_lock_free, "a signal handler may only touch lock-free atomics");
sem_t firstSignal;

/// The last way out: no destructors run, so what is on disk is tidied by hand.
[[noreturn]] void endNow()
{
    Platform::removePendingTemporaries();
    sayCancelled();
    _exit(1);
}

extern "C" void onSignal(int)
{
    const int before = errno;
    if (stop.exchange(true))
        endNow();
    sem_post(&firstSignal);
    errno = before;
}

/// Most work stops within milliseconds. This thread keeps the promise of a second for the rest, such as a library call
/// that cannot be interrupted.
void endLateStops()
{
    while (sem_wait(&firstSignal) != 0)
        continue;
    timespec left{0, 800'000'000};
    while (nanosleep(&left, &left) != 0)
        continue;
    endNow();
}

} // namespace

void install()
{
    sem_init(&firstSignal, 0, 0);
    struct sigaction action = {};
    sigemptyset(&action.sa_mask);

    // The thread that waits takes no signals itself: a handler there would interrupt nothing of use.
    sigset_t all, before;
    sigfillset(&all);
    pthread_sigmask(SIG_SETMASK, &all, &before);
    std::thread(endLateStops).detach();
    pthread_sigmask(SIG_SETMASK, &before, nullptr);

    action.sa_handler = SIG_IGN;
    sigaction(SIGXFSZ, &action, nullptr);
    sigaction(SIGPIPE, &action, nullptr);

    action.sa_handler = onSignal;
    action.sa_flags = SA_RESTART;
    for (const int number : {SIGINT, SIGTERM, SIGHUP})
    {
        struct sigaction old = {};
        sigaction(number, nullptr, &old);
        if (old.sa_handler != SIG_IGN) // started by nohup or in the background of a script
            sigaction(number, &action, nullptr);
    }
}

const std::atomic<bool> &requested()
{
    return stop;
}

void check()
{
    if (stop)
        throw Platform::cancelled();
}

void sayCancelled() noexcept
{
    if (said.exchange(true))
        return;
    constexpr std::string_view onTerminal = "\r\x1b[KCancelled.\n", elsewhere = "Cancelled.\n"; // clears the bar
    const std::string_view words = isatty(STDERR_FILENO) ? onTerminal : elsewhere;
    [[maybe_unused]] const auto written = write(STDERR_FILENO, words.data(), words.size());
}

} // namespace Stillmark::stopSignal
