#include "framework/controls/fields/editString.h"
#include "framework/views/application.h"
#include "framework/views/window.h"
#include "platform/window/memoryDisplay.h"

#include <benchmark/benchmark.h>

#include <cstddef>
#include <cstdint>
#include <string>

using namespace Sarnik;

namespace
{

/// Words of one to nine letters, with line ends where they divide the text into so many lines.
std::string wordsIn(std::size_t bytes, std::size_t lines)
{
    std::string text;
    std::size_t line = 1;
    for (std::size_t word = 0; text.size() < bytes; ++word)
    {
        text.append(1 + word * 7 % 9, static_cast<char>('a' + word % 26));
        const bool full = text.size() >= bytes / lines * line;
        text += full ? '\n' : ' ';
        line += full ? 1 : 0;
    }
    text.resize(bytes);
    return text;
}

/// A field with the focus in a window without a screen, its caret in the middle of a long text.
struct longField
{
    longField(std::size_t lines, std::uint32_t options)
    {
        field.SetEditOptions(options);
        field.SetValue(wordsIn(CTextEditor::mostBytes - 10, lines));
        field.SetFocus();
        field.Select(field.Value().size() / 2, field.Value().size() / 2);
        display.to(*window.Screen());
        run();
    }
    void run()
    {
        while (!display.scriptEnded())
            application.ProcessOne();
        application.ProcessAll();
    }

    struct plainWindow : CWindow
    {
        plainWindow() : CWindow({"Field", Platform::windowKind::normal, 63, {0, 0, 300, 200}, {83, 83, 83}}) { Open(); }
    };

    Platform::memoryDisplay display;
    CApplication application{display};
    plainWindow window;
    CEditString &field = window.Make<CEditString>(CRect{10, 10, 290, 190});
};

void applyOptions(benchmark::internal::Benchmark *b)
{
    b->ArgNames({"lines", "options"})
        ->Args({2000, kEdit_MultiLine})
        ->Args({1, kEdit_MultiLine})
        ->Args({1, kEdit_NoOptions})
        ->Unit(benchmark::kMillisecond);
}

/// A letter typed into a text of 100,000, or taken out again: what follows from it, up to the painted window.
void fieldKey(benchmark::State &state)
{
    longField open(static_cast<std::size_t>(state.range(0)), static_cast<std::uint32_t>(state.range(1)));
    bool typed = false;
    for ([[maybe_unused]] auto _ : state)
    {
        typed = !typed;
        typed ? open.display.type("x") : open.display.tap(Platform::key::backspace);
        open.run();
    }
}
BENCHMARK(fieldKey)->Apply(applyOptions);

/// The caret goes a place to the right: nothing is to be laid out.
void fieldArrow(benchmark::State &state)
{
    longField open(static_cast<std::size_t>(state.range(0)), static_cast<std::uint32_t>(state.range(1)));
    for ([[maybe_unused]] auto _ : state)
    {
        open.display.tap(Platform::key::right);
        open.run();
    }
}
BENCHMARK(fieldArrow)->Apply(applyOptions);

/// The field gets such a text, with the focus elsewhere.
void fieldFill(benchmark::State &state)
{
    longField open(static_cast<std::size_t>(state.range(0)), static_cast<std::uint32_t>(state.range(1)));
    const std::string text = open.field.Value();
    open.window.SetFocus(nullptr);
    for ([[maybe_unused]] auto _ : state)
    {
        open.field.SetValue("");
        open.run();
        open.field.SetValue(text);
        open.run();
    }
}
BENCHMARK(fieldFill)->Apply(applyOptions);

} // namespace
