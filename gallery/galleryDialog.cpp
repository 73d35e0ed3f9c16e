#include "gallery/galleryDialog.h"

#include "framework/base/localisedString.h"
#include "framework/controls/alerts/messageAlert.h"
#include "framework/controls/buttons/toolButton.h"
#include "framework/controls/menus/comboBox.h"
#include "framework/controls/menus/zoomProgressCombo.h"
#include "framework/controls/navigator/navigator.h"
#include "framework/controls/panes/columnStack.h"
#include "framework/controls/panes/disclosurePane.h"
#include "framework/controls/panes/staticText.h"
#include "framework/controls/panes/switchPane.h"
#include "framework/controls/sliders/angleSlider.h"
#include "framework/controls/sliders/editSlider.h"
#include "gallery/galleryMenus.h"
#include "gallery/galleryPanes.h"
#include "gallery/valueTask.h"

#include <fstream>
#include <iterator>

namespace Stillmark
{

using namespace Sarnik;

namespace
{

/// Views that show the same number.
constexpr const char *twins[][2] = {{"gallery/angle", "gallery/angleNumber"}, {"gallery/level", "gallery/levelNumber"}};
constexpr const char *pages[] = {"gallery/case/first", "gallery/case/second"};

std::string layoutText()
{
    std::ifstream file(STILLMARK_GALLERY_LAYOUT);
    return {std::istreambuf_iterator<char>(file), {}};
}

} // namespace

galleryDialog::galleryDialog(const messageLog &to)
    : log(to), primes([this](int tried, int found) {
          Find<CProgressBar>("gallery/bar/idler")->SetValue(static_cast<double>(tried) / primeCount::limit);
          Find<CStaticText>("gallery/primes")
              ->SetText(std::to_string(found) + " primes below " + std::to_string(tried));
          if (tried == primeCount::limit)
              log.Write("primes", std::to_string(found));
      })
{
    enterGalleryBuilders();
    LoadText(layoutText());
}

void galleryDialog::Loaded()
{
    Fill();
    CDialog::Loaded();
}

void galleryDialog::Fill()
{
    Find<CMenuBarPane>("gallery/menuBar")->SetMenuBar(makeGalleryMenuBar());
    CToolButton::Choose(*this, "gallery/tools", "gallery/tool/region");
    Find<CButton>("gallery/check")->SetValue(kOn);
    Find<CButton>("gallery/tristate")->SetValue(kNeutral);
    Find<CButton>("gallery/radio/medium")->SetValue(kOn);
    Find<CButton>("gallery/disclose")->SetValue(kOn);
    Find<CProgressBar>("gallery/bar/endless")->SetIndeterminate(true);
    Find<CProgressBar>("gallery/bar/timer")->SetValue(0.35);

    Find<CEditString>("gallery/name")->SetValue("The quick brown fox");
    Find<CEditString>("gallery/password")->SetValue("secret");
    Find<CEditString>("gallery/notes")
        ->SetValue("Several lines, scrolled\nas far as needed,\nby wheel, bar and caret.\n\nThe end.");
    Find<CEditSlider>("gallery/size")->SetResponse(CSliderResponse::Linear({{0.618, 0.1}}));

    Find<CRadioPopup>("gallery/noise")
        ->SetItems(
            {"$$$/Gallery/Auto=Auto", "$$$/Gallery/Low=Low", "$$$/Gallery/Medium=Medium", "$$$/Gallery/High=High"});
    Find<CComboBox>("gallery/paper")->SetItems({"A3", "A4", "A5", "Letter"});
    Find<CComboBox>("gallery/paper")->SetIndex(1);
    Find<CZoomProgressCombo>("gallery/zoom")->SetMenu(makeZoomMenu());
    Find<CZoomProgressCombo>("gallery/zoom")->SetProgress(0.6);
    Find<CMenuPopup>("gallery/actions")->SetMenu(makeActionMenu());
    Find<CMenuPopup>("gallery/flyout")->SetMenu(makeActionMenu());
    Find<CRadioPopup>("gallery/page")->SetItems({"$$$/Gallery/Page1=First", "$$$/Gallery/Page2=Second"});

    Find<CCellSheet>("gallery/cells")->SetCellSize({56, 60});
    for (int i = 0; i < 9; ++i)
        AddCell();
    Find<CCellSheet>("gallery/cells")->SelectIndex(1);
    auto *const files = Find<fileList>("gallery/files");
    files->Append({"/home/you/holiday.jpg", "/home/you/harbour.tif", "/home/you/portrait.png"});
    files->dropped = [this](const std::vector<std::string> &paths) {
        for (const std::string &path : paths)
            log.Write("drop", path);
    };
}

void galleryDialog::SetHelp(const std::string &text)
{
    log.Write("help", text);
    Find<CStaticText>("gallery/help")
        ->SetText(text.empty() ? "$$$/Gallery/Help=Place the pointer over a control for help." : text);
}

bool galleryDialog::ReceiveValue(CValueMessage &message)
{
    watch.Look();
    log.Value(message);
    if (const auto *const number = dynamic_cast<const CValMsg<CNumber> *>(&message))
        NumberChanged(*number);
    else if (const auto *const index = dynamic_cast<const CValMsg<unsigned> *>(&message))
        Chosen(*index);
    else if (const auto *const button = dynamic_cast<const CValMsg<EButtonValue> *>(&message))
        return ButtonChanged(*button);
    return true;
}

void galleryDialog::SetNumber(CObjID asked, double value)
{
    const auto setOne = [&](CObjID one) {
        if (auto *const both = Find<CEditSlider>(one))
            both->SetValue(value);
        else if (auto *const slider = Find<CSliderBase>(one))
            slider->SetValue(value);
        else if (auto *const field = Find<CEditNumber>(one))
            field->SetNumber(value);
    };
    setOne(asked);
    for (const auto &pair : twins)
        for (int i = 0; i < 2; ++i)
            if (asked == CObjID(pair[i]))
                setOne(pair[1 - i]);
}

void galleryDialog::NumberChanged(const CValMsg<CNumber> &message)
{
    const CObjID asked = message.Id();
    const double value = message.Value().value;
    if (asked == CObjID("gallery/zoom"))
        return SetZoom(value);
    if (message.Phase() == kValue_DragBegin || message.Phase() == kValue_EditBegin)
        before = value;
    else
        SetNumber(asked, value);
    if (isFinal(message.Phase()) && value != before)
        tasks.Push(std::make_unique<valueTask>("Change of " + asked.Name().substr(asked.Name().find('/') + 1), before,
                                               value, [this, asked](double to) { SetNumber(asked, to); }));
}

bool galleryDialog::ButtonChanged(const CValMsg<EButtonValue> &message)
{
    const auto *const button = Find<CButton>(message.Id());
    if (button == nullptr || button->Kind() == kPushButton)
        return false;
    if (message.Id() == CObjID("gallery/check"))
        FindView("gallery/text")->Enable(button->IsOn());
    else if (message.Id() == CObjID("gallery/disclose"))
        Find<CDisclosurePane>("gallery/disclosure")->Disclose(button->IsOn());
    return true;
}

void galleryDialog::Chosen(const CValMsg<unsigned> &message)
{
    if (message.Id() == CObjID("gallery/page") && message.Value() < std::size(pages))
        Find<CSwitchPane>("gallery/pages")->Switch(pages[message.Value()]);
}

bool galleryDialog::ReceiveMessage(CMessage &message)
{
    if (const auto *const scroll = dynamic_cast<const CScrollMessage *>(&message))
        log.Write("scroll", scroll->Id().Name(),
                  std::to_string(static_cast<int>(scroll->X())) + ',' + std::to_string(static_cast<int>(scroll->Y())));
    if (message.Id() != CDisclosurePane::Changed)
        return false;
    stackColumn(*FindView("gallery/lastColumn"), 0, 8);
    return true;
}

bool galleryDialog::ReceiveMenu(CMenuMessage &message)
{
    if (message.Purpose() == CMenuMessage::purpose::chosen)
        log.Write("menu", message.Id().Name(), message.Item().Name());
    return false;
}

bool galleryDialog::ReceiveCommand(CCommandMessage &message)
{
    const CObjID asked = message.Id();
    log.Write("command", asked.Name());
    if (asked == galleryCommand::undo)
        tasks.Undo();
    else if (asked == galleryCommand::redo)
        tasks.Redo();
    else if (asked == galleryCommand::quit)
        EndModal(asked);
    else if (asked == CObjID("gallery/icon"))
        AddCell();
    else if (asked == CObjID("gallery/flat"))
        RemoveCells();
    else if (asked == CObjID("gallery/start"))
        StartProgress();
    else if (const int zoom = galleryCommand::zoomBlock().IndexOf(asked); zoom >= 0)
        SetZoom(zoomPercents[zoom] / 100.0);
    else
        return ShowAlert(asked) || AskForFile(asked);
    return true;
}

bool galleryDialog::UpdateCommand(CCommandMessage &message)
{
    const CObjID asked = message.Id();
    message.enabled = true;
    if (asked == galleryCommand::undo)
        message.enabled = tasks.GetUndoText(message.text);
    else if (asked == galleryCommand::redo)
        message.enabled = tasks.GetRedoText(message.text);
    else if (const int zoom = galleryCommand::zoomBlock().IndexOf(asked); zoom >= 0)
        message.checked = Find<CZoomProgressCombo>("gallery/zoom")->Zoom() * 100 == zoomPercents[zoom];
    else
        return asked == galleryCommand::open || asked == galleryCommand::save || asked == galleryCommand::quit ||
               asked == galleryCommand::about;
    return true;
}

bool galleryDialog::ShowAlert(CObjID button)
{
    struct example
    {
        CObjID button;
        CAlertIcon icon;
        std::vector<CAlertButton> buttons;
        const char *text, *more;
    };
    const example examples[] = {
        {"gallery/alert/note", CAlertIcon::information, alertOk(), "The photo has no blur worth removing.", ""},
        {galleryCommand::about, CAlertIcon::information, alertOk(), "Every control of Stillmark's interface.",
         "What they say is printed with --log."},
        {"gallery/alert/question",
         CAlertIcon::question,
         {{CAlertButton::Ok, "&Save"}, {CAlertButton::Cancel, "Cancel"}, {CAlertButton::Other, "&Discard"}},
         "Save the changes to this workspace?",
         "Otherwise the traces that were added since are lost."},
        {"gallery/alert/warning", CAlertIcon::warning, alertOkCancel(),
         "The region is smaller than the blur. Estimate all the same?", ""},
        {"gallery/alert/error", CAlertIcon::error, alertOk(), "The workspace could not be saved.",
         "There is no room left on the device."}};
    for (const example &e : examples)
        if (e.button == button)
        {
            const CObjID answer = CMessageAlert(this, e.icon, e.buttons, e.text, e.more).Run();
            log.Write("answer", answer.Name());
            return true;
        }
    return false;
}

bool galleryDialog::AskForFile(CObjID command)
{
    const bool saves = command == galleryCommand::save;
    if (!saves && command != galleryCommand::open)
        return false;
    const CFileType types[] = {{"$$$/Gallery/Pictures=Pictures", {"png", "jpg", "jpeg", "tif", "tiff"}},
                               {"$$$/Gallery/Texts=Texts", {"txt", "md", "wyra"}}};
    std::string path;
    const auto ask = [&](CNavigator &navigator) {
        for (const CFileType &type : types)
            navigator.AddType(type);
        return navigator.Run(this, path);
    };
    bool chosen = false;
    if (saves)
    {
        CSaveFile save;
        save.SetName("untitled");
        chosen = ask(save);
    }
    else
    {
        COpenFile open;
        chosen = ask(open);
    }
    log.Write("file", chosen ? path : "-");
    if (chosen)
        Find<fileList>("gallery/files")->Append({path});
    return true;
}

void galleryDialog::AddCell()
{
    Find<CCellSheet>("gallery/cells")->Append(std::make_unique<numberCell>(++lastCell));
}

void galleryDialog::RemoveCells()
{
    auto *const sheet = Find<CCellSheet>("gallery/cells");
    const std::vector<int> selected = sheet->Selection().Selected();
    for (auto cell = selected.rbegin(); cell != selected.rend(); ++cell)
        sheet->Remove(*cell);
}

void galleryDialog::SetZoom(double factor)
{
    Find<CZoomProgressCombo>("gallery/zoom")->SetZoom(factor);
}

void galleryDialog::StartProgress()
{
    Find<CProgressBar>("gallery/bar/timer")->SetValue(0);
    Find<CZoomProgressCombo>("gallery/zoom")->SetProgress(0);
    timer.Start();
    primes.Start();
}

void galleryDialog::Tick(void *dialog)
{
    auto &self = *static_cast<galleryDialog *>(dialog);
    auto *const bar = self.Find<CProgressBar>("gallery/bar/timer");
    bar->SetValue(bar->Value() + 1.0 / 60);
    self.Find<CZoomProgressCombo>("gallery/zoom")->SetProgress(bar->Value());
    if (bar->Value() < 1)
        return;
    self.timer.Stop();
    self.Find<CZoomProgressCombo>("gallery/zoom")->EndProgress();
    self.log.Write("timer", "ended");
}

} // namespace Stillmark
