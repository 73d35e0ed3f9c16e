#include "framework/base/exceptions.h"

#include "framework/base/localisedString.h"

#include <algorithm>
#include <iterator>
#include <system_error>

namespace Sarnik
{
namespace
{

struct hostMessage
{
    std::int16_t code;
    const char *text;
};

constexpr hostMessage hostMessages[] = {
    {-128, "$$$/Sarnik/TintorelError/userCanceledErr=The operation was canceled."},
    {-111, "$$$/Sarnik/TintorelError/memWZErr=An attempt was made to operate on a free memory block."},
    {-109, "$$$/Sarnik/TintorelError/nilHandleErr=An attempt was made to use a NULL handle."},
    {-108, "$$$/Sarnik/TintorelError/memFullErr=There is not enough memory."},
    {-50, "$$$/Sarnik/TintorelError/paramErr=There is an error in the parameter list."},
    {-46, "$$$/Sarnik/TintorelError/vLckdErr=The disk volume is locked."},
    {-45, "$$$/Sarnik/TintorelError/fLckdErr=The file is locked."},
    {-43, "$$$/Sarnik/TintorelError/fnfErr=The file or directory could not be found."},
    {-39, "$$$/Sarnik/TintorelError/eofErr=The end of the data was prematurely reached."},
    {-36, "$$$/Sarnik/TintorelError/ioErr=A file system error has occurred."},
    {-34, "$$$/Sarnik/TintorelError/dskFulErr=The disk is full."},
    {-23, "$$$/Sarnik/TintorelError/openErr=The requested read or write permission is not allowed."},
    {-20, "$$$/Sarnik/TintorelError/writErr=The data could not be written."},
    {-19, "$$$/Sarnik/TintorelError/readErr=The data could not be read."},
};

} // namespace

std::string CException::GetTaskString() const
{
    return Localize(TaskText());
}

std::string CException::GetErrorString() const
{
    return Localize(ErrorText());
}

std::string CException::TaskText() const
{
    return "$$$/Sarnik/Exception/Task=The operation could not be completed.";
}

std::string CAbort::TaskText() const
{
    return "$$$/Sarnik/Abort/Task=The operation was not completed.";
}

std::string CAbort::ErrorText() const
{
    return "$$$/Sarnik/Abort/Error=The operation has been canceled.";
}

std::string CTintorelError::ErrorText() const
{
    const auto *const found = std::find_if(std::begin(hostMessages), std::end(hostMessages),
                                           [this](const hostMessage &m) { return m.code == code; });
    return found != std::end(hostMessages) ? found->text
                                           : "$$$/Sarnik/TintorelError/Unknown=An unknown host error has occurred.";
}

std::string CSystemError::ErrorText() const
{
    // The C library has a text for codes that it does not know as well; it begins with this word.
    const std::string text = std::generic_category().message(code);
    return code > 0 && !text.starts_with("Unknown")
               ? text
               : "$$$/Sarnik/SystemError/Win/Unknown=An unknown operating system error has occurred.";
}

} // namespace Sarnik
