#pragma once

#include "framework/controls/buttons/button.h"
#include "framework/views/timer.h"
#include "tests/framework/views/stage.h"

namespace Sarnik::Test
{

/// A stage whose controls lie in a pane that writes down what they say: "name phase value", "command name", "event
/// source".
struct controlStage : stage
{
    explicit controlStage(double scale = 1) : stage(scale), pane(window.Make<notingHost>(log)) {}

    struct notingHost : CPane
    {
        explicit notingHost(Log &log) : CPane({0, 0, 200, 120}), entries(log) {}

        bool ReceiveValue(CValueMessage &m) override
        {
            std::string value;
            if (const auto *const button = dynamic_cast<const CValMsg<EButtonValue> *>(&m))
                value = std::to_string(button->Value());
            else if (const auto *const id = dynamic_cast<const CValMsg<CObjID> *>(&m))
                value = id->Value().Name();
            entries.push_back(m.Id().Name() + " " + std::to_string(m.Phase()) + " " + value);
            if (onValue)
                onValue();
            return takesValues;
        }
        bool ReceiveMessage(CMessage &m) override
        {
            if (const auto *const event = dynamic_cast<const CMessageEvent *>(&m))
                entries.push_back(m.Id().Name() + " " + event->Source().Name());
            return true;
        }

        Log &entries;
        std::function<void()> onValue;
        bool takesValues = true;
    };

    template <class T> T &Control(const char *name, const CRect &frame, CContext *in = nullptr)
    {
        T &control = (in == nullptr ? static_cast<CContext &>(pane) : *in).Make<T>(frame);
        control.SetId(CObjID(name));
        return control;
    }
    /// An action in the middle of a script, where a tracker may run.
    struct call
    {
        call(double when, std::function<void()> what) : action(std::move(what)), timer(when, Fire, this)
        {
            timer.Start();
        }
        static void Fire(void *self)
        {
            static_cast<call *>(self)->timer.Stop();
            static_cast<call *>(self)->action();
        }
        std::function<void()> action;
        CTimer timer;
    };
    void At(double seconds, std::function<void()> action)
    {
        calls.push_back(std::make_unique<call>(seconds, std::move(action)));
    }
    std::int64_t PixelsShown(const std::function<void()> &change)
    {
        Run();
        const std::int64_t before = Screen().presentedPixels();
        change();
        Run();
        return Screen().presentedPixels() - before;
    }

    notingHost &pane;
    std::vector<std::unique_ptr<call>> calls;
};

} // namespace Sarnik::Test
