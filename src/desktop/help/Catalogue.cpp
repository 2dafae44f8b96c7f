#include "desktop/help/Catalogue.h"

#include "core/Prompts.h"
#include "core/settings/AppState.h"
#include "desktop/help/CatalogDialog.h"
#include "desktop/shell/PlatformDialogs.h"

#include <QDir>
#include <QFileInfo>
#include <QRegularExpression>
#include <QStorageInfo>
#include <QUrl>

namespace Catalogue {

namespace {
const QRegularExpression& letterDrive() {
    static const QRegularExpression re(QStringLiteral("^([A-Za-z]):[/\\\\]?$"));
    return re;
}
} // namespace

QString pagePath(const QString& drive) {
    QString base = drive;
    while (base.endsWith(QLatin1Char('/')) || base.endsWith(QLatin1Char('\\')))
        base.chop(1);
    return base + QStringLiteral("/kvo/index.html");
}

QString shownPath(const QString& drive) {
    return QDir::toNativeSeparators(pagePath(drive));
}

bool pageExists(const QString& drive) {
    if (drive.trimmed().isEmpty())
        return false;
    const QString path = pagePath(drive);
    return QDir::isAbsolutePath(path) && QFileInfo(path).isFile();
}

QString driveText(const QString& rootPath) {
    const auto letter = letterDrive().match(rootPath);
    if (letter.hasMatch())
        return letter.captured(1).toLower() + QLatin1Char(':');
    QString text = rootPath;
    while (text.size() > 1 && (text.endsWith(QLatin1Char('/')) || text.endsWith(QLatin1Char('\\'))))
        text.chop(1);
    return text;
}

QStringList availableDrives() {
    QStringList drives;
    const QList<QStorageInfo> volumes = QStorageInfo::mountedVolumes();
    for (const QStorageInfo& volume : volumes) {
        // Bind-mounted single files show up as volumes too; only folders can hold the page.
        if (!volume.isValid() || !volume.isReady() || !QFileInfo(volume.rootPath()).isDir())
            continue;
        const QString text = driveText(volume.rootPath());
        if (!text.isEmpty() && !drives.contains(text))
            drives.append(text);
    }
    return drives;
}

QString defaultDrive() {
    return driveText(QStorageInfo::root().rootPath());
}

bool open(const QUrl& url, Prompts& prompts, PlatformDialogs& dialogs) {
    if (url.isValid() && dialogs.openWithDefaultApplication(url))
        return true;
    prompts.show(QStringLiteral("No  program  could  open  ") + url.toDisplayString(),
                 Prompts::Icon::Information, Prompts::Buttons::Ok);
    return false;
}

void browse(AppState& state, Prompts& prompts, PlatformDialogs& dialogs, QWidget* parent) {
    if (pageExists(state.catalogDrive)) {
        open(QUrl::fromLocalFile(pagePath(state.catalogDrive)), prompts, dialogs);
        return;
    }
    CatalogDialog chooser(state, prompts, dialogs, availableDrives(), parent);
    chooser.exec();
}

} // namespace Catalogue
