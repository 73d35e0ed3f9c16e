#pragma once

#include "shell/resources/resourceBytes.h"

namespace Project
{

/// What a host learns of the plug-in without running it: the resource of type TPPL, id 16000. A list of properties,
/// each with its vendor, key, id 0, length and value, padded to a multiple of four bytes.
constexpr resourceBytes propertyList()
{
    resourceBytes list;
    std::uint32_t count = 0;
    const auto add = [&](std::string_view key, auto &&fill) {
        resourceBytes value;
        fill(value);
        list.code("TNDW");
        list.code(key);
        list.u32(0);
        list.u32(static_cast<std::uint32_t>(value.bytes.size()));
        value.pad();
        list.append(value);
        ++count;
    };

    add("nabo", [](resourceBytes &v) { v.u32(1); });
    add("kind", [](resourceBytes &v) { v.code("TNFM"); });
    add("vers", [](resourceBytes &v) { v.u32(0x00040000); });
    add("name", [](resourceBytes &v) { v.pascal("Stillmark..."); });
    add("catg", [](resourceBytes &v) { v.pascal("Sharpen"); });
    add("znam", [](resourceBytes &v) { v.pascal("$$$/Deblur/PiPL/Name=Stillmark..."); });
    add("zcat", [](resourceBytes &v) { v.pascal("$$$/Filters/Categories/Sharpen=Sharpen"); });
    add("cmpt", [](resourceBytes &v) {
        v.u32(0x00120101);
        v.text("Stillmark...");
    });
    add("flly", [](resourceBytes &v) { v.u32(0x80000000); });
    add("ms32", [](resourceBytes &v) { // the largest picture, pixels a side
        v.u32(2000000);
        v.u32(2000000);
    });
    add("8664", [](resourceBytes &v) { v.text(TN_ENTRY_NAME); });
    add("enbl", [](resourceBytes &v) {
        v.text("in (TNHOP_ImageMode, GrayScaleMode, Gray16Mode, Gray32Mode, RGBMode, RGB48Mode, RGB96Mode, LabMode, "
               "Lab48Mode, CMYKMode, CMYK64Mode)");
    });
    add("hstm", [](resourceBytes &v) {
        v.u32(0);
        v.code("debL");
        v.code("debL");
        v.u16(16000);
        v.text("7D3F0A42-91C6-4B1E-A7D2-5E60C8B4F913");
    });
    add("fici", [](resourceBytes &v) { // one for each of the host's image cases: input, output, two flags
        for (int i = 0; i < 7; ++i)
            for (const std::uint8_t b : {1, 1, 1, 0})
                v.byte(b);
    });

    resourceBytes r;
    r.u16(1); // signature
    r.u32(0); // version
    r.u32(count);
    r.append(list);
    return r;
}

} // namespace Project
