#define STILLMARK_BUILDS_PLUGIN
#include "shell/plugin/filter.h"
#include "shell/plugin/selectorDispatch.h"

void EntryFI(std::uint16_t selector, void *block, std::intptr_t *data, std::int16_t *result)
{
    Sarnik::DispatchSelector(
        []() -> std::unique_ptr<Sarnik::CTintorelFilter> { return std::make_unique<Project::PFilter>(); }, selector,
        block, data, result);
}
