#pragma once

#include "framework/controls/navigator/folderList.h"

#include <string>
#include <string_view>

namespace Sarnik
{

/// What becomes of a name that somebody has typed or chosen in a file dialog.
struct CFileChoice
{
    enum class outcome
    {
        enterFolder,
        take,
        askToReplace, ///< a file of that name is there
        refuse
    };
    outcome what = outcome::refuse;
    std::string path;    ///< absolute
    std::string message; ///< of a refusal; localised

    friend bool operator==(const CFileChoice &, const CFileChoice &) = default;
};

/// For opening: the file has to be there and to be readable.
CFileChoice choiceToOpen(const std::string &folder, std::string_view typed);
/// For saving: the folder has to be there. A name without an extension of the type, nor of another one of `known`, gets
/// the type's first one.
CFileChoice choiceToSave(const std::string &folder, std::string_view typed, const CFileType &type,
                         const std::vector<CFileType> &known = {});
/// A name for another type: an extension of one of `known` gives way to the first of `type`.
std::string nameForType(std::string_view name, const CFileType &type, const std::vector<CFileType> &known);

} // namespace Sarnik
