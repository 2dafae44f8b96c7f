#include "ScriptedDialogs.h"

#include <QPrinter>

void ScriptedDialogs::answerSave(const QString& path, int filterIndex) {
    saves_.enqueue(SaveChoice{path, filterIndex});
}

void ScriptedDialogs::cancelSave() {
    saves_.enqueue(std::nullopt);
}

void ScriptedDialogs::answerOpen(const QString& path) {
    opens_.enqueue(path);
}

void ScriptedDialogs::cancelOpen() {
    opens_.enqueue(std::nullopt);
}

void ScriptedDialogs::printToPdf(const QString& pdfPath) {
    prints_.enqueue(pdfPath);
}

void ScriptedDialogs::cancelPrint() {
    prints_.enqueue(std::nullopt);
}

std::optional<PlatformDialogs::SaveChoice> ScriptedDialogs::askSaveFile(QWidget*,
                                                                        const FileRequest& r) {
    saveCalls.append({r.folder, r.fileName, r.filters, r.filterIndex});
    if (saves_.isEmpty()) {
        ++unanswered;
        return std::nullopt;
    }
    return saves_.dequeue();
}

std::optional<QString> ScriptedDialogs::askOpenFile(QWidget*, const FileRequest& r) {
    openCalls.append({r.folder, r.fileName, r.filters});
    if (opens_.isEmpty()) {
        ++unanswered;
        return std::nullopt;
    }
    return opens_.dequeue();
}

bool ScriptedDialogs::askPrinter(QWidget*, QPrinter& printer) {
    ++printDialogs;
    if (prints_.isEmpty()) {
        ++unanswered;
        return false;
    }
    const std::optional<QString> pdf = prints_.dequeue();
    if (!pdf)
        return false;
    if (pdf->isEmpty())
        return true;
    printer.setOutputFormat(QPrinter::PdfFormat);
    printer.setOutputFileName(*pdf);
    return true;
}

bool ScriptedDialogs::openWithDefaultApplication(const QUrl& url) {
    openedWithDefault.append(url);
    return openWithResult_;
}
