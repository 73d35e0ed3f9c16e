#pragma once

#include "shell/resources/resourceBytes.h"

namespace Project
{

/// What the host's scripting calls the filter and the keys of its recorded runs: the resource of type AETE, id 16000.
constexpr resourceBytes terminology()
{
    struct parameter
    {
        std::string_view name, key, type;
    };
    constexpr parameter parameters[] = {
        {"$$$/Deblur/Dialog/FullAutoOpertions=Auto Operations", "fulA", "bool"}, // the key is spelt so everywhere
        {"$$$/Deblur/Dialog/ImageHeight=Image Height", "imgH", "long"},
        {"$$$/Deblur/Dialog/ImageWidth=Image Width", "imgW", "long"},
        {"$$$/Deblur/Dialog/TotalBlurTrace=Total Traces", "knlC", "long"},
        {"$$$/Deblur/Dialog/AppliedBlurTrace=Activated", "appK", "long"},
        {"$$$/Deblur/Dialog/FineDeconvLabel=&Artifact Suppression", "fRet", "bool"},
    };

    resourceBytes r;
    for (const std::uint8_t version : {1, 0, 1, 0})
        r.byte(version);
    r.u16(0); // language
    r.u16(0); // script
    r.u16(1); // suites
    r.pascal("Corvane");
    r.pascal("Stillmark");
    r.code("debL");
    r.u16(1); // level
    r.u16(1); // version
    r.u16(1); // events
    r.pascal("$$$/Deblur/AETE/Name=Stillmark");
    r.pascal("");
    r.code("debL"); // class
    r.code("debL"); // id
    r.code("null"); // no reply
    r.pascal("");
    r.u16(0);
    r.code("#ImR"); // the direct parameter
    r.pascal("");
    r.u16(0xB000);
    r.u16(static_cast<std::uint16_t>(std::size(parameters)));
    for (const parameter &p : parameters)
    {
        r.pascal(p.name);
        r.code(p.key);
        r.code(p.type);
        r.pascal("");
        r.u16(0);
    }
    r.u16(0); // classes
    r.u16(0); // comparison operators
    r.u16(0); // enumerations
    return r;
}

} // namespace Project
