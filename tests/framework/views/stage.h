#pragma once

#include "framework/views/application.h"
#include "framework/views/dragDrop.h"
#include "framework/views/view.h"
#include "framework/views/window.h"
#include "platform/window/memoryDisplay.h"

#include <gmock/gmock.h>

#include <functional>
#include <string>
#include <vector>

namespace Sarnik::Test
{

using Log = std::vector<std::string>;

/// A pane of one colour that writes down what it is told.
struct notingPane : CPane
{
    notingPane(Log &log, std::string called, const CRect &frame, std::uint32_t options = 0)
        : CPane(frame, options), entries(log), name(std::move(called))
    {
        SetId(CObjID("test/pane/" + name));
    }
    void Note(const std::string &what) const { entries.push_back(name + " " + what); }

    void Draw(CPort &port) override
    {
        ++drawn;
        for (const CRect &part : port.Parts())
            asked += part.Width() * part.Height();
        port.Canvas().fillRectangle(toCanvas(Bounds()), colour);
        // Nothing slanted: where such a line is clipped its edge pixels may differ by some levels.
        const Platform::rectangle r = toCanvas(Bounds());
        port.Canvas().drawRectangle({r.left + 3.5, r.top + 3.5, r.right - 3.5, r.bottom - 3.5},
                                    {.ink = {255, 255, 255}});
    }
    bool MouseDown(const CMouseEvent &e) override
    {
        Note("down " + std::to_string(int(e.at.x)) + "," + std::to_string(int(e.at.y)));
        return takesPress;
    }
    void MouseUp(const CMouseEvent &) override { Note("up"); }
    void MouseEnter() override { Note("enter"); }
    void MouseLeave() override { Note("leave"); }
    bool MouseWheel(const CMouseEvent &) override
    {
        Note("wheel");
        return takesPress;
    }
    bool ContextClick(const CMouseEvent &) override
    {
        Note("context");
        return true;
    }
    bool ReceiveKeyboard(CKeyboardMessage &m) override
    {
        if (m.IsChar() || m.IsDown())
            Note(std::string(m.IsChar() ? "char " : "key ") + static_cast<char>(m.Character()));
        return takesKeys;
    }
    void FocusChanged(bool has) override { Note(has ? "focus" : "blur"); }
    void Press() override { Note("press"); }
    char32_t AccessKey() const override { return accessKey; }

    Log &entries;
    std::string name;
    Platform::colour colour{200, 100, 50};
    bool takesPress = true, takesKeys = false;
    char32_t accessKey = 0;
    int drawn = 0;
    std::int64_t asked = 0;
};

/// A display without a screen, the loop, and an open window of 200 by 120 units.
struct stage : testing::Test
{
    explicit stage(double scale = 1) : display(scale)
    {
        window.Open();
        Run();
        log.clear();
    }
    /// Everything that the script holds, and what follows from it.
    void Run()
    {
        while (!display.scriptEnded())
            application.ProcessOne();
        application.ProcessAll();
    }
    Log Told()
    {
        Run();
        return std::exchange(log, {});
    }
    notingPane &Pane(const std::string &name, const CRect &frame, std::uint32_t options = 0, CContext *in = nullptr)
    {
        return (in == nullptr ? static_cast<CContext &>(window) : *in).Make<notingPane>(log, name, frame, options);
    }
    Platform::memoryWindow &Screen() { return *display.find(window.Screen()->id()); }

    struct notingWindow : CWindow
    {
        explicit notingWindow(Log &log)
            : CWindow({"Test", Platform::windowKind::normal, 63 | kWin_DropFiles, {10, 10, 210, 130}, {}}), entries(log)
        {
        }
        bool KeyboardFilter(CKeyboardMessage &m) override { return filter && filter(m); }
        bool UpdateCommand(CCommandMessage &m) override
        {
            m.enabled = commandEnabled;
            m.text = "$$$/Test/Command=Do it";
            return true;
        }
        bool ReceiveCommand(CCommandMessage &m) override
        {
            entries.push_back("command " + m.Id().Name());
            return true;
        }
        bool GetTip(CPoint at, CTip &tip) override { return tipAt && tipAt(at, tip); }
        void SetHelp(const std::string &text) override { entries.push_back("help " + text); }

        Log &entries;
        std::function<bool(CKeyboardMessage &)> filter;
        std::function<bool(CPoint, CTip &)> tipAt;
        bool commandEnabled = true;
    };

    Platform::memoryDisplay display;
    CApplication application{display};
    Log log;
    notingWindow window{log};
};

} // namespace Sarnik::Test
