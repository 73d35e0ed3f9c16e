#include "framework/layout/wyraProperty.h"

#include "framework/base/localisedString.h"
#include "framework/layout/layoutError.h"
#include "framework/layout/viewBuilder.h"

#include <algorithm>
#include <charconv>
#include <cmath>

namespace Sarnik
{

const CExpressionValue *CWyraPropertyList::Find(std::string_view name) const
{
    const auto found = std::find_if(properties.rbegin(), properties.rend(),
                                    [name](const CWyraProperty &property) { return property.name == name; });
    return found == properties.rend() ? nullptr : &found->value;
}

bool CWyraVariablePropertyList::OfClass(std::string_view name, std::int32_t *value) const
{
    const auto found = builder != nullptr ? builder->DefaultOf(name) : std::nullopt;
    if (found)
        *value = *found;
    return found.has_value();
}

bool CWyraVariablePropertyList::ReadInteger(std::string_view name, std::int32_t *value) const
{
    return ReadAny({name}, value);
}

bool CWyraVariablePropertyList::ReadAny(std::initializer_list<std::string_view> names, std::int32_t *value) const
{
    if (value == nullptr)
        throw CLayoutError("value != NULL", "a property is read without a place for its value");
    for (const std::string_view name : names)
        if (const CExpressionValue *const own = head.Find(name); own != nullptr && own->Defined())
        {
            *value = own->integer;
            return true;
        }
    for (const std::string_view name : names)
        if (OfClass(name, value))
            return true;
    for (const std::string_view name : names)
        if (const CExpressionValue *const variable = InScope(name); variable != nullptr && variable->Defined())
        {
            *value = variable->integer;
            return true;
        }
    return false;
}

bool CWyraVariablePropertyList::ReadText(std::string_view name, std::string_view *value) const
{
    if (value == nullptr)
        throw CLayoutError("value != NULL", "a property is read without a place for its value");
    const CExpressionValue *found = head.Find(name);
    if (found == nullptr || !found->text)
        found = InScope(name);
    if (found == nullptr || !found->text)
        return false;
    *value = *found->text;
    return true;
}

std::int32_t CWyraVariablePropertyList::Integer(std::string_view name, std::int32_t otherwise) const
{
    ReadInteger(name, &otherwise);
    return otherwise;
}

std::string_view CWyraVariablePropertyList::Text(std::string_view name) const
{
    std::string_view text;
    ReadText(name, &text);
    return text;
}

std::string CWyraVariablePropertyList::LocalisedText(std::string_view name) const
{
    return Localize(Text(name));
}

double CWyraVariablePropertyList::Number(std::string_view name, double otherwise) const
{
    std::string_view text;
    if (ReadText(name, &text))
    {
        double number = 0;
        const auto [end, error] = std::from_chars(text.data(), text.data() + text.size(), number);
        return error == std::errc() && end == text.data() + text.size() && std::isfinite(number) ? number : otherwise;
    }
    std::int32_t integer = 0;
    return ReadInteger(name, &integer) ? integer : otherwise;
}

} // namespace Sarnik
