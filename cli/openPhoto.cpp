#include "cli/commands.h"

namespace Stillmark
{

photo openPhoto(const std::string &path, runContext &context)
{
    context.bar.stage("Reading");
    photo picture = photo::open(path, context.progress());
    for (const std::string &note : picture.notes())
        context.notes.push_back(picture.path() + ": " + note);
    return picture;
}

} // namespace Stillmark
