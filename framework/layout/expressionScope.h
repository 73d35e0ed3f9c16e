#pragma once

#include "framework/layout/expressionValue.h"
#include "framework/layout/stringPool.h"

#include <array>
#include <cstddef>
#include <deque>
#include <memory>
#include <string_view>

namespace Sarnik
{

/// Named variables. A name that is not found here is looked for in the parent, which outlives the scope.
///
/// A definition knows its place in the text, and a later one with the same name hides it without destroying it: a view
/// in the text sees what was defined before it, however long after the parse it asks.
class CExpressionScope
{
public:
    static constexpr std::size_t anywhere = static_cast<std::size_t>(-1);
    static constexpr unsigned bucketCount = 127;

    explicit CExpressionScope(CStringPool &stringPool, const CExpressionScope *parentScope = nullptr)
        : pool(stringPool), parent(parentScope)
    {
    }
    CExpressionScope(const CExpressionScope &) = delete;
    CExpressionScope &operator=(const CExpressionScope &) = delete;
    virtual ~CExpressionScope() = default;

    /// Whether expressions may compare, and use `&&`, `||` and `in`.
    virtual bool LogicAllowed() const { return false; }

    /// The name is copied to the pool; a text is in it already, or lives as long: handing one long text on from name to
    /// name costs nothing. Positions never decrease from one call to the next.
    void Define(std::string_view name, const CExpressionValue &value, std::size_t position = 0);

    /// The last definition that stands no later in the text, here or further out; null if there is none.
    const CExpressionValue *Find(std::string_view name, std::size_t at = anywhere) const;

    const CExpressionScope *Parent() const { return parent; }
    CStringPool &Pool() const { return pool; }

    /// The hash of a name modulo bucketCount is its bucket.
    static std::uint32_t Hash(std::string_view name);

private:
    struct definition
    {
        std::string_view name;
        CExpressionValue value;
        std::uint32_t hash;
        std::size_t position;
        const definition *next; ///< an older one in the same bucket
    };
    struct table
    {
        std::array<const definition *, bucketCount> buckets{};
        std::deque<definition> definitions; // stay where they are as it grows
    };

    CStringPool &pool;
    const CExpressionScope *parent;
    std::unique_ptr<table> variables; ///< none before the first definition
};

} // namespace Sarnik
