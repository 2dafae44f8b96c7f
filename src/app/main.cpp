#include "link/QtSerialLine.h"
#include "shell/MainWindow.h"
#include "shell/MessageBoxPrompts.h"
#include "shell/QtPlatformDialogs.h"
#include "shell/SystemClock.h"

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
