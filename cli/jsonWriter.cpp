#include "cli/jsonWriter.h"

namespace Stillmark
{

std::string jsonRectangle(const rectangle &area)
{
    return jsonArray({jsonNumber(area.x), jsonNumber(area.y), jsonNumber(area.width), jsonNumber(area.height)});
}

} // namespace Stillmark
