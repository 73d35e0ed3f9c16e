#pragma once

#include <atomic>

/// Ctrl-C and its kin (SIGINT, SIGTERM, SIGHUP) as a flag.
namespace Stillmark::stopSignal
{

/// From now on the first signal raises the flag. If the program has not ended 0.8 s later, or when a second signal
/// comes, it ends at once with status 1 and without its temporary files. Also lets writing past a file size limit or
/// into a closed pipe fail with an error in place of a signal. Call once, before any thread is started.
void install();

/// True since the first signal.
const std::atomic<bool> &requested();

/// Throws Platform::cancelled after a signal.
void check();

/// Tells on the standard error that the run was cancelled, once, whoever asks first. Async-signal-safe.
void sayCancelled() noexcept;

} // namespace Stillmark::stopSignal
