#include "host/photoSaver.h"

#include "host/pfm.h"
#include "host/photoMetadata.h"
#include "host/rasterImage.h"

#include <algorithm>
#include <cerrno>

namespace Stillmark
{

namespace
{

/// A failure in libvips, to be told from those of our own code on the way out.
struct vipsFailure
{
};

void require(int result)
{
    if (result != 0)
        throw vipsFailure();
}

/// One of libvips' operations from an image to an image.
template <typename Operation> vipsImage applied(Operation operation)
{
    VipsImage *result = nullptr;
    require(operation(&result));
    return vipsImage(result);
}

/// The picture as the format is to get it, drawn from the raster when the saver asks for it.
vipsImage pictureToSave(rasterImage &drawer, const photo::content &model, const savePlan &plan)
{
    using form = rasterImage::form;
    const int colours = colourPlanesOf(model.mode);
    const int modelDepth = model.raster->sampleBytes() * 8;
    const form codes = plan.depth == 8 ? form::bytes : plan.depth == 16 ? form::shorts : form::floats;
    // libvips' conversions to sRGB are made for codes; a float map gets its floats at the very end.
    const form codesOfRgb = plan.depth == 8 ? form::bytes : form::shorts;
    const int extras = plan.flatten ? 1 : plan.extraPlanes;
    const bool together = !plan.toRgb;

    form samples = plan.toRgb ? codesOfRgb : codes;
    VipsInterpretation meaning = VIPS_INTERPRETATION_CMYK;
    switch (model.mode)
    {
    case colourMode::grey:
        meaning = plan.depth == 16 ? VIPS_INTERPRETATION_GREY16 : VIPS_INTERPRETATION_B_W;
        break;
    case colourMode::rgb:
        meaning = plan.depth == 8    ? VIPS_INTERPRETATION_sRGB
                  : plan.depth == 16 ? VIPS_INTERPRETATION_RGB16
                                     : VIPS_INTERPRETATION_scRGB;
        break;
    case colourMode::cmyk:
        break;
    case colourMode::lab:
        meaning = modelDepth == 8 ? VIPS_INTERPRETATION_LAB : VIPS_INTERPRETATION_LABS;
        samples = modelDepth == 8 ? form::labBytes : form::labShorts;
        break;
    }

    vipsImage picture = drawer.make(0, together ? colours + extras : colours, samples, meaning);
    if (model.metadata)
        copyMetadata(model.metadata.get(), picture.get());

    if (plan.toRgb)
    {
        const bool bytes = codesOfRgb == form::bytes;
        const VipsInterpretation rgb = bytes ? VIPS_INTERPRETATION_sRGB : VIPS_INTERPRETATION_RGB16;
        if (model.mode == colourMode::cmyk)
            picture = applied([&](VipsImage **out) {
                return vips_icc_transform(picture.get(), out, "srgb", "embedded", TRUE, "input_profile", "cmyk",
                                          "depth", bytes ? 8 : 16, nullptr);
            });
        else
        {
            picture = applied([&](VipsImage **out) { return vips_colourspace(picture.get(), out, rgb, nullptr); });
            vips_image_remove(picture.get(), VIPS_META_ICC_NAME); // it spoke of Lab
        }
        if (extras > 0)
        {
            const vipsImage others = drawer.make(colours, extras, codesOfRgb, VIPS_INTERPRETATION_MULTIBAND);
            picture =
                applied([&](VipsImage **out) { return vips_bandjoin2(picture.get(), others.get(), out, nullptr); });
            picture =
                applied([&](VipsImage **out) { return vips_copy(picture.get(), out, "interpretation", rgb, nullptr); });
        }
    }
    if (plan.flatten)
    {
        const double white = model.mode == colourMode::cmyk ? 0 : 255;
        const std::unique_ptr<VipsArrayDouble, void (*)(VipsArrayDouble *)> background(
            vips_array_double_new(&white, 1), [](VipsArrayDouble *a) { vips_area_unref(VIPS_AREA(a)); });
        picture = applied([&](VipsImage **out) {
            return vips_flatten(picture.get(), out, "background", background.get(), "max_alpha", 255.0, nullptr);
        });
    }
    return picture;
}

int encode(VipsImage *picture, photoFormat::kind kind, VipsTarget *target)
{
    switch (kind)
    {
    case photoFormat::kind::jpeg:
    {
        // The best Huffman codes need the whole picture's coefficients in memory.
        constexpr double mostForOptimum = 5e7;
        const bool small = static_cast<double>(picture->Xsize) * picture->Ysize <= mostForOptimum;
        return vips_jpegsave_target(picture, target, "Q", 95, "subsample_mode", VIPS_FOREIGN_SUBSAMPLE_OFF,
                                    "optimize_coding", small ? TRUE : FALSE, nullptr);
    }
    case photoFormat::kind::png:
        return vips_pngsave_target(picture, target, "filter", VIPS_FOREIGN_PNG_FILTER_ALL, "compression", 4, nullptr);
    case photoFormat::kind::webp:
        return vips_webpsave_target(picture, target, "Q", 95, "smart_subsample", TRUE, nullptr);
    default:
    {
        constexpr double mostForPlainTiff = 3e9; // offsets of 32 bits, with room for tags and what does not shrink
        const double bytes = static_cast<double>(VIPS_IMAGE_SIZEOF_IMAGE(picture));
        const auto predictor = picture->BandFmt == VIPS_FORMAT_FLOAT ? VIPS_FOREIGN_TIFF_PREDICTOR_FLOAT
                                                                     : VIPS_FOREIGN_TIFF_PREDICTOR_HORIZONTAL;
        // LZW packs bytes nearly as well as deflate in a tenth of the time, but inflates the noise of deeper samples.
        const auto packing = picture->BandFmt == VIPS_FORMAT_UCHAR ? VIPS_FOREIGN_TIFF_COMPRESSION_LZW
                                                                   : VIPS_FOREIGN_TIFF_COMPRESSION_DEFLATE;
        return vips_tiffsave_target(picture, target, "compression", packing, "predictor", predictor, "bigtiff",
                                    bytes > mostForPlainTiff ? TRUE : FALSE, nullptr);
    }
    }
}

/// Float maps are ours to write, the bottom row first.
void writeFloatMap(VipsImage *picture, Platform::atomicFile &file)
{
    constexpr int bandRows = 64;
    const std::string header = pfmHeader(picture->Xsize, picture->Ysize, picture->Bands);
    file.write(header.data(), header.size());

    const std::unique_ptr<VipsRegion, vipsUnref> region(vips_region_new(picture));
    const std::size_t count = static_cast<std::size_t>(picture->Xsize) * static_cast<std::size_t>(picture->Bands);
    std::vector<float> row(count);
    for (int bottom = picture->Ysize; bottom > 0; bottom -= bandRows)
    {
        const int top = std::max(0, bottom - bandRows);
        const VipsRect area{0, top, picture->Xsize, bottom - top};
        require(vips_region_prepare(region.get(), &area));
        for (int y = bottom - 1; y >= top; --y)
        {
            const VipsPel *from = VIPS_REGION_ADDR(region.get(), 0, y);
            if (picture->BandFmt == VIPS_FORMAT_FLOAT)
                file.write(from, count * sizeof(float));
            else
            {
                const auto *codes = reinterpret_cast<const std::uint16_t *>(from);
                std::transform(codes, codes + count, row.begin(), [](std::uint16_t code) { return code / 65535.0f; });
                file.write(row.data(), count * sizeof(float));
            }
        }
    }
}

} // namespace

void savePicture(const sampleRaster &pixels, const photo::content &model, const photoFormat &format,
                 const savePlan &plan, Platform::atomicFile &file, const std::string &shownPath,
                 const progressCheck &progress)
{
    startVips();
    takeVipsError();
    rasterImage drawer(pixels, progress);
    try
    {
        const vipsImage picture = pictureToSave(drawer, model, plan);
        if (format.id == photoFormat::kind::floatMap)
            return writeFloatMap(picture.get(), file);
        adaptMetadata(picture.get(), format.id);
        const vipsTarget target(vips_target_new_to_descriptor(file.descriptor()));
        if (!target)
            throw vipsFailure();
        require(encode(picture.get(), format.id, target.get()));
    }
    catch (const vipsFailure &)
    {
        const std::string detail = takeVipsError();
        drawer.rethrow();
        throw Platform::fileError(shownPath + ": cannot be written" + (detail.empty() ? "" : ": " + detail));
    }
}

} // namespace Stillmark
