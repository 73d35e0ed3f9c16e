#include "host/vipsHandle.h"

#include "host/photo.h"

#include <cctype>
#include <mutex>
#include <stdexcept>

namespace Stillmark
{

namespace
{

void dropMessage(const gchar *, GLogLevelFlags, const gchar *, gpointer)
{
}

} // namespace

void startVips()
{
    static std::once_flag once;
    std::call_once(once, [] {
        g_log_set_handler("VIPS", static_cast<GLogLevelFlags>(G_LOG_LEVEL_MASK), dropMessage, nullptr);
        if (vips_init("stillmark") != 0)
            throw std::runtime_error("The picture library cannot be started: " + takeVipsError());
        vips_cache_set_max(0);
        vips_block_untrusted_set(TRUE);
    });
}

std::string takeVipsError()
{
    const std::unique_ptr<char, void (*)(gpointer)> text(vips_error_buffer_copy(), g_free);
    constexpr std::size_t longest = 200;
    std::string line;
    bool gap = false;
    for (const char *c = text.get(); *c && line.size() < longest; ++c)
    {
        if (*c == '\n')
            gap = !line.empty();
        else if (!std::iscntrl(static_cast<unsigned char>(*c)))
        {
            if (gap)
                line += "; ";
            gap = false;
            line += *c;
        }
    }
    return line;
}

void setPhotoThreads(int count)
{
    startVips();
    vips_concurrency_set(count);
}

} // namespace Stillmark
