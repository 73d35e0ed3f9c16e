#pragma once

#include <string>

namespace Bench
{

/// Makes a shaken photograph (scenes.h), RGB, 8 bits a sample unless the path ends in .pfm.
void makePhoto(int width, int height, const std::string &path);

} // namespace Bench
