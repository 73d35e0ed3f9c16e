#pragma once

#include "host/document/pictureResult.h"
#include "host/photoWriter.h"

#include <string>
#include <vector>

namespace Stillmark
{

/// What is written becomes a new version of a photo; all else in it stays the photo's, bit for bit.
class resultRaster final : public pictureResult
{
public:
    /// Checks the path as photoWriter does, and throws what it throws.
    resultRaster(const photo &model, const std::string &path) : writer(model, path) {}

    void write(int plane, const rectangle &area, const planeSamples &codes) override;
    bool wasWritten() const { return started; }

    /// What saving will have to change, one plain sentence each.
    const std::vector<std::string> &notes() const { return writer.notes(); }

    /// Saves; once. Throws as photoWriter::commit does.
    void commit(const progressCheck &progress = {});

private:
    void start();

    photoWriter writer;
    bool started = false; ///< the writer has the photo's pixels
};

} // namespace Stillmark
