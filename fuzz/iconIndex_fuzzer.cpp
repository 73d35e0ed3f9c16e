#include "framework/icons/resourceConversionThunk.h"
#include "fuzz/fuzzing.h"

using namespace Sarnik;
using Fuzzing::require;

/// The first byte: whether what follows is a whole index or the records of one. The second: how many records. Then the
/// index, and a store for both resolutions.
extern "C" int LLVMFuzzerTestOneInput(const std::uint8_t *data, std::size_t size)
{
    if (size < 2)
        return 0;
    const auto rest = std::as_bytes(std::span(data + 2, size - 2));
    std::vector<std::byte> index;
    if (data[0] % 2 == 1)
        index = writeIconIndex({});
    const std::size_t wanted = (data[0] % 2 == 1 ? 0 : iconHeaderBytes) + data[1] * CIconRecord::bytes;
    const auto records = rest.first(std::min(wanted, rest.size()));
    index.insert(index.end(), records.begin(), records.end());
    const auto store = rest.subspan(records.size());

    const auto icons = readIconIndex(index);
    CResourceDataProvider provider([&](std::string_view key) {
        return key == CResourceDataProvider::Icons ? std::span<const std::byte>(index) : store;
    });
    require(provider.Count() == (icons ? icons->size() : 0));
    if (!icons)
        return 0;
    require(readIconIndex(writeIconIndex(*icons)) == icons);

    ResourceConversionThunk thunk(provider);
    int drawn = 0;
    for (const auto &[name, record] : *icons)
    {
        if (++drawn > 4)
            break;
        for (const double scale : {1.0, 2.0})
            for (std::uint32_t state = 0; state <= CIconRecord::states; ++state)
            {
                const CIcon icon = thunk.Find(name, scale, state);
                require(!icon || (icon.pixels->width() <= 1024 && icon.pixels->height() <= 1024));
            }
        const auto cursor = thunk.OnScreen(name, 0.5);
        require(cursor.pixels == nullptr ||
                (cursor.hotX < cursor.pixels->width() && cursor.hotY < cursor.pixels->height()));
    }
    return 0;
}
