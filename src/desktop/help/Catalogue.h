#pragma once

#include <QString>
#include <QStringList>

struct AppState;
class Prompts;
class PlatformDialogs;
class QUrl;
class QWidget;

// The maker's product catalogue: an HTML page under "kvo" on a CD. The drive is a drive text
// such as "d:" on Windows, and a folder or mount path such as "/media/cdrom" elsewhere.
namespace Catalogue {

// drive + "/kvo/index.html".
QString pagePath(const QString& drive);
// The same with the platform's own separators, for showing.
QString shownPath(const QString& drive);
// True when the page is a file. A relative or empty drive text never counts, so the page is
// never looked up relative to the current folder.
bool pageExists(const QString& drive);

// A volume's root as a drive text: "C:/" gives "c:", "/media/cdrom/" gives "/media/cdrom".
QString driveText(const QString& rootPath);
// The drives or mounted volumes of this machine, and the one a drive list starts on.
QStringList availableDrives();
QString defaultDrive();

// Hands a file, web or mail address to the default application. The address goes to the
// platform as an address, never through a command line, so no text in it can run anything.
// A failure is reported in a message box.
bool open(const QUrl& url, Prompts& prompts, PlatformDialogs& dialogs);

// Browse Catalogue: opens the page on catalogDrive, or lets the user choose another drive.
void browse(AppState& state, Prompts& prompts, PlatformDialogs& dialogs, QWidget* parent);

} // namespace Catalogue
