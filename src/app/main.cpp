#include "core/link/QtSerialLine.h"
#include "core/settings/SystemClock.h"
#include "desktop/shell/MainWindow.h"
#include "desktop/shell/MessageBoxPrompts.h"
#include "desktop/shell/QtPlatformDialogs.h"

#include <QApplication>

int main(int argc, char** argv) {
    QApplication app(argc, argv);
    QApplication::setOrganizationName(QStringLiteral("Telvio"));
    QApplication::setApplicationName(QStringLiteral("Telvio"));

    MessageBoxPrompts prompts;
    SystemClock clock;
    QtSerialLine serial;
    QtPlatformDialogs dialogs;
    MainWindow window({&prompts, &clock, &serial, &dialogs});
    prompts.setParent(&window);
    window.start();
    return app.exec();
}
