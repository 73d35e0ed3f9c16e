#pragma once

namespace Project
{

/// Which stage a preview is told of, and with that in whose coordinates the rectangle is: the first and the third in
/// the picture's, the others in those of the stage that tells.
enum class PNotice
{
    source = 1,
    sourceScaled = 2,
    resultFull = 3,
    resultFast = 4,
    resultFullScaled = 5,
    resultRough = 6,
};

} // namespace Project
