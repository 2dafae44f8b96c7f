#include "desktop/shell/QtPlatformDialogs.h"

#include <QDesktopServices>
#include <QDir>
#include <QFileDialog>
#include <QPrintDialog>
#include <QPrinter>

std::optional<PlatformDialogs::SaveChoice>
QtPlatformDialogs::askSaveFile(QWidget* parent, const FileRequest& request) {
    QFileDialog dialog(parent);
    dialog.setAcceptMode(QFileDialog::AcceptSave);
    dialog.setFileMode(QFileDialog::AnyFile);
    // The file-exists question is the program's own dialog.
    dialog.setOption(QFileDialog::DontConfirmOverwrite);
    dialog.setOption(QFileDialog::DontResolveSymlinks);
    dialog.setDirectory(request.folder);
    dialog.setNameFilters(request.filters);
    dialog.selectNameFilter(request.filters.value(request.filterIndex));
    dialog.selectFile(request.fileName);
    if (dialog.exec() != QDialog::Accepted || dialog.selectedFiles().isEmpty())
        return std::nullopt;
    SaveChoice choice;
    choice.path = dialog.selectedFiles().constFirst();
    choice.filterIndex = qMax(0, int(request.filters.indexOf(dialog.selectedNameFilter())));
    return choice;
}

std::optional<QString> QtPlatformDialogs::askOpenFile(QWidget* parent, const FileRequest& request) {
    QFileDialog dialog(parent);
    dialog.setAcceptMode(QFileDialog::AcceptOpen);
    dialog.setFileMode(QFileDialog::AnyFile); // a missing name gets the program's own message
    dialog.setOptions(QFileDialog::ReadOnly | QFileDialog::DontResolveSymlinks);
    dialog.setDirectory(request.folder);
    dialog.setNameFilters(request.filters);
    dialog.selectNameFilter(request.filters.value(request.filterIndex));
    if (!request.fileName.isEmpty())
        dialog.selectFile(request.fileName);
    if (dialog.exec() != QDialog::Accepted || dialog.selectedFiles().isEmpty())
        return std::nullopt;
    return dialog.selectedFiles().constFirst();
}

bool QtPlatformDialogs::askPrinter(QWidget* parent, QPrinter& printer) {
    QPrintDialog dialog(&printer, parent);
    dialog.setOption(QAbstractPrintDialog::PrintToFile, false);
    dialog.setOption(QAbstractPrintDialog::PrintSelection, false);
    dialog.setOption(QAbstractPrintDialog::PrintPageRange, false);
    return dialog.exec() == QDialog::Accepted;
}

bool QtPlatformDialogs::openWithDefaultApplication(const QUrl& url) {
    return QDesktopServices::openUrl(url);
}
