#pragma once

#include "framework/controls/dialog.h"
#include "framework/tasks/taskStack.h"
#include "framework/views/timer.h"
#include "gallery/messageLog.h"
#include "gallery/primeCount.h"
#include "gallery/viewWatch.h"

#include <string>

namespace Stillmark
{

/// Every control of the interface in one window: gallery.wyra places them, here they are filled and tied together.
class galleryDialog final : public Sarnik::CDialog
{
public:
    /// The log outlives it.
    explicit galleryDialog(const messageLog &to);

    bool ReceiveValue(Sarnik::CValueMessage &message) override;
    bool ReceiveCommand(Sarnik::CCommandMessage &message) override;
    bool UpdateCommand(Sarnik::CCommandMessage &message) override;
    bool ReceiveMenu(Sarnik::CMenuMessage &message) override;
    bool ReceiveMessage(Sarnik::CMessage &message) override;
    void SetHelp(const std::string &text) override;

private:
    void Loaded() override;
    void Fill();

    /// A slider or a field, and whatever shows the same number.
    void SetNumber(Sarnik::CObjID id, double value);
    void NumberChanged(const Sarnik::CValMsg<Sarnik::CNumber> &message);
    /// Whether it was a button with a value of its own.
    bool ButtonChanged(const Sarnik::CValMsg<Sarnik::EButtonValue> &message);
    void Chosen(const Sarnik::CValMsg<unsigned> &message);
    bool ShowAlert(Sarnik::CObjID button);
    bool AskForFile(Sarnik::CObjID command);
    void AddCell();
    void RemoveCells();
    void SetZoom(double factor);
    void StartProgress();
    static void Tick(void *dialog);

    const messageLog &log;
    viewWatch watch{log};
    Sarnik::CTaskStack tasks;
    double before = 0; ///< of the number that is being changed
    Sarnik::CTimer timer{1.0 / 30, Tick, this};
    primeCount primes;
    int lastCell = 0;
};

} // namespace Stillmark
