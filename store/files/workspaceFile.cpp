#include "store/files/workspaceFile.h"

#include "store/files/collectionStream.h"
#include "store/files/fileBytes.h"
#include "store/files/fileHeader.h"
#include "store/traces/kernelCollection.h"

namespace Project
{

bool CheckFileHeader(PKernelCollection &collection, const std::string &path)
{
    return LoadFile(collection, path, [&](Sarnik::CContainer &in) {
        ReadHeader(collection, in);
        return true;
    });
}

bool LoadWorkspace(PKernelCollection &collection, const std::string &path, PStreamIndices *indices)
{
    return LoadFile(collection, path, [&](Sarnik::CContainer &in) {
        ReadHeader(collection, in);
        if (!collection.GetLastError().empty())
            return false;
        // However the reading ends, the old traces are gone, and with them what could be undone.
        const auto tell = [&] {
            collection.Events().WorkspaceLoaded();
            collection.SetSavedMark(0);
        };
        try
        {
            ReadCollection(collection, in, indices);
        }
        catch (...)
        {
            tell();
            throw;
        }
        tell();
        return true;
    });
}

bool SaveWorkspace(PKernelCollection &collection, const std::string &directory, const std::string &name)
{
    const bool saved = SaveFile(directory, name, [&](Sarnik::CContainer &out) {
        WriteHeader(collection, out);
        WriteCollection(collection, out);
        return true;
    });
    if (saved)
        collection.SetSavedMark(collection.Events().UndoPosition());
    return saved;
}

} // namespace Project
