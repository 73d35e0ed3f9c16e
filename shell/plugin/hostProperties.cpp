#include "shell/plugin/hostProperties.h"

namespace Sarnik
{

std::optional<std::intptr_t> CHostProperties::Number(std::uint32_t key, std::uint32_t signature) const
{
    if (procs == nullptr || procs->get == nullptr)
        return std::nullopt;
    std::intptr_t number = 0;
    TNHandle text = nullptr;
    if (procs->get(procs->context, signature, key, 0, &number, &text) != TNNoError)
        return std::nullopt;
    if (text == nullptr)
        return number;
    if (handles != nullptr && handles->dispose != nullptr)
        handles->dispose(handles->context, text);
    return std::nullopt;
}

bool CHostProperties::Set(std::uint32_t key, std::intptr_t number) const
{
    return procs != nullptr && procs->set != nullptr &&
           procs->set(procs->context, TN_PROPERTY_SIGNATURE, key, 0, number) == TNNoError;
}

} // namespace Sarnik
