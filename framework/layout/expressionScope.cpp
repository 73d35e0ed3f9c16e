#include "framework/layout/expressionScope.h"

namespace Sarnik
{

std::uint32_t CExpressionScope::Hash(std::string_view name)
{
    std::uint32_t hash = 0;
    for (const char c : name)
    {
        std::uint32_t value = static_cast<unsigned char>(c);
        if (c >= '0' && c <= '9')
            value = static_cast<std::uint32_t>(c - '0');
        else if (c >= 'A' && c <= 'Z')
            value = static_cast<std::uint32_t>(c - 'A' + 10);
        else if (c >= 'a' && c <= 'z')
            value = static_cast<std::uint32_t>(c - 'a' + 36);
        else if (c == '_')
            value = 62;
        hash = hash * 63 + value;
    }
    return hash;
}

void CExpressionScope::Define(std::string_view name, const CExpressionValue &value, std::size_t position)
{
    if (!variables)
        variables = std::make_unique<table>();
    const std::uint32_t hash = Hash(name);
    const definition *&bucket = variables->buckets[hash % bucketCount];
    variables->definitions.push_back({pool.Copy(name), value, hash, position, bucket});
    bucket = &variables->definitions.back();
}

const CExpressionValue *CExpressionScope::Find(std::string_view name, std::size_t at) const
{
    const std::uint32_t hash = Hash(name);
    for (const CExpressionScope *scope = this; scope != nullptr; scope = scope->parent)
    {
        if (!scope->variables)
            continue;
        for (const definition *d = scope->variables->buckets[hash % bucketCount]; d != nullptr; d = d->next)
            if (d->hash == hash && d->position <= at && d->name == name)
                return &d->value;
    }
    return nullptr;
}

} // namespace Sarnik
