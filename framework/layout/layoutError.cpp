#include "framework/layout/layoutError.h"

namespace Sarnik
{

std::string CLayoutError::Message(std::string_view assertion, std::string_view reason, std::size_t line,
                                  std::size_t column)
{
    std::string message = "Warning! (" + std::string(assertion) + ")";
    if (line > 0)
        message += " line " + std::to_string(line) + ", column " + std::to_string(column);
    return message + ": " + std::string(reason);
}

} // namespace Sarnik
