#pragma once
// What the component needs from the process it runs in, in one object: the chart window and mouse
// pointer, the prompter (message boxes, the data choice dialogs), the host's object factory, the
// help opener and the print target. services() is the set in use; a test installs its own for a
// scope and the previous set comes back when the scope ends:
//
//   ScopedServices services{[] { Services s; s.hostObjects = myFactory; return s; }()};
//   services->printToPdf = "/tmp/printed.pdf";
#include <cstdint>
#include <functional>
#include <memory>
#include <string>

#include "chart/ChartWindowPort.h"
#include "host/HostObjects.h"

namespace kg {

// Mouse pointer values of the screen.
constexpr int kPointerDefault = 0;
constexpr int kPointerHourglass = 11;

// Which data choice dialog: quote types (frmChoose1) or categories (frmChoose2).
enum class ChoiceDialog { QuoteType = 1, Category = 2 };
constexpr int16_t kChoiceCancelled = -99;

// The chart window and the mouse pointer.
class WindowService {
public:
    virtual ~WindowService() = default;
    // Loads the chart window if it is not loaded (its load handler runs); a loaded one is returned as is.
    virtual Ref<ChartWindowPort> loadChartWindow() = 0;
    virtual void setMousePointer(int pointer) = 0;
    virtual int mousePointer() const = 0;
};

// Every message box and data choice dialog of the requests. The windows' own dialogs extend it
// (ui/Prompter.h).
class Prompter {
public:
    virtual ~Prompter() = default;
    // Fixed text, OK only, no icon, the component's title.
    virtual void showMessage(const std::string& text) = 0;
    // Shows the dialog modally and returns its iChoice (0..6, or -99 when cancelled).
    virtual int16_t chooseData(ChoiceDialog dialog) = 0;
};

// The defaults without a screen (requests/HeadlessUi.h): a chart window that only holds its
// control, and a prompter whose messages go nowhere and whose data choice fails.
std::shared_ptr<WindowService> headlessWindows();
std::shared_ptr<Prompter> noScreenPrompter();

struct Services {
    std::shared_ptr<WindowService> windows = headlessWindows();
    std::shared_ptr<Prompter> prompter = noScreenPrompter();
    // Creates the host's objects for GraphInitialize; null until a host installs one (the C
    // surface installs the test stand's when the host has none).
    Ref<host::HostObjectFactory> hostObjects;
    // Opens the help file at a path, returning a shell-style code; empty: the desktop's opener.
    std::function<int(const std::string& path)> helpOpener;
    // Printing goes to this PDF file; empty: to the default printer.
    std::string printToPdf;
};

// The set in use: the innermost ScopedServices, else the process's own.
Services& services();

class ScopedServices {
public:
    explicit ScopedServices(Services installed = {});
    ~ScopedServices();
    ScopedServices(const ScopedServices&) = delete;
    ScopedServices& operator=(const ScopedServices&) = delete;

    Services* operator->() { return &own_; }
    Services& operator*() { return own_; }

private:
    Services own_;
    Services* previous_;
};

}  // namespace kg
