#pragma once

#include "framework/pixels/rect.h"

#include <cstdint>
#include <memory>
#include <optional>
#include <string>
#include <string_view>
#include <unordered_map>

namespace Sarnik
{

class CWyraVariablePropertyList;

struct CLayoutSize
{
    std::int32_t width = 0, height = 0;

    friend bool operator==(const CLayoutSize &, const CLayoutSize &) = default;
};

/// How large a text is when it is drawn. The layout language has no fonts of its own; whoever draws answers.
class CTextMeasure
{
public:
    /// text: localised, one line or several. font: one of the kFont_... numbers of the layouts. In pixels of scale 1.
    virtual CLayoutSize Measure(std::string_view text, std::int32_t font) const = 0;

protected:
    ~CTextMeasure() = default;
};

/// Where a view lies.
struct CLayoutPlacement
{
    CRect frame;                 ///< from the left top corner of its parent; of a window from its own
    std::int32_t labelWidth = 0; ///< of the label column that it shares with its neighbours; 0 if it has no label
};

/// What a layout builds, as far as the layout language deals with it.
class CLayoutView
{
public:
    virtual ~CLayoutView() = default;

    /// Called once, before any child is adopted. Nothing of `properties` may be kept but copies.
    virtual void TakeLayout(const CLayoutPlacement &placement, const CWyraVariablePropertyList &properties) = 0;
    /// Called once for each child, after the child has taken its own layout and adopted its own children. `interior`:
    /// the part of this view that the child is meant for, one of the kInterior_... numbers.
    virtual void AdoptChild(std::unique_ptr<CLayoutView> child, std::int32_t interior) = 0;
};

class CViewBuilderBase;

/// The classes that a layout may name.
class CViewBuilderMap
{
public:
    /// Those of the program: every static builder has entered itself.
    static CViewBuilderMap &Global();

    /// The builder outlives the map's use; a second one of the same name replaces the first.
    void Enter(const CViewBuilderBase &builder);
    /// Null for a name without a builder.
    const CViewBuilderBase *Find(std::string_view className) const;

private:
    std::unordered_map<std::string_view, const CViewBuilderBase *> builders;
};

/// What the layout language knows of one class: its defaults, its natural size, and how to make a view of it.
class CViewBuilderBase
{
public:
    explicit CViewBuilderBase(std::string_view viewClassName, CViewBuilderMap &map = CViewBuilderMap::Global())
        : className(viewClassName)
    {
        map.Enter(*this);
    }
    CViewBuilderBase(const CViewBuilderBase &) = delete;
    CViewBuilderBase &operator=(const CViewBuilderBase &) = delete;
    virtual ~CViewBuilderBase() = default;

    const std::string &ClassName() const { return className; }

    /// The class's own value of a property; it goes before variables of the layout, and behind the view's head.
    virtual std::optional<std::int32_t> DefaultOf(std::string_view property) const = 0;
    /// The size without regard to children: of the text, of the bitmap, of a frame around nothing.
    virtual CLayoutSize NaturalSize(const CWyraVariablePropertyList &properties, const CTextMeasure &measure) const = 0;
    virtual std::unique_ptr<CLayoutView> Create() const = 0;

private:
    std::string className;
};

/// The builder of class T, which offers the two static functions LayoutDefault(property) and NaturalSize(properties,
/// measure) and is built without arguments. One static object per class enters it into the map:
///
///     static const CPaneBuilder<CStaticText> staticTextBuilder("CStaticText");
template <class T> class CViewBuilder : public CViewBuilderBase
{
public:
    using CViewBuilderBase::CViewBuilderBase;

    std::optional<std::int32_t> DefaultOf(std::string_view property) const override
    {
        return T::LayoutDefault(property);
    }
    CLayoutSize NaturalSize(const CWyraVariablePropertyList &properties, const CTextMeasure &measure) const override
    {
        return T::NaturalSize(properties, measure);
    }
    std::unique_ptr<CLayoutView> Create() const override { return std::make_unique<T>(); }
};

/// The same for panes and for windows. Layouts do not tell them apart: a window is a view that others lie in.
using CPaneBuilderBase = CViewBuilderBase;
using CWindowBuilderBase = CViewBuilderBase;
template <class T> using CPaneBuilder = CViewBuilder<T>;
template <class T> using CWindowBuilder = CViewBuilder<T>;

} // namespace Sarnik
