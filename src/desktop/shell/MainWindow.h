#pragma once

#include "core/settings/AppState.h"
#include "desktop/shell/MainControls.h"

#include <QMainWindow>
#include <functional>
#include <memory>

class Clock;
class Prompts;
class PlatformDialogs;
class SerialLine;
class Exchange;
class Connection;
class InstrumentCommands;
class ReadingCommands;
class WorkspaceCommands;
class HelpCommands;
class QPrinter;

// What the main window is given to talk to the outside world. Tests pass recorders and fakes;
// the program passes the real ones (see app/main.cpp).
struct MainWindowServices {
    Prompts* prompts = nullptr;
    Clock* clock = nullptr;
    SerialLine* serial = nullptr;
    PlatformDialogs* dialogs = nullptr;
};

// The main window: builds every control, owns AppState and the subsystems' command classes,
// and holds the routines every command runs first (save prompt, voltage stop, enabling rules).
class MainWindow : public QMainWindow {
    Q_OBJECT
public:
    explicit MainWindow(const MainWindowServices& services, QWidget* parent = nullptr);
    ~MainWindow() override;

    // The start-up sequence: caption, placement, show, data folder, settings, serial options,
    // first connection attempt.
    void start();

    AppState& state() { return state_; }
    const MainControls& controls() const { return c_; }
    Prompts& prompts() { return *services_.prompts; }
    Clock& clock() { return *services_.clock; }
    SerialLine& serial() { return *services_.serial; }
    PlatformDialogs& dialogs() { return *services_.dialogs; }

    Exchange& exchange() { return *exchange_; }
    Connection& connection() { return *connection_; }
    InstrumentCommands& instrument() { return *instrument_; }
    ReadingCommands& readings() { return *readings_; }
    WorkspaceCommands& workspace() { return *workspace_; }
    HelpCommands& help() { return *help_; }

    void ExitProgram();
    void RunSetupWizard();
    void StopVoltageDisplay();
    bool NeedsSavePrompt(const QString& mode) const;
    void PromptSaveAndClear(const QString& mode);
    void UncheckDisplayMenus();
    void DisableCommandsForRun();
    void EnableCommandsAfterRun();
    // Sets the status line and paints it at once (exchanges block the event loop).
    void setMessage(const QString& text);
    // Places a widget at a left edge given in twips.
    static void setLeftTwips(QWidget* w, int twips);
    static void setTopTwips(QWidget* w, int twips);

    // The data folder: the user's documents folder + "Telvio".
    QString dataFolder() const;
    // The one printer of the program: what Print Setup chooses is used by every later print,
    // the help windows' included. Made when first needed.
    QPrinter& printer();

    // Called when ExitProgram ends the program; tests replace it to observe the exit.
    std::function<void()> endProgram;

signals:
    void resized();

protected:
    void closeEvent(QCloseEvent* event) override;
    void resizeEvent(QResizeEvent* event) override;

private:
    void buildControls();
    void buildMenus();
    void buildButtons();
    void buildStatusArea();
    void placeWindow();

    MainWindowServices services_;
    AppState state_;
    MainControls c_;
    std::unique_ptr<Exchange> exchange_;
    std::unique_ptr<Connection> connection_;
    std::unique_ptr<InstrumentCommands> instrument_;
    std::unique_ptr<ReadingCommands> readings_;
    std::unique_ptr<WorkspaceCommands> workspace_;
    std::unique_ptr<HelpCommands> help_;
    std::unique_ptr<QPrinter> printer_;
    QString dataFolder_;
    bool exiting_ = false;
};
