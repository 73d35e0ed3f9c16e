#pragma once

#include <stdexcept>
#include <string>

namespace Platform
{

/// A file that cannot be read or written. what() is one line that names the file and the cause in plain words, ready
/// to be shown: "out.jpg: cannot be written: No space left on device".
class fileError : public std::runtime_error
{
public:
    using std::runtime_error::runtime_error;
};

/// Thrown by long operations whose caller asked them to stop. Nothing has been changed on disk.
class cancelled : public std::runtime_error
{
public:
    cancelled() : std::runtime_error("cancelled") {}
};

} // namespace Platform
