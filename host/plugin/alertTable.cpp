#include "host/plugin/alertTable.h"

#include <iostream>

namespace Stillmark
{
namespace
{

constexpr std::size_t mostKept = 1000;

std::string textOf(const char *text)
{
    return text ? text : "";
}

void printAlert(const hostAlert &alert)
{
    std::string line = alert.title + ": " + alert.first;
    if (!alert.second.empty())
        line += " " + alert.second;
    if (alert.kind == TNAlertYesNo)
        line += alert.answer == TNAnswerOk ? " Yes." : " No.";
    std::cerr << line << std::endl;
}

} // namespace

alertTable::alertTable(runState &run, const hostOptions &hostOffers) : state(run), options(hostOffers)
{
    table.context = this;
    table.show = [](void *context, std::int32_t kind, const char *title, const char *first, const char *second) {
        alertTable &all = *static_cast<alertTable *>(context);
        return all.state.value("show of an alert", std::int32_t{TNAnswerNo}, [&] {
            const TNAlertKind known = kind == TNAlertYesNo ? TNAlertYesNo : TNAlertOk;
            return all.show({known, textOf(title), textOf(first), textOf(second), TNAnswerOk});
        });
    };
    table.beep = nullptr; // there is nobody to hear it
    table.waitCursor = nullptr;
}

std::int32_t alertTable::show(hostAlert alert)
{
    if (alert.kind == TNAlertYesNo)
    {
        alert.answer = questions < options.answers.size() ? options.answers[questions] : TNAnswerNo;
        questions++;
    }
    if (const hostLie lie = state.lie(hostCall::alert); lie.fails() || lie.raves())
        alert.answer = lie.fails() ? 0 : 77;
    if (list.size() < mostKept)
        list.push_back(alert);
    (options.alert ? options.alert : printAlert)(alert);
    return alert.answer;
}

} // namespace Stillmark
