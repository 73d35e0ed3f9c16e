#include "host/greyPng.h"

#include "host/vipsHandle.h"
#include "platform/files.h"

namespace Stillmark
{

namespace
{

void write(const std::string &path, int width, int height, const void *samples, VipsBandFormat format)
{
    startVips();
    takeVipsError();
    Platform::atomicFile file(path);
    const std::size_t size =
        static_cast<std::size_t>(width) * static_cast<std::size_t>(height) * vips_format_sizeof(format);
    const vipsImage image(vips_image_new_from_memory(samples, size, width, height, 1, format));
    const vipsTarget target(vips_target_new_to_descriptor(file.descriptor()));
    if (image)
        image->Type = format == VIPS_FORMAT_USHORT ? VIPS_INTERPRETATION_GREY16 : VIPS_INTERPRETATION_B_W;
    if (!image || !target || vips_pngsave_target(image.get(), target.get(), nullptr) != 0)
        throw Platform::fileError(path + ": cannot be written: " + takeVipsError());
    file.commit();
}

} // namespace

void writeGreyPng(const std::string &path, int width, int height, const std::vector<std::uint8_t> &samples)
{
    write(path, width, height, samples.data(), VIPS_FORMAT_UCHAR);
}

void writeGreyPng(const std::string &path, int width, int height, const std::vector<std::uint16_t> &samples)
{
    write(path, width, height, samples.data(), VIPS_FORMAT_USHORT);
}

} // namespace Stillmark
