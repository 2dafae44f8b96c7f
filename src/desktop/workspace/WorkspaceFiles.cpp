#include "desktop/workspace/WorkspaceFiles.h"

#include "core/Prompts.h"
#include "core/text/SavedText.h"
#include "core/text/WorkspaceFileIO.h"
#include "desktop/shell/MainWindow.h"
#include "desktop/shell/PlatformDialogs.h"
#include "desktop/workspace/FileExistsDialog.h"

#include <QAction>
#include <QFileInfo>
#include <QLabel>
#include <QPlainTextEdit>
#include <QPushButton>

namespace {
bool fileExists(const QString& path) {
    return QFileInfo(path).isFile();
}
} // namespace

WorkspaceFiles::WorkspaceFiles(MainWindow& window) : w_(window) {}

DisplayKind WorkspaceFiles::displayKind() const {
    const MainControls& c = w_.controls();
    DisplayKind k;
    k.realTime = c.mnuRealTime->isChecked();
    k.log = c.mnuLog->isChecked();
    k.glp = c.mnuGLP->isChecked();
    k.voltage = c.mnuVoltage->isChecked();
    k.maxMin = c.mnuMaxMin->isChecked();
    k.listen = c.mnuListen->isChecked();
    return k;
}

QString WorkspaceFiles::DefaultSaveName() const {
    return SaveNames::defaultName(displayKind());
}

QString WorkspaceFiles::folder() const {
    return lastFolder_.isEmpty() ? w_.dataFolder() : lastFolder_;
}

void WorkspaceFiles::rememberFolder(const QString& path) {
    lastFolder_ = QFileInfo(path).absolutePath();
}

WorkspaceFiles::Chosen WorkspaceFiles::AskSaveFileName() {
    const QStringList filters = SaveNames::saveFilters(displayKind());
    // A filter index beyond the filters offered now (plain text only) starts on the first.
    const int index = filterIndex_ < filters.size() ? filterIndex_ : 0;
    const auto answer =
        w_.dialogs().askSaveFile(&w_, {folder(), DefaultSaveName(), filters, index});
    if (!answer) {
        w_.state().saveCancelled = true;
        return {};
    }
    filterIndex_ = answer->filterIndex;
    const bool comma = answer->filterIndex == 1 && filters.size() > 1;
    Chosen chosen{SaveNames::withDefaultExtension(answer->path, comma ? 1 : 0), comma};
    rememberFolder(chosen.path);
    fileName_ = chosen.path;
    return chosen;
}

// What goes into the file. The conversions work on a copy: the workspace keeps the text it
// shows, so finding, a later save and a continued run still see the readings as received.
QString WorkspaceFiles::fileContents(bool commaDelimited) const {
    const AppState& s = w_.state();
    const MainControls& c = w_.controls();
    return SavedText::contents(s.workspaceText, commaDelimited, s.convertAsterisks == 1,
                               c.mnuGLP->isChecked(),
                               c.lblHeader->text().isEmpty() ? QString() : s.headerText);
}

void WorkspaceFiles::SaveWorkspace() {
    AppState& s = w_.state();
    w_.StopVoltageDisplay();
    s.saveCancelled = false;
    Chosen chosen;
    for (;;) {
        chosen = AskSaveFileName();
        if (s.saveCancelled)
            return;
        if (!fileExists(chosen.path))
            break;
        FileExistsDialog dialog(&w_);
        dialog.exec();
        s.fileExistsChoice = dialog.choice();
        if (s.fileExistsChoice == QLatin1String("Append") ||
            s.fileExistsChoice == QLatin1String("Overwrite"))
            break;
    }
    const bool append = s.fileExistsChoice == QLatin1String("Append");
    QString error;
    if (!WorkspaceFileIO::write(chosen.path, fileContents(chosen.commaDelimited), append, error)) {
        w_.prompts().show(error, Prompts::Icon::Exclamation, Prompts::Buttons::Ok);
        return;
    }
    s.workspaceSaved = true;
}

void WorkspaceFiles::OpenFileIntoWorkspace() {
    AppState& s = w_.state();
    const MainControls& c = w_.controls();
    w_.StopVoltageDisplay();
    w_.PromptSaveAndClear(QString());
    const auto path =
        w_.dialogs().askOpenFile(&w_, {folder(), fileName_, SaveNames::openFilters()});
    if (!path)
        return;
    rememberFolder(*path);
    fileName_ = *path;
    if (!fileExists(*path)) {
        fileName_.clear();
        w_.prompts().show(QStringLiteral("        File not found!        "), Prompts::Icon::None,
                          Prompts::Buttons::Ok);
    } else {
        // Read into a copy first: a file that cannot be read leaves the workspace as it was.
        QString text;
        QString error;
        if (!WorkspaceFileIO::readForDisplay(*path, text, error)) {
            w_.prompts().show(error, Prompts::Icon::Information, Prompts::Buttons::Ok);
            return;
        }
        s.workspaceText = std::move(text);
        c.lblHeader->clear();
        c.RichTextBox1->setPlainText(s.workspaceText);
        w_.UncheckDisplayMenus();
    }
    c.cmdSaveFile->setEnabled(true);
    c.mnuSave->setEnabled(true);
}
