#pragma once

#include "host/photo.h"
#include "platform/json.h"

#include <string>

namespace Stillmark
{

using Platform::jsonArray;
using Platform::jsonBool;
using Platform::jsonNumber;
using Platform::jsonObject;
using Platform::jsonString;

/// [x, y, width, height]
std::string jsonRectangle(const rectangle &area);

} // namespace Stillmark
