#pragma once

#include "framework/layout/expressionScope.h"
#include "framework/layout/expressionValue.h"

#include <cstdint>
#include <initializer_list>
#include <string>
#include <string_view>
#include <vector>

namespace Sarnik
{

class CViewBuilderBase;

/// One `name: value` of a view's head.
struct CWyraProperty
{
    std::string_view name;
    CExpressionValue value;
};

/// The properties of one head, as they stand there. A name that stands twice has its last value.
class CWyraPropertyList
{
public:
    void Add(const CWyraProperty &property) { properties.push_back(property); }
    /// Null if the head does not have it.
    const CExpressionValue *Find(std::string_view name) const;
    std::size_t Count() const { return properties.size(); }

private:
    std::vector<CWyraProperty> properties;
};

/// The properties of a view as its builder reads them. A property is looked for in three places: the view's head, the
/// defaults of its class, and the variables that are seen where the view stands. The first place that has it decides.
class CWyraVariablePropertyList
{
public:
    /// All outlive this. `builder` may be null: a class without defaults. `at`: where the view stands in the text.
    CWyraVariablePropertyList(const CWyraPropertyList &headProperties, const CViewBuilderBase *viewBuilder,
                              const CExpressionScope &enclosingScope, std::size_t at)
        : head(headProperties), builder(viewBuilder), scope(enclosingScope), position(at)
    {
    }

    /// False, and *value as it was, where no place has a value of that kind. A string has no integer unless it is a
    /// four-character code. Throws CLayoutError if value is null.
    bool ReadInteger(std::string_view name, std::int32_t *value) const;
    bool ReadText(std::string_view name, std::string_view *value) const;

    std::int32_t Integer(std::string_view name, std::int32_t otherwise = 0) const;
    bool Boolean(std::string_view name, bool otherwise = false) const { return Integer(name, otherwise) != 0; }
    /// As it stands in the layout, and as the user reads it.
    std::string_view Text(std::string_view name) const;
    std::string LocalisedText(std::string_view name) const;
    /// A number with a fraction, which a layout writes as a string: '0.001'. Integers count too. `otherwise` for what
    /// is no finite number.
    double Number(std::string_view name, double otherwise = 0) const;

    /// A property of several names, the most particular one first: all of them are looked for in one place before the
    /// next place is asked.
    bool ReadAny(std::initializer_list<std::string_view> names, std::int32_t *value) const;

    /// The three places by themselves; null or false where the name is not there.
    const CExpressionValue *InHead(std::string_view name) const { return head.Find(name); }
    bool OfClass(std::string_view name, std::int32_t *value) const;
    const CExpressionValue *InScope(std::string_view name) const { return scope.Find(name, position); }

private:
    const CWyraPropertyList &head;
    const CViewBuilderBase *builder;
    const CExpressionScope &scope;
    std::size_t position;
};

} // namespace Sarnik
