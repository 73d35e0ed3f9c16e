#include "gallery/messageLog.h"

#include "framework/controls/fields/numberFormat.h"

#include <cstdio>

namespace Stillmark
{
namespace
{

using namespace Sarnik;

std::string_view nameOf(EValuePhase phase)
{
    switch (phase)
    {
    case kValue_Set:
        return "set";
    case kValue_Click:
        return "click";
    case kValue_DragBegin:
        return "dragBegin";
    case kValue_Drag:
        return "drag";
    case kValue_DragEnd:
        return "dragEnd";
    case kValue_EditBegin:
        return "editBegin";
    case kValue_Edit:
        return "edit";
    case kValue_EditEnd:
        return "editEnd";
    }
    return "?";
}

std::string quoted(std::string_view text)
{
    std::string all = "\"";
    for (const char c : text)
    {
        if (c == '\n')
            all += "\\n";
        else
            all.append(c == '"' || c == '\\' ? 1 : 0, '\\').push_back(c);
    }
    return all + '"';
}

std::string valueOf(const CValueMessage &message)
{
    if (const auto *const number = dynamic_cast<const CValMsg<CNumber> *>(&message))
        return CNumberFormat{.bits = kNumber_Decimal, .decimals = 3}.Text(number->Value().value);
    if (const auto *const index = dynamic_cast<const CValMsg<unsigned> *>(&message))
        return std::to_string(index->Value());
    if (const auto *const button = dynamic_cast<const CValMsg<EButtonValue> *>(&message))
        return std::to_string(button->Value());
    if (const auto *const id = dynamic_cast<const CValMsg<CObjID> *>(&message))
        return id->Value().Name();
    if (const auto *const text = dynamic_cast<const CValMsg<std::string> *>(&message))
        return quoted(text->Value());
    return "?";
}

} // namespace

void messageLog::Write(std::string_view what, std::string_view about, std::string_view more) const
{
    if (!on)
        return;
    std::string line(what);
    for (const std::string_view part : {about, more})
        if (!part.empty())
            line.append(1, ' ').append(part);
    std::puts(line.c_str());
    std::fflush(stdout);
}

void messageLog::Value(const CValueMessage &message) const
{
    if (on)
        Write("value", message.Id().Name(), std::string(nameOf(message.Phase())) + ' ' + valueOf(message));
}

} // namespace Stillmark
