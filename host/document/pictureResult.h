#pragma once

#include "host/document/pictureSource.h"

namespace Stillmark
{

/// Takes what was written into a document. One thread at a time.
class pictureResult
{
public:
    virtual ~pictureResult() = default;

    /// Takes the codes of one plane (colours, then transparency) in area, which is not empty and lies within the
    /// picture. In any order; what is written again replaces what was there. Throws Platform::fileError.
    virtual void write(int plane, const rectangle &area, const planeSamples &codes) = 0;
};

} // namespace Stillmark
