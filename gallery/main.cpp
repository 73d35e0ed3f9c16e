#include "framework/base/exceptions.h"
#include "framework/base/service.h"
#include "framework/controls/alerts/messageAlert.h"
#include "framework/icons/programIcons.h"
#include "framework/views/application.h"
#include "gallery/galleryDialog.h"
#include "gallery/galleryOptions.h"
#include "gallery/screenshot.h"
#include "platform/window/memoryDisplay.h"
#include "platform/window/sdlDisplay.h"

#include <cstdlib>
#include <exception>
#include <iostream>

namespace
{

using namespace Stillmark;

void takeScreenshot(const galleryOptions &options)
{
    Platform::memoryDisplay display(options.scale.value_or(1));
    Sarnik::CApplication application(display);
    const messageLog log(options.log);
    galleryDialog dialog(log);
    dialog.Open();
    application.ProcessAll();
    writeScreenshot(display.find(dialog.Screen()->id())->screen(), options.screenshot);
}

void runOnScreen(const galleryOptions &options)
{
    if (options.scale)
        setenv("STILLMARK_SCALE", std::to_string(*options.scale).c_str(), 1);
    Platform::sdlDisplay display;
    Sarnik::CApplication application(display);
    Sarnik::CWindowAlerts alerts;
    Sarnik::CAlertPort *const before = Sarnik::SetAlerts(&alerts);
    const messageLog log(options.log);
    galleryDialog dialog(log);
    log.Write("ended", dialog.RunModal().Name());
    Sarnik::SetAlerts(before);
}

int run(std::span<char *const> arguments)
{
    const galleryOptions options = parseGalleryOptions(arguments);
    if (options.help)
    {
        std::cout << galleryOptions::usage;
        return 0;
    }
    Sarnik::CProgramIcons::Get();
    options.screenshot.empty() ? runOnScreen(options) : takeScreenshot(options);
    return 0;
}

} // namespace

int main(int argc, char **argv)
{
    int status = 1;
    try
    {
        status = run({argv + 1, argv + argc});
    }
    catch (const usageError &e)
    {
        std::cerr << "stillmark_gallery: " << e.what() << '\n' << galleryOptions::usage;
        status = 2;
    }
    catch (const Sarnik::CException &e)
    {
        std::cerr << "stillmark_gallery: " << e.GetErrorString() << '\n';
    }
    catch (const std::exception &e)
    {
        std::cerr << "stillmark_gallery: " << e.what() << '\n';
    }
    Sarnik::CService::ShutdownAll();
    return status;
}
