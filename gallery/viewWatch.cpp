#include "gallery/viewWatch.h"

#include "framework/base/localisedString.h"
#include "framework/views/application.h"
#include "framework/views/view.h"
#include "framework/views/window.h"

namespace Stillmark
{

using namespace Sarnik;

namespace
{

std::string written(const CRect &r)
{
    return std::to_string(r.left) + ',' + std::to_string(r.top) + ',' + std::to_string(r.right) + ',' +
           std::to_string(r.bottom);
}

/// Empty for a view without a name. The parts of controls have the same names in all of them: theirs go behind the
/// control's.
std::string nameOf(const CView &view)
{
    if (!view.Id())
        return {};
    std::string name = view.Id().Name();
    for (const CView *above = view.ParentView(); above != nullptr && name.starts_with("Sarnik/");
         above = above->ParentView())
        if (above->Id())
            name = above->Id().Name() + name.substr(name.rfind('/'));
    return name;
}

void findPlaces(const CContext &within, std::map<std::string, std::string> &found)
{
    for (const auto &view : within.Children())
    {
        const CRect seen = view->VisibleInWindow();
        if (const std::string name = nameOf(*view); !name.empty() && seen.Width() > 0 && seen.Height() > 0)
            found.emplace(name, written(seen));
        findPlaces(*view, found);
    }
}

} // namespace

void viewWatch::Look()
{
    const CWindow *const now = CApplication::Current()->Modal();
    if (!log.IsOn() || now == nullptr || now->Screen() == nullptr)
        return;
    if (now != window)
    {
        window = now;
        places.clear();
        where.clear();
        focus.clear();
    }
    const CPoint corner = now->ToScreen({});
    const std::string newWhere = std::to_string(static_cast<int>(corner.x)) + ',' +
                                 std::to_string(static_cast<int>(corner.y)) + ',' +
                                 std::to_string(now->Screen()->scale()) + ',' + Localize(now->Settings().title);
    if (newWhere != where)
        log.Write("window", newWhere);
    where = newWhere;

    std::map<std::string, std::string> found;
    findPlaces(*now, found);
    for (const auto &[name, place] : found)
        if (const auto old = places.find(name); old == places.end() || old->second != place)
            log.Write("place", name, place);
    for (const auto &[name, place] : places)
        if (!found.contains(name))
            log.Write("place", name, "-");
    places = std::move(found);

    const CView *view = now->Focus();
    while (view != nullptr && !view->Id())
        view = view->ParentView();
    const std::string newFocus = view == nullptr ? "-" : nameOf(*view);
    if (newFocus != focus)
        log.Write("focus", newFocus);
    focus = newFocus;
}

} // namespace Stillmark
