#pragma once

#include "tests/framework/views/stage.h"

#include <sstream>

namespace Sarnik::Test
{

/// An open window that writes down the values that its controls tell: "EditBegin 3".
struct valueStage : stage
{
    explicit valueStage(double scale = 1) : stage(scale) { display.to(*panel.Screen()); }

    struct notingPanel : CWindow
    {
        explicit notingPanel(Log &told)
            : CWindow({"Panel", Platform::windowKind::normal, 63, {0, 0, 300, 200}, {83, 83, 83}}), entries(told)
        {
            Open();
        }
        bool ReceiveValue(CValueMessage &m) override
        {
            static constexpr const char *names[] = {"",        "Set",       "Click", "DragBegin", "Drag",
                                                    "DragEnd", "EditBegin", "Edit",  "EditEnd"};
            std::ostringstream line;
            line << names[m.Phase()] << " ";
            if (const auto *const number = dynamic_cast<CValMsg<CNumber> *>(&m))
                line << number->Value().value;
            else if (const auto *const text = dynamic_cast<CValMsg<std::string> *>(&m))
                line << text->Value();
            entries.push_back(line.str());
            last = m.Id();
            if (onValue)
                onValue(m);
            return true;
        }
        bool ReceiveCommand(CCommandMessage &m) override
        {
            entries.push_back("command " + m.Id().Name());
            return true;
        }
        bool UpdateCommand(CCommandMessage &m) override { return m.enabled = true; }
        void CloseRequested() override {}

        Log &entries;
        CObjID last;
        std::function<void(CValueMessage &)> onValue;
    };

    /// Presented pixels while something is done, in view units squared.
    template <class Action> std::int64_t Painted(Action action)
    {
        Run();
        const std::int64_t before = Shown().presentedPixels();
        action();
        Run();
        return (Shown().presentedPixels() - before) / static_cast<std::int64_t>(display.pixelsPerUnit());
    }
    Platform::memoryWindow &Shown() { return *display.find(panel.Screen()->id()); }
    /// What is shown is what a paint of everything would show.
    void ExpectFreshScreen()
    {
        Run();
        const Platform::raster kept = Shown().screen();
        panel.Invalidate();
        application.ProcessAll();
        EXPECT_TRUE(kept == Shown().screen());
    }

    notingPanel panel{log};
};

} // namespace Sarnik::Test
