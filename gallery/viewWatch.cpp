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

} // namespace

void viewWatch::Look(const CContext &within, std::map<CObjID, std::string> &found) const
{
    for (const auto &view : within.Children())
    {
        const CRect seen = view->VisibleInWindow();
        if (view->Id() && seen.Width() > 0 && seen.Height() > 0)
            found.emplace(view->Id(), written(seen));
        Look(*view, found);
    }
}

bool viewWatch::Idle()
{
    const CWindow *const now = CApplication::Current()->Modal();
    if (!log.IsOn() || now == nullptr || now->Screen() == nullptr)
        return false;
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
                                 std::to_string(now->Screen()->scale()) + ',' + localised(now->Settings().title);
    if (newWhere != where)
        log.Write("window", newWhere);
    where = newWhere;

    std::map<CObjID, std::string> found;
    Look(*now, found);
    for (const auto &[id, place] : found)
        if (const auto old = places.find(id); old == places.end() || old->second != place)
            log.Write("place", id.Name(), place);
    for (const auto &[id, place] : places)
        if (!found.contains(id))
            log.Write("place", id.Name(), "-");
    places = std::move(found);

    // A part without an id counts as the whole: the field of an edit slider.
    const CView *view = now->Focus();
    while (view != nullptr && !view->Id())
        view = view->ParentView();
    const std::string newFocus = view == nullptr ? "-" : view->Id().Name();
    if (newFocus != focus)
        log.Write("focus", newFocus);
    focus = newFocus;
    return false;
}

} // namespace Stillmark
