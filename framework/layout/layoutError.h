#pragma once

#include "framework/base/exceptions.h"

#include <cstddef>
#include <string>
#include <string_view>
#include <utility>

namespace Sarnik
{

/// A layout text that cannot be used. Its error line is the assertion that failed and, for whoever writes the layout,
/// the place and the reason: "Warning! (variable != NULL) line 3, column 14: no variable is named 'gSpce'". Both count
/// from 1, a column is a character. Line 0 stands for a failure without a place in the text.
class CLayoutError : public CError
{
public:
    CLayoutError(std::string_view assertion, std::string_view reason, std::size_t atLine = 0, std::size_t atColumn = 0)
        : CError(Message(assertion, reason, atLine, atColumn)), line(atLine), column(atColumn)
    {
    }

    std::size_t Line() const { return line; }
    std::size_t Column() const { return column; }

private:
    static std::string Message(std::string_view assertion, std::string_view reason, std::size_t line,
                               std::size_t column);

    std::size_t line, column;
};

} // namespace Sarnik
